#include "app/search/SnippetPreview.h"

#include <QBoxLayout>
#include <QClipboard>
#include <QFontDatabase>
#include <QGuiApplication>
#include <QLabel>
#include <QMimeData>
#include <QTextBrowser>
#include <utility>

#include "Foundation/text/HTMLExport.h"
#include "app/TextOnPasteboard.h"
#include "app/qt/Labels.h"
#include "app/qt/Text.h"

namespace plume {

namespace {

// More is not seen without a long way down.
constexpr std::size_t MostShown = 4000;
constexpr std::size_t LongestExpanded = 200'000;

QString htmlOf(const AttributedString& text) {
    return QString::fromStdString(htmlFromAttributedString(text, defaultExcludedTags()));
}

}  // namespace

SnippetPreview::SnippetPreview() : text_(new QTextBrowser), remark_(makeHelpLabel({})) {
    setBackgroundRole(QPalette::Base);
    setAutoFillBackground(true);
    text_->setAccessibleName(tr("Preview of the selected snippet"));
    text_->setFocusPolicy(Qt::NoFocus);
    text_->setFrameShape(QFrame::NoFrame);
    text_->setOpenLinks(false);
    constexpr double Margin = 10;
    text_->document()->setDocumentMargin(Margin);
    auto* layout = new QVBoxLayout(this);
    layout->setContentsMargins({});
    layout->setSpacing(0);
    remark_->setContentsMargins(10, 6, 10, 0);
    layout->addWidget(remark_);
    layout->addWidget(text_);
}

void SnippetPreview::show(const std::shared_ptr<Snippet>& snippet, const SnippetGroups& groups) {
    shown_.reset();
    text_->clear();
    remark_->hide();
    if (!snippet || !snippet->hasContent()) return;
    if (snippet->contentLength() > LongestExpanded) {
        shown_ = ContentPreview{snippet->plainTextContent().value_or(u""), snippet->isScript()};
    } else {
        const TextOnPasteboard clipboard(clipboard_);
        ContentEnvironment environment;
        environment.pasteboard = &clipboard;
        shown_ = previewOf(snippet, groups, environment, {});
    }
    if (shown_) showContent(*shown_);
}

void SnippetPreview::showContent(const ContentPreview& preview) {
    const auto* rich = std::get_if<AttributedString>(&preview.content);
    const bool isShort = preview.text().size() <= MostShown;
    text_->setFont(preview.isScript ? QFontDatabase::systemFont(QFontDatabase::FixedFont) : font());
    if (rich && isShort) {
        text_->setHtml(htmlOf(*rich));
    } else {
        const QString text = toQString(std::u16string_view(preview.text()).substr(0, MostShown));
        text_->setPlainText(isShort ? text : text + QChar(u'…'));
    }
    if (preview.isScript) {
        remark_->setText(tr("A script: what it prints is inserted."));
        remark_->show();
    }
}

void SnippetPreview::copyToClipboard() const {
    if (!shown_) return;
    // The clipboard takes it over.
    auto* copied = new QMimeData;  // NOLINT(cppcoreguidelines-owning-memory)
    copied->setText(toQString(shown_->text()));
    if (const auto* rich = std::get_if<AttributedString>(&shown_->content)) copied->setHtml(htmlOf(*rich));
    QGuiApplication::clipboard()->setMimeData(copied);
}

}  // namespace plume
