#include "app/editor/ScriptRunPanel.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <QVBoxLayout>
#include <deque>

#include "Foundation/Strings.h"
#include "library/SnippetGroup.h"
#include "ports/simulated/SimulatedRunLoop.h"
#include "tests/app/windows/WindowsSupport.h"

namespace plume {
namespace {

using namespace test;
using ::testing::ElementsAre;
using ::testing::HasSubstr;
using ::testing::Not;

// Writes what the test wants.
class StandInRunner final : public TrialRunner {
  public:
    StandInRunner(ScriptOutput written, std::vector<std::string>& scripts)
        : written_(std::move(written)), scripts_(scripts) {}
    ScriptOutput run(std::u16string_view script, bool /*isAppleScript*/) override {
        scripts_.push_back(toUtf8(script));
        if (isStopped_) written_.end = ScriptEnd::Stopped;
        return written_;
    }
    void stop() override { isStopped_ = true; }

  private:
    ScriptOutput written_;
    std::vector<std::string>& scripts_;
    bool isStopped_ = false;
};

class ScriptRunPanelTest : public ::testing::Test {
  protected:
    struct Task {
        std::function<void()> work;
        std::function<void()> done;
    };

    ScriptRunPanelTest() : panel(new ScriptRunPanel(services())) {
        auto* layout = new QVBoxLayout(&window);
        layout->addWidget(panel);
        window.resize(40 * window.fontMetrics().height(), 20 * window.fontMetrics().height());
        window.show();
        activate(window);
        show(ContentType::ShellScript);
    }
    ScriptRunServices services() {
        return {.loop = loop,
                .groups = [this]() -> const SnippetGroups& { return groups; },
                .readClipboard =
                    [this](auto told) {
                        ++clipboardReads;
                        loop.perform([told] { told(u"copied"); });
                    },
                .inBackground =
                    [this](auto work, auto done) {
                        tasks.push_back({work, done});
                    },
                .makeRunner = [this] { return std::make_shared<StandInRunner>(written, scripts); },
                .numberLocale = "en_US"};
    }
    void show(ContentType type) {
        snippet = std::make_shared<Snippet>(u"abc", u"stored");
        snippet->setContentType(type);
        panel->setScript(snippet, [this] { return text; });
    }
    // The script ends, so long after it began.
    void endAfter(double seconds) {
        loop.advance(seconds);
        const Task task = tasks.front();
        tasks.pop_front();
        task.work();
        task.done();
        QCoreApplication::processEvents();
    }
    std::string run(double seconds = 0) {
        click(window, QStringLiteral("Run Now"));
        loop.runReady();
        endAfter(seconds);
        return textOf(window);
    }
    bool canClick(const char* name) { return find<QAbstractButton>(window, QString::fromLatin1(name)).isEnabled(); }
    std::string output() {
        return find<QPlainTextEdit>(window, QStringLiteral("Output of the script")).toPlainText().toStdString();
    }

    SimulatedRunLoop loop;
    SnippetGroups groups;
    std::u16string text = u"echo";
    ScriptOutput written;
    std::vector<std::string> scripts;
    std::deque<Task> tasks;
    int clipboardReads = 0;
    std::shared_ptr<Snippet> snippet;
    QWidget window;
    ScriptRunPanel* panel;
};

TEST_F(ScriptRunPanelTest, ShowsWhatWasWrittenAndHowLongItTook) {
    EXPECT_THAT(textOf(window), HasSubstr("ended after 30 seconds"));
    written.output = "one\ntwo\n";
    EXPECT_THAT(run(1.4), HasSubstr("Finished after 1.4 seconds."));
    EXPECT_EQ(output(), "one\ntwo\n");
    EXPECT_THAT(scripts, ElementsAre("echo"));
    EXPECT_EQ(clipboardReads, 0);
    text = u"other";
    EXPECT_THAT(run(), HasSubstr("Finished after 0.0 seconds."));
    EXPECT_THAT(scripts, ElementsAre("echo", "other"));
    takePicture(window, QStringLiteral("ScriptRunFinished"));
}

TEST_F(ScriptRunPanelTest, ErrorsAreNamedAndColoured) {
    written.output = "some";
    written.error = "line 1: what?";
    written.failed = true;
    EXPECT_THAT(run(), HasSubstr("says that it failed, after 0.0 seconds."));
    EXPECT_EQ(output(), "some\nErrors:\nline 1: what?");
    auto& view = find<QPlainTextEdit>(window, QStringLiteral("Output of the script"));
    QTextCursor end = view.textCursor();
    end.movePosition(QTextCursor::End);
    EXPECT_NE(end.charFormat().foreground().color(), view.palette().color(QPalette::Text));
    EXPECT_THAT(textOf(window), Not(HasSubstr("errors are typed")));
    takePicture(window, QStringLiteral("ScriptRunErrors"));
    written.output.clear();
    EXPECT_THAT(run(), HasSubstr("the errors are typed"));
    EXPECT_EQ(output(), "Errors:\nline 1: what?");
}

TEST_F(ScriptRunPanelTest, IsExpandedFirst) {
    text = u"echo 【clipboard】 【field:name value:Ada】";
    EXPECT_THAT(run(), HasSubstr("Fields had the values"));
    EXPECT_THAT(scripts, ElementsAre("echo copied Ada"));
}

TEST_F(ScriptRunPanelTest, TellsHowLongItRunsAndCanBeCancelled) {
    click(window, QStringLiteral("Run Now"));
    EXPECT_THAT(textOf(window), HasSubstr("Running for 0 of at most 30 seconds."));
    EXPECT_FALSE(canClick("Run Now"));
    loop.advance(7.5);
    EXPECT_THAT(textOf(window), HasSubstr("Running for 7 of at most 30 seconds."));
    takePicture(window, QStringLiteral("ScriptRunRunning"));
    written.output = "until then";
    click(window, QStringLiteral("Cancel"));
    EXPECT_THAT(textOf(window), HasSubstr("Cancelling"));
    endAfter(0.5);
    EXPECT_THAT(textOf(window), HasSubstr("Cancelled after 8.0 seconds."));
    EXPECT_TRUE(canClick("Run Now"));
    EXPECT_FALSE(canClick("Cancel"));
    EXPECT_FALSE(loop.nextDue());
}

TEST_F(ScriptRunPanelTest, TheKeyboardStaysWithTheButtonThatCanBePressed) {
    auto& runNow = find<QAbstractButton>(window, QStringLiteral("Run Now"));
    runNow.setFocus();
    QTest::keyClick(&runNow, Qt::Key_Space);
    EXPECT_EQ(window.focusWidget(), &find<QAbstractButton>(window, QStringLiteral("Cancel")));
    endAfter(0);
    EXPECT_EQ(window.focusWidget(), &runNow);
}

struct EndCase {
    ScriptEnd end;
    const char* sentence;
};

TEST_F(ScriptRunPanelTest, TellsWhyItEnded) {
    for (const auto& [end, sentence] : {EndCase{ScriptEnd::TimeLimit, "Ended at the time limit of 30 seconds."},
                                        EndCase{ScriptEnd::OutputLimit, "because it wrote too much."},
                                        EndCase{ScriptEnd::NotStarted, "could not be run: no memory."},
                                        EndCase{ScriptEnd::Finished, "The script wrote nothing."}}) {
        written.end = end;
        written.problem = "no memory";
        EXPECT_THAT(run(30), HasSubstr(sentence));
    }
}

TEST_F(ScriptRunPanelTest, HugeOutputIsCutWithAWord) {
    written.output = std::string(1'050'000, 'x');
    EXPECT_THAT(run(), HasSubstr("1,000,000 more characters are not shown."));
    EXPECT_EQ(output().size(), 50'000U);
    takePicture(window, QStringLiteral("ScriptRunHuge"));
}

TEST_F(ScriptRunPanelTest, AppleScriptCannotRunHere) {
    show(ContentType::AppleScript);
    EXPECT_THAT(textOf(window), HasSubstr("AppleScript cannot run on this system."));
    EXPECT_FALSE(canClick("Run Now"));
    show(ContentType::PlainText);
    EXPECT_FALSE(canClick("Run Now"));
    panel->setScript(nullptr, nullptr);
    EXPECT_FALSE(canClick("Run Now"));
    show(ContentType::ShellScript);
    EXPECT_TRUE(canClick("Run Now"));
}

TEST_F(ScriptRunPanelTest, ScriptsThatNeverEndAreNotRun) {
    groups.push_back(SnippetGroup::make());
    groups[0]->addItem(std::make_shared<Snippet>(u"a", u"【snippet:b】【snippet:b】"));
    groups[0]->addItem(std::make_shared<Snippet>(u"b", u"【snippet:a】【snippet:a】"));
    text = u"【snippet:a】";
    click(window, QStringLiteral("Run Now"));
    loop.runReady();
    EXPECT_THAT(textOf(window), HasSubstr("placeholders cannot be replaced"));
    EXPECT_TRUE(canClick("Run Now"));
    EXPECT_TRUE(tasks.empty());
}

// ---- What ends a run ----

TEST_F(ScriptRunPanelTest, ClosingTheWindowCancels) {
    click(window, QStringLiteral("Run Now"));
    window.close();
    endAfter(0);
    window.show();
    EXPECT_THAT(textOf(window), HasSubstr("Cancelled after"));
}

TEST_F(ScriptRunPanelTest, NothingIsShownOfAnotherSnippet) {
    written.output = "first";
    click(window, QStringLiteral("Run Now"));
    show(ContentType::ShellScript);
    EXPECT_FALSE(panel->isRunning());
    endAfter(1);
    EXPECT_EQ(output(), "");
    EXPECT_THAT(textOf(window), HasSubstr("is ended after 30 seconds"));
}

TEST_F(ScriptRunPanelTest, MayGoWhileTheClipboardIsReadOrTheScriptRuns) {
    text = u"【clipboard】";
    click(window, QStringLiteral("Run Now"));
    click(window, QStringLiteral("Cancel"));
    loop.runReady();
    EXPECT_TRUE(tasks.empty());
    EXPECT_THAT(textOf(window), HasSubstr("Cancelled."));
    click(window, QStringLiteral("Run Now"));
    loop.runReady();
    click(window, QStringLiteral("Cancel"));
    delete panel;
    endAfter(1);
    EXPECT_THAT(scripts, ElementsAre("copied"));
}

}  // namespace
}  // namespace plume
