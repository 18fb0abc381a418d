#include "content/PLScript.h"

#include <gmock/gmock.h>

#include <functional>

#include "content/scripts/ScriptRunner.h"

namespace plume {
namespace {

using testing::ElementsAre;

// Answers every script by a function of its text and remembers what it was asked to run.
class FakeRunner final : public ScriptRunner {
  public:
    using Answer = std::function<std::optional<std::u16string>(std::u16string_view)>;
    explicit FakeRunner(Answer answer) : answer_(std::move(answer)) {}

    std::optional<std::u16string> run(std::u16string_view script, bool isAppleScript) override {
        ran.emplace_back(script);
        if (isAppleScript) appleScripts.emplace_back(script);
        return answer_(script);
    }

    bool canRunAppleScript() override { return true; }

    std::vector<std::u16string> ran;
    std::vector<std::u16string> appleScripts;

  private:
    Answer answer_;
};

std::optional<std::u16string> inAngles(std::u16string_view script) {
    return u"<" + std::u16string(script) + u">";
}

std::shared_ptr<PLScript> makeScript(std::u16string text, std::size_t location = 0) {
    auto script = std::make_shared<PLScript>();
    script->script = std::move(text);
    script->location = location;
    return script;
}

TEST(PLScript, RunsFromTheInsideOut) {
    FakeRunner runner(inAngles);
    auto outer = makeScript(u"a");
    auto middle = makeScript(u"b", 1);
    middle->isAppleScript = true;
    middle->nestedScripts = {makeScript(u"c", 0)};
    outer->nestedScripts = {middle, makeScript(u"d", 1)};
    outer->execute(runner);
    EXPECT_THAT(runner.ran, ElementsAre(u"c", u"<c>b", u"d", u"a<<c>b><d>"));
    EXPECT_THAT(runner.appleScripts, ElementsAre(u"<c>b"));
    EXPECT_EQ(outer->result, u"<a<<c>b><d>>");
}

TEST(PLScript, PutsInWhatResultsThereAreWhereverTheyBelong) {
    auto outer = makeScript(u"()");
    outer->nestedScripts = {makeScript(u"", 1), makeScript(u"", 1), makeScript(u"", 1), makeScript(u"", 99)};
    outer->nestedScripts[0]->result = u"first";
    outer->nestedScripts[2]->result = u"second";
    outer->nestedScripts[3]->result = u"end";
    outer->mergerNestedScriptResults();
    EXPECT_EQ(outer->script, u"(firstsecond)end");
}

TEST(PLScript, AppendsTheSuffixToAnOutputThatIsNotEmpty) {
    using Text = PLScript::Text;
    const Text cases[][3] = {
        {u"out", u".", u"out."}, {u"out", std::nullopt, u"out"}, {u"", u".", u""}, {std::nullopt, u".", std::nullopt}};
    for (const auto& [output, suffix, expected] : cases) {
        FakeRunner runner([&result = output](std::u16string_view) { return result; });
        PLScript script;
        script.suffix = suffix;
        script.execute(runner);
        EXPECT_EQ(script.result, expected);
    }
}

TEST(PLScript, TellsThatItRanOnceItsResultStands) {
    struct Listener {
        void scriptExecuted(PLScript& script) { results.push_back(script.result.value_or(u"none")); }
        std::vector<std::u16string> results;
    } listener;
    FakeRunner runner(inAngles);
    auto outer = makeScript(u"outer");
    auto nested = makeScript(u"nested");
    outer->nestedScripts = {nested};
    outer->suffix = u"!";
    const Subscription subscriptions[] = {outer->executed.addObserver(&listener, &Listener::scriptExecuted),
                                          nested->executed.addObserver(&listener, &Listener::scriptExecuted)};
    outer->execute(runner);
    EXPECT_THAT(listener.results, ElementsAre(u"<nested>", u"<<nested>outer>!"));
}

TEST(PLScript, RunsAndGoesAwayHoweverDeepItIsNested) {
    constexpr std::size_t Depth = 200'000;
    auto outermost = makeScript(u"");
    PLScript* innermost = outermost.get();
    for (std::size_t i = 0; i < Depth; ++i) {
        innermost->nestedScripts = {makeScript(u"")};
        innermost = innermost->nestedScripts[0].get();
    }
    innermost->script = u"x";
    FakeRunner runner([](std::u16string_view script) { return std::u16string(script); });
    outermost->execute(runner);
    EXPECT_EQ(outermost->result, u"x");
    EXPECT_EQ(runner.ran.size(), Depth + 1);
    outermost.reset();
}

TEST(PLScript, LeavesScriptsThatOthersStillHold) {
    auto outer = makeScript(u"outer");
    auto kept = makeScript(u"kept");
    kept->nestedScripts = {makeScript(u"inner")};
    outer->nestedScripts = {kept};
    outer.reset();
    ASSERT_EQ(kept->nestedScripts.size(), 1u);
    EXPECT_EQ(kept->nestedScripts[0]->script, u"inner");
}

}  // namespace
}  // namespace plume
