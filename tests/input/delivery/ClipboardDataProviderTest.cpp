#include "input/delivery/ClipboardDataProvider.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "Foundation/text/RTFD.h"
#include "input/ClipboardUtils.h"
#include "input/delivery/ClipboardBackup.h"
#include "ports/simulated/SimulatedPasteboard.h"
#include "ports/simulated/SimulatedRunLoop.h"

namespace plume {
namespace {

using ::testing::ElementsAre;

const std::string String(PasteboardType::String);
const std::string RTF(PasteboardType::RTF);
const std::string RTFD(PasteboardType::RTFD);
const std::string HTML(PasteboardType::HTML);

AttributedString boldText(std::u16string text) {
    TextAttributes look;
    look.font = FontAttribute{u"Serif", 12, true, false};
    return AttributedString(std::move(text), std::make_shared<const TextAttributes>(look));
}

class ClipboardDataProviderTest : public ::testing::Test {
  protected:
    // What the target of a paste does.
    std::optional<std::u16string> paste() { return pasteboard.string(); }
    void expand(std::u16string text) {
        provider.cancelRestore();
        provider.backup();
        provider.setString(std::move(text));
    }

    SimulatedPasteboard pasteboard;
    SimulatedRunLoop loop;
    ClipboardDataProvider provider{pasteboard, loop};
    UserPasteboard userPasteboard{pasteboard, provider};
};

TEST_F(ClipboardDataProviderTest, GivesTheClipboardBackOnceTheTargetHasRead) {
    pasteboard.copyFromProgram({{"image/png", std::string(5'000'000, '\x7f')}, {String, "user's"}, {"odd", ""}});
    expand(u"expansion");
    EXPECT_THAT(pasteboard.types(), ElementsAre(String));
    provider.restoreAfterDelay();
    loop.advance(10);
    EXPECT_EQ(paste(), u"expansion") << "not restored before anybody has read it";
    loop.advance(0.31);
    EXPECT_THAT(pasteboard.types(), ElementsAre("image/png", String, "odd"));
    EXPECT_EQ(pasteboard.data("image/png"), std::string(5'000'000, '\x7f'));
    EXPECT_EQ(pasteboard.data(String), "user's");
    EXPECT_EQ(pasteboard.data("odd"), "");
    EXPECT_FALSE(loop.nextDue());
}

TEST_F(ClipboardDataProviderTest, WhatTheUserCopiedSinceStays) {
    pasteboard.copyFromProgram(u"old");
    expand(u"expansion");
    paste();
    provider.restoreAfterDelay();
    pasteboard.copyFromProgram(u"new");
    loop.advance(1);
    EXPECT_EQ(paste(), u"new");
    EXPECT_FALSE(loop.nextDue());
}

TEST_F(ClipboardDataProviderTest, RichContentIsOfferedInItsRichFormsOnly) {
    provider.setAttributedString(boldText(u"a\nb"));
    EXPECT_THAT(pasteboard.types(), ElementsAre(RTFD, RTF));
    EXPECT_EQ(attributedStringFromRTFD(*pasteboard.data(RTFD)).value().string(), u"a\nb");
    EXPECT_EQ(attributedStringFromRTF(*pasteboard.data(RTF)).value().string(), u"a\nb");

    provider.includeHTMLData = true;
    provider.setAttributedString(boldText(u"a\nb"));
    EXPECT_THAT(pasteboard.types(), ElementsAre(RTFD, RTF, HTML));
    EXPECT_NE(pasteboard.data(HTML)->find("<p>"), std::string::npos);
    provider.setAttributedString(boldText(u"a b"));
    EXPECT_EQ(pasteboard.data(HTML)->find("<p"), std::string::npos) << "a part of a line";
    provider.excludeParagraphTag = true;
    provider.setAttributedString(boldText(u"a\nb"));
    EXPECT_EQ(pasteboard.data(HTML)->find("<p"), std::string::npos);
}

TEST_F(ClipboardDataProviderTest, ClipboardPlaceholdersReadTheUsersContent) {
    pasteboard.copyFromProgram({{String, "plain"}, {RTF, "{\\rtf1 rich}"}});
    EXPECT_EQ(userPasteboard.string(), u"plain");
    expand(u"expansion");
    EXPECT_EQ(userPasteboard.string(), u"plain");
    EXPECT_EQ(userPasteboard.data(RTF), "{\\rtf1 rich}");
    EXPECT_THAT(userPasteboard.types(), ElementsAre(String, RTF));
    pasteboard.copyFromProgram(u"newer");
    EXPECT_EQ(userPasteboard.string(), u"newer");
}

TEST(ClipboardBackup, WritesEverythingBack) {
    SimulatedPasteboard pasteboard;
    SimulatedRunLoop loop;
    ClipboardBackup backup(pasteboard, loop);
    backup.backup();
    EXPECT_FALSE(backup.hasData()) << "nothing was there";

    pasteboard.copyFromProgram({{String, "text"}, {"image/png", "\x89PNG"}});
    backup.backup();
    ClipboardUtils::setAttributedString(pasteboard, boldText(u"bold"));
    EXPECT_THAT(pasteboard.types(), ElementsAre(String, RTFD, RTF, HTML));
    EXPECT_EQ(pasteboard.string(), u"bold");
    backup.restoreAfterDelay();
    loop.advance(0.2);
    EXPECT_EQ(pasteboard.string(), u"bold");
    loop.advance(0.2);
    EXPECT_THAT(pasteboard.types(), ElementsAre(String, "image/png"));
    EXPECT_EQ(pasteboard.string(), u"text");
    EXPECT_FALSE(backup.hasData()) << "once is enough";
}

}  // namespace
}  // namespace plume
