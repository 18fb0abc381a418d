// Runs the script that is being written, and shows what came out of it.
//
// On the main thread; the script runs on another one and is cancelled when the panel is hidden or goes. Nothing is
// delivered anywhere, and neither the script nor its output is kept.
#pragma once

#include <QWidget>
#include <functional>
#include <memory>
#include <optional>
#include <string>

#include "app/editor/ScriptTrial.h"
#include "platform/RunLoop.h"

class QLabel;
class QPlainTextEdit;
class QPushButton;

namespace plume {

struct ScriptRunServices {
    using Clipboard = std::optional<std::u16string>;

    // The main thread's; outlives the panel.
    RunLoop& loop;
    // The library, for snippets that the script includes.
    std::function<const SnippetGroups&()> groups;
    // Tells the text on the clipboard later, on the main thread.
    std::function<void(std::function<void(const Clipboard&)> told)> readClipboard;
    // `work` on another thread, then `done` on the main one.
    std::function<void(std::function<void()> work, std::function<void()> done)> inBackground;
    // Another one for each run.
    std::function<std::shared_ptr<TrialRunner>()> makeRunner;
    ScriptLimits limits = {};  // that these runners keep to
    bool canRunAppleScript = false;
    // The zone and locale of dates; whom it reports to, and its clipboard, are the panel's.
    ContentEnvironment environment = {};
    std::string numberLocale = {};
};

class ScriptRunPanel final : public QWidget {
    Q_OBJECT
  public:
    explicit ScriptRunPanel(ScriptRunServices services);
    ~ScriptRunPanel() override;

    // What is run from now on; `text` is asked when it is. Null: nothing can be run. What another snippet has written
    // is not shown any more.
    void setScript(const std::shared_ptr<Snippet>& snippet, std::function<std::u16string()> text);
    bool isRunning() const { return run_ != nullptr; }

    // Nothing while one runs.
    Q_SLOT void runNow();
    // What it has written until now is shown.
    Q_SLOT void cancel();

  protected:
    void hideEvent(QHideEvent* event) override;
    void changeEvent(QEvent* event) override;

  private:
    // From the click to the last output. Whoever is told of it later holds it weakly.
    struct Run {
        std::shared_ptr<ScriptTrial> trial;  // null while the clipboard is read
        std::shared_ptr<TrialRunner> runner;
        double start = 0;
        bool isCancelled = false;
        QStringList notes;
    };

    void makeLayout();
    void begin(const ScriptRunServices::Clipboard& clipboard);
    void runInBackground();
    void finish();
    void giveUp(const QString& status);
    void showRunning();
    void showIdle();
    void enableButtons();
    void showOutput();
    QString endInWords(const ScriptTrial::Ending& ending, double seconds) const;
    static QStringList notesOn(const ScriptTrial& trial);

    const ScriptRunServices services_;
    std::shared_ptr<Snippet> snippet_;
    std::function<std::u16string()> text_;
    std::shared_ptr<Run> run_;            // null: nothing runs
    std::shared_ptr<ScriptTrial> shown_;  // null: nothing has been run
    Timer tick_;

    QPushButton* runButton_;
    QPushButton* cancelButton_;
    QLabel* status_;
    QLabel* notes_;
    QPlainTextEdit* output_;
};

}  // namespace plume
