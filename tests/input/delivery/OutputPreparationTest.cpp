#include "input/delivery/OutputPreparation.h"

#include <gtest/gtest.h>

#include "Foundation/KeyCode.h"
#include "Foundation/KeyModifiers.h"
#include "Foundation/Strings.h"
#include "library/Snippet.h"
#include "library/SnippetGroup.h"

namespace plume {
namespace {

using enum InputFlag;

const TriggerKey SpaceKey{KeyCode::Space, u" "};
const TriggerKey ReturnKey{KeyCode::Return, u"\r"};
const TriggerKey NoLongerKnown{};

struct World {
    std::shared_ptr<SnippetGroup> group = SnippetGroup::make();
    std::shared_ptr<Snippet> snippet = std::make_shared<Snippet>(u"a", u"b");
    PLOutput output;
    ContextInputSetting setting;
    TriggerKey key = SpaceKey;

    explicit World(std::size_t length = 5) {
        group->setExpandTrigger(ExpandTrigger::DelimiterKept);
        group->addItem(snippet);
        output.trigger = SnippetTrigger::Typed;
        output.snippetExpandedContent = std::make_shared<SnippetExpandedContent>(std::u16string(length, u'x'));
        output.snippetExpandedContent->originalSnippet = snippet;
    }

    SnippetExpandedContent& content() { return *output.snippetExpandedContent; }
    void addKey(std::uint64_t count) {
        auto variable = std::make_shared<SnippetKeyVariable>(u"\u2192", KeyCode::Right);
        variable->count = count;
        content().variables.push_back(variable);
    }
};

struct PreparationCase {
    const char* about;
    World world;
    bool cancelTrigger;
    std::u16string text;  // with the delimiter that is typed again
};

World with(World world, const std::function<void(World&)>& change) {
    change(world);
    return world;
}

std::u16string x(std::size_t length, std::u16string_view suffix = {}) {
    return std::u16string(length, u'x').append(suffix);
}

std::vector<PreparationCase> cases() {
    return {
        {"20 events", with(World(10), [](World& w) { w.output.backspaceCount = 19; }), false, x(10)},
        {"21 events", with(World(10), [](World& w) { w.output.backspaceCount = 20; }), true, x(10, u" ")},
        {"not typed", with(World(401), [](World& w) { w.output.trigger = SnippetTrigger::Suggestion; }), true, x(401)},
        {"swallowed already, and typed again", with(World(), [](World& w) { w.output.cancelTrigger = true; }), true,
         x(5, u" ")},
        {"a suffix of its own", with(World(), [](World& w) { w.content().suffix = u"!"; }), false, x(5, u"!")},
        {"and that only once", with(World(401), [](World& w) { w.content().suffix = u"!"; }), true, x(401, u"!")},
        {"many presses", with(World(), [](World& w) { w.addKey(30); }), true, x(5, u" ")},
        {"a delayed key at the end",
         with(World(),
              [](World& w) {
                  w.addKey(1);
                  std::static_pointer_cast<SnippetKeyVariable>(w.content().variables.back())->delay = 1;
                  w.content().variables.back()->location = 5;
              }),
         true, x(5, u" ")},
        {"with a wait behind",
         with(World(),
              [](World& w) {
                  w.setting.flags |= UseClipboard;
                  w.setting.afterPastingDelay = 0.05;
              }),
         true, x(5, u" ")},
        {"by way of activation", with(World(), [](World& w) { w.setting.flags = UseClipboard | Reactivate; }), true,
         x(5, u" ")},
        {"delays that only pastes have", with(World(), [](World& w) { w.setting.flags = DelayPasting; }), false, x(5)},
        {"the key is gone", with(World(401), [](World& w) { w.key = NoLongerKnown; }), true, x(401)},
        {"no styled delimiter behind rich text, but Return has no look",
         with(World(),
              [](World& w) {
                  w.content().content = AttributedString(u"rich");
                  w.group->setResetFormatting(true);
                  w.key = ReturnKey;
              }),
         false, u"rich"},
        {"plain text has no style", with(World(), [](World& w) { w.group->setResetFormatting(true); }), false, x(5)},
    };
}

TEST(OutputPreparation, DecidesAboutTheTriggerKey) {
    for (PreparationCase& c : cases()) {
        World& world = c.world;
        prepareOutput(world.output, world.setting, world.key, false);
        EXPECT_EQ(world.output.cancelTrigger, c.cancelTrigger) << c.about;
        EXPECT_EQ(toUtf8(world.content().string()), toUtf8(c.text)) << c.about;
        std::u16string sent;
        for (const auto& fragment : world.output.fragments) {
            if (const auto* text = std::get_if<std::u16string>(&fragment)) sent += *text;
            if (const auto* rich = std::get_if<AttributedString>(&fragment)) sent += rich->string();
        }
        EXPECT_EQ(toUtf8(sent), toUtf8(c.text)) << c.about << ": what is sent";
    }
}

TEST(OutputPreparation, ErasingAloneNeedsNoContent) {
    PLOutput output;
    output.backspaceCount = 21;
    prepareOutput(output, {}, SpaceKey, false);
    EXPECT_TRUE(output.cancelTrigger);
    EXPECT_TRUE(output.fragments.empty());
}

}  // namespace
}  // namespace plume
