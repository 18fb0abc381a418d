#include "app/preferences/HotKeyRecorder.h"

#include <gtest/gtest.h>

#include <QLabel>
#include <memory>

#include "tests/app/preferences/PreferencesSupport.h"

namespace plume {
namespace {

class HotKeyRecorderTest : public testing::Test, protected test::PreferencesWorld {
  protected:
    using HotKey = std::optional<GeneralHotKey>;

    HotKeyRecorderTest() {
        QObject::connect(recorder.get(), &HotKeyRecorder::edited,
                         [this](const HotKey& hotKey) { edits.push_back(hotKey); });
        recorder->setName("Undo");
        test::bringUp(*recorder);
    }

    QLineEdit& field() { return *recorder->findChild<QLineEdit*>(); }
    void begin() { QTest::keyClick(&field(), Qt::Key_Return); }
    QString words() { return recorder->findChild<QLabel*>()->text(); }
    // A second recording, begun by a click.
    void record(const GeneralHotKey& hotKey) {
        QTest::mouseClick(&field(), Qt::LeftButton);
        pressed(hotKey);
    }

    const PreferencesServices around = services();
    std::unique_ptr<HotKeyRecorder> recorder =
        std::make_unique<HotKeyRecorder>(around, [](const GeneralHotKey& hotKey) {
            return hotKey.keyCode == KeyCode::F5 ? QString("Quick search") : QString();
        });
    std::vector<HotKey> edits;
};

constexpr GeneralHotKey CtrlAltK{KeyModifier::Control | KeyModifier::Option, KeyCode::K};

TEST_F(HotKeyRecorderTest, RecordsKeysWithModifiersAndModifiersAlone) {
    begin();
    EXPECT_TRUE(recorder->isRecording());
    EXPECT_EQ(field().placeholderText(), "Press keys… Escape leaves it as it is");
    pressed(CtrlAltK);
    EXPECT_EQ(field().text(), "Ctrl+Alt+K");
    const GeneralHotKey modifiers{KeyModifier::Shift | KeyModifier::Command, KeyCode::None};
    record(modifiers);
    EXPECT_EQ(field().text(), "Shift+Super");
    record({{}, KeyCode::F1});
    EXPECT_EQ(field().text(), "Key 122") << "a key without a name has its number";
    EXPECT_EQ(edits, (std::vector<HotKey>{CtrlAltK, modifiers, GeneralHotKey{{}, KeyCode::F1}}));
    EXPECT_EQ(ended, 3);
}

TEST_F(HotKeyRecorderTest, RefusesWhatWouldBeTyped) {
    begin();
    for (const KeyCode key : {KeyCode::K, KeyCode::Space, KeyCode::Return, KeyCode::Keypad5, KeyCode::Tab}) {
        for (const KeyModifiers modifiers : {KeyModifiers(), KeyModifiers(KeyModifier::Shift)}) {
            pressed({modifiers, key});
            EXPECT_TRUE(words().contains("would be typed all the time")) << numberOf(key);
        }
    }
    EXPECT_TRUE(recorder->isRecording()) << "another one can be pressed at once";
    pressed(CtrlAltK);
    EXPECT_EQ(words(), "");
    EXPECT_EQ(edits, std::vector<HotKey>{CtrlAltK});
}

TEST_F(HotKeyRecorderTest, RefusesWhatPlumeOrTheDesktopHas) {
    begin();
    pressed({KeyModifier::Control, KeyCode::F5});
    EXPECT_EQ(words(), "Ctrl+F5 is the hot key of “Quick search” already.");
    desktopsAnswer = Error{"The desktop locks the screen by it."};
    pressed(CtrlAltK);
    EXPECT_EQ(words(), "The desktop locks the screen by it.");
    EXPECT_EQ(field().text(), "");
    EXPECT_TRUE(edits.empty());
    EXPECT_EQ(ended, 1);
}

TEST_F(HotKeyRecorderTest, EscapeLeavesItAndBackspaceClearsIt) {
    recorder->setHotKey(CtrlAltK);
    record({{}, KeyCode::Escape});
    EXPECT_EQ(field().text(), "Ctrl+Alt+K");
    record({{}, KeyCode::Delete});
    EXPECT_EQ(field().text(), "");
    recorder->setHotKey(CtrlAltK);
    QTest::keyClick(&field(), Qt::Key_Delete);
    EXPECT_EQ(edits, (std::vector<HotKey>{std::nullopt, std::nullopt}));
    EXPECT_EQ(std::pair(recordings, ended), std::pair(2, 2));
}

TEST_F(HotKeyRecorderTest, EndsWhenNothingComes) {
    begin();
    recorder->findChild<QTimer*>()->start(0);
    EXPECT_TRUE(QTest::qWaitFor([this] { return !recorder->isRecording(); }));
    EXPECT_TRUE(words().startsWith("Nothing was heard."));
    EXPECT_EQ(ended, 1);
}

TEST_F(HotKeyRecorderTest, EndsOnceHoweverItEnds) {
    begin();
    field().clearFocus();
    EXPECT_EQ(ended, 1);
    pressed(CtrlAltK);
    EXPECT_TRUE(edits.empty()) << "a key that comes late is no hot key";
    field().setFocus();
    begin();
    QTest::keyClick(&field(), Qt::Key_Escape);
    EXPECT_EQ(ended, 2) << "also by a key that Plume does not hear";
    begin();
    const auto late = pressed;
    recorder.reset();
    EXPECT_EQ(ended, 3);
    late(CtrlAltK);
}

TEST_F(HotKeyRecorderTest, AnAnswerThatComesLateIsDropped) {
    holdsAnswers = true;
    begin();
    pressed(CtrlAltK);
    const auto first = heldAnswer;
    begin();
    first({});
    EXPECT_TRUE(edits.empty());
    pressed({KeyModifier::Command, KeyCode::K});
    const auto second = heldAnswer;
    recorder.reset();
    second({});
    EXPECT_EQ(ended, 2);
}

}  // namespace
}  // namespace plume
