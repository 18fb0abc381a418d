// Shows how a snippet will come out.
//
// On the main thread; its window owns it.
#pragma once

#include <QFrame>
#include <memory>
#include <optional>
#include <string>

#include "app/ContentPreview.h"

class QLabel;
class QTextBrowser;

namespace plume {

class SnippetPreview final : public QFrame {
    Q_OBJECT
  public:
    SnippetPreview();

    // What the clipboard's placeholder gives from now on.
    void setClipboard(std::optional<std::u16string> text) { clipboard_ = std::move(text); }
    // Null shows nothing.
    void show(const std::shared_ptr<Snippet>& snippet, const SnippetGroups& groups);
    // What is shown, as a program would paste it; empty when nothing is.
    void copyToClipboard() const;

  private:
    void showContent(const ContentPreview& preview);

    std::optional<std::u16string> clipboard_;
    std::optional<ContentPreview> shown_;
    QTextBrowser* text_;
    QLabel* remark_;
};

}  // namespace plume
