#include "ports/simulated/SimulatedPasteboard.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

namespace plume {
namespace {

using ::testing::ElementsAre;
using ::testing::IsEmpty;

const std::string String(PasteboardType::String);
const std::string Rtf(PasteboardType::RTF);

struct Promise final : PasteboardOwner {
    void provideData(Pasteboard& pasteboard, std::string_view type) override {
        asked.emplace_back(type);
        if (keeps) pasteboard.setString(u"promised", type);
    }
    std::vector<std::string> asked;
    bool keeps = true;
};

TEST(SimulatedPasteboard, HoldsWhatAProgramCopied) {
    SimulatedPasteboard pasteboard;
    EXPECT_FALSE(pasteboard.string());
    pasteboard.copyFromProgram({{Rtf, "{\\rtf1}"}, {String, "na\xC3\xAFve"}});
    EXPECT_THAT(pasteboard.types(), ElementsAre(Rtf, String));
    EXPECT_EQ(pasteboard.string(), u"na\u00EFve");
    EXPECT_EQ(pasteboard.data(Rtf), "{\\rtf1}");

    const std::u16string unpaired = u"a\xD800";
    pasteboard.copyFromProgram(unpaired);
    EXPECT_EQ(pasteboard.string(), unpaired);
    EXPECT_FALSE(pasteboard.data(Rtf));
}

TEST(SimulatedPasteboard, CountsEveryNewContent) {
    SimulatedPasteboard pasteboard;
    const auto before = pasteboard.changeCount();
    EXPECT_EQ(pasteboard.declareTypes({String}, nullptr), before + 1);
    pasteboard.setString(u"text", String);
    EXPECT_EQ(pasteboard.changeCount(), before + 1);
    pasteboard.declareTypes({}, nullptr);
    EXPECT_EQ(pasteboard.changeCount(), before + 2);
    EXPECT_THAT(pasteboard.types(), IsEmpty());
    EXPECT_FALSE(pasteboard.string());
}

TEST(SimulatedPasteboard, TakesNothingThatWasNotDeclared) {
    SimulatedPasteboard pasteboard;
    pasteboard.declareTypes({String}, nullptr);
    pasteboard.setData("{\\rtf1}", Rtf);
    EXPECT_FALSE(pasteboard.data(Rtf));
    EXPECT_FALSE(pasteboard.string());
}

TEST(SimulatedPasteboard, AsksForPromisedContentWhenSomebodyWantsIt) {
    SimulatedPasteboard pasteboard;
    Promise promise;
    pasteboard.declareTypes({String, Rtf}, &promise);
    EXPECT_THAT(pasteboard.types(), ElementsAre(String, Rtf));
    EXPECT_THAT(promise.asked, IsEmpty());
    EXPECT_EQ(pasteboard.string(), u"promised");
    EXPECT_EQ(pasteboard.string(), u"promised");
    EXPECT_FALSE(pasteboard.data("public.html"));
    EXPECT_THAT(promise.asked, ElementsAre(String)) << "once, and for nothing else";
}

TEST(SimulatedPasteboard, APromiseThatIsNotKeptIsNoContent) {
    SimulatedPasteboard pasteboard;
    Promise promise;
    promise.keeps = false;
    pasteboard.declareTypes({String}, &promise);
    EXPECT_FALSE(pasteboard.string());
    pasteboard.copyFromProgram(u"text");
    EXPECT_EQ(pasteboard.string(), u"text");
    EXPECT_THAT(promise.asked, ElementsAre(String));
}

}  // namespace
}  // namespace plume
