#include "app/editor/ScriptEdit.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <QClipboard>
#include <QLineEdit>
#include <QScrollBar>
#include <QShortcut>
#include <QTextBlock>
#include <QTextLayout>
#include <QVBoxLayout>
#include <ctime>

#include "app/editor/LegibleColor.h"
#include "app/editor/ScriptHighlighter.h"
#include "app/qt/Text.h"
#include "tests/app/windows/WindowsSupport.h"

namespace plume {
namespace {

using namespace test;
using ::testing::ElementsAre;

class ScriptEditTest : public ::testing::Test {
  protected:
    ScriptEditTest() {
        auto* layout = new QVBoxLayout(&window);
        layout->addWidget(before);
        layout->addWidget(edit);
        layout->addWidget(behind);
        QObject::connect(edit, &ScriptEdit::edited, &window, [this] { ++edits; });
        window.resize(40 * window.fontMetrics().height(), 30 * window.fontMetrics().height());
        window.show();
        activate(window);
        edit->setFocus();
    }
    void set(const std::u16string& text) { edit->setContent(AttributedString(text)); }
    std::string text() const { return toUtf8(edit->content().string()); }
    void press(Qt::Key key, Qt::KeyboardModifiers modifiers = Qt::NoModifier) {
        QTest::keyClick(edit, key, modifiers);
        QCoreApplication::processEvents();
    }
    void select(int from, int to) {
        QTextCursor cursor = edit->textCursor();
        cursor.setPosition(from);
        cursor.setPosition(to, QTextCursor::KeepAnchor);
        edit->setTextCursor(cursor);
    }
    QWidget* focused() const { return window.focusWidget(); }

    QWidget window;
    QLineEdit* before = new QLineEdit;
    ScriptEdit* edit = new ScriptEdit;
    QLineEdit* behind = new QLineEdit;
    int edits = 0;
};

// ---- The text ----

TEST_F(ScriptEditTest, WhatWasSetComesBackUntilItIsChanged) {
    const std::u16string odd = u"a\r\nb\u2028c\u00A0d\u2029e\rf";
    set(odd);
    EXPECT_EQ(edit->content().string(), odd);
    select(0, 0);
    QTest::keyClicks(edit, QStringLiteral("x"));
    EXPECT_EQ(edit->content().string(), u"xa\nb\u2028c\u00A0d\ne\nf");
    set(odd);
    EXPECT_EQ(edit->content().string(), odd);
}

TEST_F(ScriptEditTest, TellsEachChangeOfTheUserOnce) {
    set(u"#!/bin/sh\necho");
    setColorScheme(true);
    setColorScheme(false);
    edit->setAppleScript(true);
    QTest::qWait(1);
    EXPECT_EQ(edits, 0);
    QTest::keyClicks(edit, QStringLiteral("if"));
    EXPECT_EQ(edits, 2);
    edit->insertPlaceholder(u"date");
    press(Qt::Key_Return);
    press(Qt::Key_Right);
    EXPECT_EQ(edits, 4);
    EXPECT_EQ(text(), "if【date】\n#!/bin/sh\necho");
}

TEST_F(ScriptEditTest, TheCaretStaysWhereTheTextAroundItStays) {
    const auto caretAfter = [&](const std::u16string& from, int caret, const std::u16string& to) {
        set(from);
        select(caret, caret);
        set(to);
        return edit->textCursor().position();
    };
    EXPECT_EQ(caretAfter(u"one two three", 2, u"one 2 three"), 2);
    EXPECT_EQ(caretAfter(u"one two three", 10, u"one 2 three"), 8);
    EXPECT_EQ(caretAfter(u"one two three", 13, u"one two three"), 13);
    EXPECT_EQ(caretAfter(u"one two three", 6, u"one  three"), 4);
    EXPECT_EQ(caretAfter(u"aaaa", 4, u"aaa"), 3);
    EXPECT_EQ(caretAfter(u"one two three", 10, u"quite another"), 0);
    EXPECT_EQ(caretAfter(u"\U0001F600 abcdef", 5, u"\U0001F601 abcdef"), 5);
    EXPECT_EQ(text(), "\U0001F601 abcdef");
    EXPECT_EQ(edits, 0);
}

TEST_F(ScriptEditTest, TheClipboardKeepsWhatIsText) {
    set(u"a\u00A0b\nc");
    edit->selectAll();
    press(Qt::Key_C, Qt::ControlModifier);
    EXPECT_EQ(QGuiApplication::clipboard()->text(), QStringLiteral("a\u00A0b\nc"));
    QGuiApplication::clipboard()->setText(QStringLiteral("x\uFFFC\r\ny"));
    press(Qt::Key_V, Qt::ControlModifier);
    EXPECT_EQ(text(), "x\ny");
}

// ---- Keys ----

TEST_F(ScriptEditTest, TabWritesATabAndOthersLeave) {
    press(Qt::Key_Tab);
    EXPECT_EQ(text(), "\t");
    EXPECT_EQ(focused(), edit);
    press(Qt::Key_Tab, Qt::ControlModifier);
    EXPECT_EQ(focused(), behind);
    edit->setFocus();
    press(Qt::Key_Backtab, Qt::ControlModifier | Qt::ShiftModifier);
    EXPECT_EQ(focused(), before);
    edit->setFocus();
    press(Qt::Key_Escape);
    press(Qt::Key_Tab);
    EXPECT_EQ(focused(), behind);
    edit->setFocus();
    press(Qt::Key_Escape);
    press(Qt::Key_Shift, Qt::ShiftModifier);
    press(Qt::Key_Backtab, Qt::ShiftModifier);
    EXPECT_EQ(focused(), before);
    edit->setFocus();
    press(Qt::Key_Escape);
    QTest::keyClicks(edit, QStringLiteral("x"));
    press(Qt::Key_Tab);
    EXPECT_EQ(focused(), edit);
    EXPECT_EQ(text(), "\tx\t");
}

TEST_F(ScriptEditTest, WhoOnlyReadsLeavesWithTab) {
    edit->setReadOnly(true);
    press(Qt::Key_Tab);
    EXPECT_EQ(focused(), behind);
    EXPECT_EQ(text(), "");
}

TEST_F(ScriptEditTest, SelectedLinesAreShiftedTogether) {
    set(u"a\n\n  b\nc\nd");
    select(0, 7);
    press(Qt::Key_Tab);
    EXPECT_EQ(text(), "\ta\n\n\t  b\nc\nd");
    press(Qt::Key_Backtab, Qt::ShiftModifier);
    press(Qt::Key_Backtab, Qt::ShiftModifier);
    EXPECT_EQ(text(), "a\n\nb\nc\nd");
}

TEST_F(ScriptEditTest, LinesBeginBelowEachOther) {
    QTest::keyClicks(edit, QStringLiteral("if x; then"));
    press(Qt::Key_Return);
    QTest::keyClicks(edit, QStringLiteral("y"));
    press(Qt::Key_Enter, Qt::KeypadModifier);
    // Not the sign that breaks a line inside of a paragraph, which no shell knows.
    press(Qt::Key_Return, Qt::ShiftModifier);
    press(Qt::Key_Backtab, Qt::ShiftModifier);
    QTest::keyClicks(edit, QStringLiteral("fi"));
    EXPECT_EQ(text(), "if x; then\n\ty\n\t\nfi");
    select(3, 12);
    press(Qt::Key_Return);
    EXPECT_EQ(text(), "if \ny\n\t\nfi");
}

TEST_F(ScriptEditTest, UndoingIsLeftToTheWindow) {
    int undone = 0;
    const QShortcut shortcut(QKeySequence(QKeySequence::Undo), &window);
    QObject::connect(&shortcut, &QShortcut::activated, &window, [&] { ++undone; });
    QTest::keyClicks(edit, QStringLiteral("x"));
    press(Qt::Key_Z, Qt::ControlModifier);
    EXPECT_EQ(undone, 1);
    EXPECT_EQ(text(), "x");
}

// ---- How it looks ----

TEST_F(ScriptEditTest, LinesAreNumbered) {
    std::u16string lines;
    for (int i = 0; i < 5000; ++i) lines += u"echo\n";
    const auto left = [this] { return edit->viewport()->geometry().left(); };
    const int narrow = left();
    set(lines);
    EXPECT_GT(left(), narrow);
    edit->verticalScrollBar()->setValue(4321);
    QCoreApplication::processEvents();
    const auto visible = edit->visibleLines();
    EXPECT_EQ(visible.front().number, 4322);
    EXPECT_GE(visible.back().top + visible.back().height, edit->viewport()->height());
    for (const auto& line : visible) {
        const QTextCursor there = edit->cursorForPosition({0, line.top + line.height / 2});
        EXPECT_EQ(there.blockNumber() + 1, line.number);
    }
    set(u"");
    EXPECT_EQ(left(), narrow);
}

TEST_F(ScriptEditTest, BracketsAreShownInPairs) {
    const auto marked = [&](const std::u16string& script, int caret) {
        set(script);
        select(caret, caret);
        std::vector<int> places;
        for (const auto& mark : edit->extraSelections()) places.push_back(mark.cursor.selectionStart());
        return places;
    };
    EXPECT_THAT(marked(u"f(a(b)\n{c})", 1), ElementsAre(1, 10));
    EXPECT_THAT(marked(u"f(a(b)\n{c})", 11), ElementsAre(10, 1));
    EXPECT_THAT(marked(u"f(a(b)\n{c})", 6), ElementsAre(5, 3));
    EXPECT_THAT(marked(u"f(a(b)\n{c})", 8), ElementsAre(7, 9));
    EXPECT_THAT(marked(u"x) ( y", 2), ElementsAre());
    EXPECT_THAT(marked(u"x) ( y", 4), ElementsAre());
    EXPECT_THAT(marked(u"(" + std::u16string(100'000, u' ') + u")", 0), ElementsAre());
}

std::string colouredIn(const ScriptEdit& edit, int line) {
    std::string all;
    const QTextBlock block = edit.document()->findBlockByNumber(line);
    for (const auto& range : block.layout()->formats()) {
        all += block.text().mid(range.start, range.length).toStdString() + "|";
    }
    return all;
}

TEST_F(ScriptEditTest, AnotherFirstLineGivesAllLinesOtherColours) {
    set(u"#!/bin/sh\ndef f: 'if\nfi'");
    EXPECT_EQ(colouredIn(*edit, 2), "fi'|");
    select(7, 9);
    QTest::keyClicks(edit, QStringLiteral("python3"));
    EXPECT_EQ(colouredIn(*edit, 1), "def|'if|");
    EXPECT_EQ(colouredIn(*edit, 2), "'|");
    edit->setAppleScript(true);
    EXPECT_EQ(colouredIn(*edit, 1), "if|");
}

TEST_F(ScriptEditTest, ColoursCanBeReadOnEveryGround) {
    constexpr double Readable = 4.5;
    for (const bool isDark : {false, true}) {
        setColorScheme(isDark);
        const QPalette palette = QApplication::palette();
        const ScriptHighlighter highlighter(edit->document(), palette);
        for (int i = 0; i <= static_cast<int>(ScriptToken::Placeholder); ++i) {
            const QTextCharFormat& format = highlighter.formatOf(static_cast<ScriptToken>(i));
            const QColor ground = format.background().style() == Qt::NoBrush ? palette.color(QPalette::Base)
                                                                             : format.background().color();
            EXPECT_GE(contrastOf(format.foreground().color(), ground), Readable) << i << " dark: " << isDark;
        }
        EXPECT_GE(contrastOf(legibleColor(TextHue::Red, palette), palette.color(QPalette::Base)), Readable);
    }
    setColorScheme(false);
    EXPECT_NEAR(contrastOf(Qt::white, Qt::black), 21, 0.01);
    EXPECT_NEAR(contrastOf(Qt::red, Qt::red), 1, 0.01);
}

TEST_F(ScriptEditTest, ALongLineDelaysNoKey) {
    constexpr double Allowed = 0.5;  // seconds of the processor, without optimisation
    std::u16string line;
    while (line.size() < 50'000) line += u"if \"$x\" ${ 【y】 ";
    std::clock_t start = std::clock();
    const auto seconds = [&] { return static_cast<double>(std::clock() - start) / CLOCKS_PER_SEC; };
    set(line);
    QCoreApplication::processEvents();
    EXPECT_LT(seconds(), 2 * Allowed);
    for (const int place : {0, 25'000, 50'000}) {
        select(place, place);
        start = std::clock();
        QTest::keyClicks(edit, QStringLiteral("\""));
        QCoreApplication::processEvents();
        EXPECT_LT(seconds(), Allowed) << place;
        RecordProperty("seconds" + std::to_string(place), std::to_string(seconds()));
    }
}

TEST_F(ScriptEditTest, CanBeLookedAt) {
    set(u"#!/bin/sh\n# Greets whoever is named\nname=\"${1:-【field:name】}\"\nif [ -n \"$name\" ]; then\n"
        u"\tprintf 'Hello, %s\\n' \"$name\"\nelse\n\tcat <<END\nNobody's here\nEND\nfi\n");
    select(71, 71);
    takePicture(window, QStringLiteral("ScriptEdit"));
    EXPECT_FALSE(edit->accessibleName().isEmpty());
    EXPECT_TRUE(edit->accessibleDescription().contains(QStringLiteral("Escape and then Tab")));
}

}  // namespace
}  // namespace plume
