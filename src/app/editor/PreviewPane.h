// What comes out of the selected snippet, who includes it, and a field in which abbreviations expand.
//
// On the main thread; the editor's window owns it. What it shows is made a moment after it is asked for, so that nobody
// who types or goes through the list waits for it.
#pragma once

#include <QTimer>
#include <QWidget>
#include <functional>
#include <memory>
#include <optional>
#include <string>

#include "library/LibraryArchive.h"

class QLabel;
class QPlainTextEdit;

namespace plume {

class SnippetPreview;

class PreviewPane final : public QWidget {
    Q_OBJECT
  public:
    struct Services {
        std::function<const SnippetGroups&()> groups;
        std::function<void(std::function<void(const std::optional<std::u16string>&)> told)> readClipboard;
        // Plume leaves its own windows alone otherwise.
        std::function<void(bool expands)> setExpandsInOwnWindows;
    };

    explicit PreviewPane(Services services);
    ~PreviewPane() override;

    void show(const std::shared_ptr<Snippet>& snippet);
    // It is being typed: once that has paused.
    void showSoon();

    // Chosen among those that include the one that is shown.
    Q_SIGNAL void chosen(const std::shared_ptr<Snippet>& snippet);

  protected:
    bool eventFilter(QObject* watched, QEvent* event) override;

  private:
    void showNow();
    void showWhereUsed();
    void follow(const QString& link);

    const Services services_;
    std::shared_ptr<Snippet> snippet_;
    std::vector<std::shared_ptr<Snippet>> users_;
    QTimer timer_;
    SnippetPreview* preview_;
    QLabel* whereUsed_;
    QPlainTextEdit* trial_;
};

}  // namespace plume
