// What the composition does that no scenario shows: a program without windows.
#include "app/Composition.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "library/SettingsFile.h"
#include "ports/posix/PosixProcessLauncher.h"
#include "ports/simulated/SimulatedDesktop.h"

namespace plume {

namespace {

using testing::ElementsAre;
using testing::HasSubstr;

class WindowlessProgram : public testing::Test {
  protected:
    WindowlessProgram() {
        desktop_.activate(u"org.example.editor");
        program_.loadPreferences();
        program_.start();
        desktop_.runLoop().runReady();
    }
    void add(const std::u16string& content) {
        group_->addItem(std::make_shared<Snippet>(u"sig", content));
        program_.setSnippetGroups({group_});
    }
    std::u16string typed(std::u16string_view text) {
        for (const char16_t character : text) desktop_.typeCharacter({&character, 1});
        desktop_.runLoop().advance(1);
        return desktop_.front()->field().text();
    }

    SimulatedDesktop desktop_;
    PosixProcessLauncher launcher_;
    // Control+J, for a window that there is not.
    std::shared_ptr<const UserDefaults> settings_ =
        SettingsFile::read(R"({"suggestAbbreviationsHotKey": 8589934630})", "settings").value();
    std::vector<std::string> told_;
    std::vector<std::string> logged_;
    std::shared_ptr<SnippetGroup> group_ = SnippetGroup::make();
    Composition program_{{desktop_.keyboardTap(), desktop_.mouseTap(), desktop_.poster(), desktop_.pasteboard(),
                          desktop_.processManager(), desktop_.inputSources(), desktop_.accessibility(),
                          desktop_.secureInput(), desktop_.systemHotKeys(), desktop_.sounds(), desktop_.notices(),
                          launcher_, desktop_.runLoop(), desktop_.runLoop()},
                         {*settings_, [this](const std::string& message) { told_.push_back(message); },
                          [this](const std::string& line) { logged_.push_back(line); }}};
};

}  // namespace

TEST_F(WindowlessProgram, TellsThatASnippetNeedsAForm) {
    add(u"Dear \u3010field:Name\u3011");
    EXPECT_EQ(typed(u"sig"), u"sig");
    EXPECT_THAT(told_, ElementsAre(HasSubstr("\"sig\"")));
}

TEST_F(WindowlessProgram, LeavesDigitsAndReturnAloneWhenSeveralMatch) {
    add(u"first");
    add(u"second");
    EXPECT_EQ(typed(u"sig"), u"sig");
    EXPECT_EQ(typed(u"1\n"), u"sig1\n");
    EXPECT_THAT(told_, ElementsAre(HasSubstr("\"sig\"")));
}

TEST_F(WindowlessProgram, LeavesAHotKeyWithNothingToDoToThePrograms) {
    desktop_.pressAndRelease(KeyCode::J, KeyModifier::Control);
    EXPECT_EQ(desktop_.front()->events().size(), 4U);
    EXPECT_THAT(logged_, ElementsAre(HasSubstr("suggestAbbreviationsHotKey")));
}

}  // namespace plume
