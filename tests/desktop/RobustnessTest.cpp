// The whole program while the user does what users do: keeps things on the clipboard, holds keys, types on.
#include "tests/desktop/Robustness.h"

#include <csignal>
#include <ostream>
#include <vector>

#include "testing/rig/SelectionClients.h"

namespace plume::rig {

namespace {

class RobustnessInTarget : public Robustness, public testing::WithParamInterface<TargetKind> {
  protected:
    void expectText(TargetProgram& target, const std::string& expected, const std::string& what) {
        EXPECT_EQ(target.awaitText(expected, Milliseconds(5'000)), expected) << what << '\n' << log();
    }
};

constexpr TargetKind Targets[] = {TargetKind::GtkTextView, TargetKind::QtTextEdit, TargetKind::Xterm};

std::string targetName(const testing::TestParamInfo<TargetKind>& info) {
    return nameOf(info.param);
}

std::string nameOf(Way way) {
    return way == Way::Typed ? "typed" : "pasted";
}

// ---- The clipboard ----

class ClipboardInTarget : public RobustnessInTarget {
  protected:
    // An image of 5 MB, whose bytes would show if pieces of it were lost, doubled or swapped.
    static std::string image() {
        std::string bytes(5'000'000, '\0');
        std::uint32_t state = 1;
        for (char& byte : bytes) {
            state = state * 1'664'525 + 1'013'904'223;
            byte = static_cast<char>(state >> 24);
        }
        return bytes;
    }

    static SelectionOffer copiedByUser() {
        return {{"UTF8_STRING", {"UTF8_STRING", 8, "What the user copied — 日本"}},
                {"text/html", {"text/html", 8, "<p>What the <b>user</b> copied</p>"}},
                {"image/png", {"image/png", 8, image()}},
                {"STRING", {"STRING", 8, "What the user copied"}},
                {"TEXT", {"COMPOUND_TEXT", 8, "What the user copied"}},
                {"LENGTH", {"INTEGER", 32, std::string("\x06\0\0\0", 4)}},
                {"x-words", {"CARDINAL", 16, std::string("\1\2\3\4", 4)}},
                {"x-empty", {"x-empty", 8, ""}}};
    }

    // What a program that is not in front finds on the clipboard, once it is the user's again.
    static void expectOnClipboard(const SelectionOffer& offer) {
        SelectionRequestor reader(rig_->server().display());
        const auto textIsBack = [&] {
            reader.targets("CLIPBOARD");
            return reader.request("CLIPBOARD", "UTF8_STRING") == offer.front().second;
        };
        EXPECT_TRUE(waitUntil(textIsBack, Milliseconds(10'000))) << log();
        for (const auto& [target, data] : offer) {
            const auto read = reader.request("CLIPBOARD", target);
            ASSERT_TRUE(read.has_value()) << target;
            EXPECT_EQ(read->type, data.type);
            EXPECT_TRUE(read->bytes == data.bytes) << target << ": " << read->bytes.size() << " bytes";
        }
    }

    void pasteOneByOne(TargetProgram& target, int count) {
        const Sample samples[] = {ShortMixed, LongAscii, ShortAscii, LongMixed};
        for (int i = 0; i < count; ++i) {
            const Sample& sample = samples[i % 4];
            target.clear();
            rig_->keyboard().type(sample.abbreviation);
            expectText(target, sample.content, "paste " + std::to_string(i));
        }
    }

    void pasteBackToBack(TargetProgram& target, int count) {
        target.clear();
        rig_->keyboard().type(times(count, ShortMixed.abbreviation + ShortAscii.abbreviation));
        expectText(target, times(count, ShortMixed.content + ShortAscii.content), "back to back");
    }
};

TEST_P(ClipboardInTarget, IsTheUsersAgainAfterPastes) {
    startPlume(Way::Pasted);
    const auto target = rig_->startTarget(GetParam());
    const ForeignOwner user(rig_->server().display(), copiedByUser());
    pasteOneByOne(*target, 10 * rounds());
    expectOnClipboard(copiedByUser());
    pasteBackToBack(*target, 5 * rounds());
    expectOnClipboard(copiedByUser());
    pasteOneByOne(*target, 1);  // from what was restored, not from what was copied
    expectOnClipboard(copiedByUser());
}

TEST_P(ClipboardInTarget, StaysEmpty) {
    startPlume(Way::Pasted);
    const auto target = rig_->startTarget(GetParam());
    rig_->client().emptySelection("CLIPBOARD");
    pasteOneByOne(*target, 3);
    pasteBackToBack(*target, 2);
    SelectionRequestor reader(rig_->server().display());
    EXPECT_TRUE(waitUntil([&] { return reader.readAll("CLIPBOARD").empty(); }, Milliseconds(10'000))) << log();
}

// Ended by a signal, when the clipboard is the user's again or while the expansion still stands there.
struct End {
    int signal;
    bool inTheMiddle;
};

class ClipboardAfterTheEnd : public ClipboardInTarget {};

TEST_P(ClipboardAfterTheEnd, IsTheUsersUntilSomethingNewIsCopied) {
    for (const auto& [signal, inTheMiddle] : {End{SIGKILL, false}, End{SIGKILL, true}, End{SIGTERM, false}}) {
        SCOPED_TRACE(std::to_string(signal) + (inTheMiddle ? ", in the middle" : ""));
        startPlume(Way::Pasted);
        const auto target = rig_->startTarget(GetParam());
        const ForeignOwner user(rig_->server().display(), copiedByUser());
        if (inTheMiddle) kill(target->pid(), SIGSTOP);
        rig_->keyboard().type(LongAscii.abbreviation);
        const auto isPlumes = [&] { return rig_->client().selectionOwner("CLIPBOARD") != user.window(); };
        ASSERT_TRUE(waitUntil(isPlumes, Milliseconds(5'000)));
        if (!inTheMiddle) expectOnClipboard(copiedByUser());
        kill(plume_->process().pid(), signal);
        ASSERT_TRUE(plume_->process().waitForExit(Milliseconds(5'000)));
        kill(target->pid(), SIGCONT);
        expectOnClipboard(copiedByUser());

        const xcb_window_t heir = rig_->client().selectionOwner("CLIPBOARD");
        EXPECT_NE(heir, 0U);
        rig_->client().emptySelection("CLIPBOARD");
        EXPECT_TRUE(waitUntil([&] { return !rig_->client().exists(heir); }, Milliseconds(5'000)));
    }
}

INSTANTIATE_TEST_SUITE_P(Targets, ClipboardAfterTheEnd, testing::Values(TargetKind::GtkTextView), targetName);

INSTANTIATE_TEST_SUITE_P(Targets, ClipboardInTarget, testing::ValuesIn(Targets), targetName);

// Stopped while it gets a paste: the clipboard is the user's again meanwhile.
class StoppedTarget : public ClipboardInTarget {
  protected:
    static SelectionOffer text() { return {{"UTF8_STRING", {"UTF8_STRING", 8, "What the user copied"}}}; }

    static void pasteInto(TargetProgram& stopped, const std::string& typed) {
        const ForeignOwner user(rig_->server().display(), text());
        kill(stopped.pid(), SIGSTOP);
        rig_->keyboard().type(typed);
        const auto isPlumes = [&] { return rig_->client().selectionOwner("CLIPBOARD") != user.window(); };
        ASSERT_TRUE(waitUntil(isPlumes, Milliseconds(5'000)));
        expectOnClipboard(text());
    }
};

TEST_P(StoppedTarget, GetsThePasteWhenItGoesOnAndThenTheKeys) {
    startPlume(Way::Pasted);
    const auto target = rig_->startTarget(GetParam());
    pasteInto(*target, LongAscii.abbreviation + "xyz");
    EXPECT_FALSE(target->awaitPaste(Milliseconds(2'000))) << "longer than keys wait otherwise";
    kill(target->pid(), SIGCONT);
    expectText(*target, LongAscii.content + "xyz", "after four seconds");
    expectOnClipboard(text());
}

TEST_P(StoppedTarget, HoldsNoKeysBackFromAnother) {
    startPlume(Way::Pasted);
    const auto other = rig_->startTarget(TargetKind::QtTextEdit);
    const auto target = rig_->startTarget(GetParam());
    pasteInto(*target, LongAscii.abbreviation);
    other->activate();
    rig_->keyboard().type("at once");
    EXPECT_EQ(other->awaitText("at once", Milliseconds(1'000)), "at once");
    kill(target->pid(), SIGCONT);
    expectText(*target, LongAscii.content, "in the background");
}

INSTANTIATE_TEST_SUITE_P(Targets, StoppedTarget, testing::Values(TargetKind::GtkTextView, TargetKind::QtTextEdit),
                         targetName);

// ---- Keys that are held ----

class HeldKeysInTarget : public RobustnessInTarget {
  protected:
    // The text is exact; behind it, and nowhere else, the key may have repeated while it was held.
    void expectTextAndRepeats(TargetProgram& target, const std::string& expected, char key) {
        rig_->keyboard().sync();
        EXPECT_TRUE(waitUntil([] { return isKeyboardAtRest(); }, Milliseconds(5'000)));
        waitUntil([&] { return target.text().size() >= expected.size(); }, Milliseconds(5'000));
        rig_->keyboard().type(" ok");
        waitUntil([&] { return target.text().ends_with(" ok"); }, Milliseconds(5'000));
        const std::string text = target.text();
        const std::size_t repeats = text.size() - std::min(text.size(), expected.size() + 3);
        EXPECT_EQ(text, expected + std::string(repeats, key) + " ok") << log();
    }

    // The last key of the abbreviation stays down: the expansion is whole, and repeats come behind it.
    void holdTrigger(TargetProgram& target, const Sample& sample) {
        target.clear();
        rig_->keyboard().type(sample.abbreviation.substr(0, 2));
        const char last = sample.abbreviation.back();
        const int keycode = rig_->keyboard().keycodeOf(static_cast<char32_t>(last));
        rig_->keyboard().press(keycode);
        rig_->keyboard().sync();
        poll(nullptr, 0, 1'000);
        rig_->keyboard().release(keycode);
        expectTextAndRepeats(target, sample.content, last);
    }

    // Shift is down for the trigger and stays down.
    void holdShift(TargetProgram& target, const Sample& sample) {
        target.clear();
        rig_->keyboard().type(sample.abbreviation.substr(0, 2));
        rig_->keyboard().press(Key::LeftShift);
        rig_->keyboard().tap(static_cast<Key>(rig_->keyboard().keycodeOf(U'!')));
        rig_->keyboard().sync();
        expectText(target, sample.content, "Shift held");
        rig_->keyboard().tap(static_cast<Key>(rig_->keyboard().keycodeOf(U'a')));
        rig_->keyboard().release(Key::LeftShift);
        rig_->keyboard().sync();
        expectTextAndRepeats(target, sample.content + "A", 'A');
    }

    // The letter before the trigger is still down when the expansion comes, and goes up afterwards.
    void holdPrevious(TargetProgram& target, const Sample& sample) {
        target.clear();
        std::vector<int> keys;
        for (const char character : sample.abbreviation) {
            keys.push_back(rig_->keyboard().keycodeOf(static_cast<char32_t>(character)));
            rig_->keyboard().press(keys.back());
        }
        rig_->keyboard().sync();
        waitUntil([&] { return target.text().size() >= sample.content.size(); }, Milliseconds(5'000));
        for (const int key : keys) rig_->keyboard().release(key);
        expectTextAndRepeats(target, sample.content, sample.abbreviation.back());
    }
};

TEST_P(HeldKeysInTarget, DoNotReachIntoTheExpansion) {
    const auto target = rig_->startTarget(GetParam());
    for (const Way way : {Way::Typed, Way::Pasted}) {
        SCOPED_TRACE(nameOf(way));
        startPlume(way);
        for (int round = 0; round < rounds(); ++round) {
            holdTrigger(*target, way == Way::Typed ? LongMixed : LongAscii);
            holdShift(*target, Shifted);
            holdPrevious(*target, ShortMixed);
            holdPrevious(*target, LongAscii);
        }
    }
}

INSTANTIATE_TEST_SUITE_P(Targets, HeldKeysInTarget, testing::ValuesIn(Targets), targetName);

// ---- The user types on ----

class TypingOnInTarget : public RobustnessInTarget {
  protected:
    // Something before, the abbreviation, and text right behind it, in which the next abbreviation comes.
    void typeOn(TargetProgram& target, const Sample& sample, Milliseconds gap) {
        target.clear();
        rig_->keyboard().typeRollingOver("so " + sample.abbreviation + "and on " + sample.abbreviation + ", and", gap);
        expectText(target, "so " + sample.content + "and on " + sample.content + ", and",
                   "at " + std::to_string(gap.count()) + " ms a key");
    }

    void typeOnBehindWords(TargetProgram& target, const Sample& word, Milliseconds gap) {
        target.clear();
        rig_->keyboard().typeRollingOver(
            "so " + word.abbreviation + " and, " + word.abbreviation + ",on " + word.abbreviation + ".", gap);
        expectText(target, "so " + word.content + " and, " + word.content + ",on " + word.content + ".",
                   "words at " + std::to_string(gap.count()) + " ms a key");
    }
};

TEST_P(TypingOnInTarget, LosesDoublesAndMisplacesNothing) {
    const auto target = rig_->startTarget(GetParam());
    for (const Way way : {Way::Typed, Way::Pasted}) {
        SCOPED_TRACE(nameOf(way));
        startPlume(way);
        for (int round = 0; round < rounds(); ++round) {
            for (const Sample& sample : {ShortAscii, LongAscii, ShortMixed, LongMixed}) {
                typeOn(*target, sample, Milliseconds(1));
            }
            for (const Sample& word : {Word, LongWord}) typeOnBehindWords(*target, word, Milliseconds(1));
            typeOn(*target, LongMixed, Milliseconds(15));
            typeOnBehindWords(*target, Word, Milliseconds(15));
            typeOn(*target, LongMixed, Milliseconds(0));
        }
    }
}

INSTANTIATE_TEST_SUITE_P(Targets, TypingOnInTarget, testing::ValuesIn(Targets), targetName);

}  // namespace

}  // namespace plume::rig
