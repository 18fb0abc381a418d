#include "app/editor/PreviewPane.h"

#include <QEvent>
#include <QLabel>
#include <QPlainTextEdit>
#include <QPointer>
#include <QVBoxLayout>
#include <utility>

#include "app/FirstLine.h"
#include "app/editing/WhereUsed.h"
#include "app/qt/Labels.h"
#include "app/qt/Text.h"
#include "app/search/SnippetPreview.h"

namespace plume {

namespace {

using namespace std::chrono_literals;

constexpr auto SelectionPause = 60ms;
constexpr auto TypingPause = 300ms;
constexpr std::size_t MostNamed = 6;

QString nameOf(const Snippet& snippet) {
    const auto abbreviation = snippet.abbreviationWithPrefix().value_or(u"");
    return toQString(firstLine(abbreviation.empty() ? snippet.sortingContent().value_or(u"") : abbreviation));
}

}  // namespace

PreviewPane::PreviewPane(Services services)
    : services_(std::move(services)),
      preview_(new SnippetPreview),
      whereUsed_(makeHelpLabel({})),
      trial_(new QPlainTextEdit) {
    timer_.setSingleShot(true);
    connect(&timer_, &QTimer::timeout, this, &PreviewPane::showNow);
    whereUsed_->setTextFormat(Qt::RichText);
    whereUsed_->setTextInteractionFlags(Qt::LinksAccessibleByMouse | Qt::LinksAccessibleByKeyboard);
    whereUsed_->setAccessibleName(tr("Included by"));
    connect(whereUsed_, &QLabel::linkActivated, this, &PreviewPane::follow);
    trial_->setTabChangesFocus(true);
    trial_->setPlaceholderText(tr("Try abbreviations here: they expand."));
    trial_->setAccessibleName(tr("Field to try abbreviations in"));
    trial_->setMaximumHeight(4 * fontMetrics().lineSpacing());
    trial_->installEventFilter(this);
    auto* layout = new QVBoxLayout(this);
    layout->addWidget(makeSectionTitle(tr("What Comes Out")));
    layout->addWidget(preview_, 1);
    layout->addWidget(whereUsed_);
    layout->addWidget(trial_);
    whereUsed_->hide();
}

PreviewPane::~PreviewPane() {
    if (trial_->hasFocus()) services_.setExpandsInOwnWindows(false);
}

void PreviewPane::show(const std::shared_ptr<Snippet>& snippet) {
    if (snippet_ != snippet) preview_->show(nullptr, services_.groups());
    snippet_ = snippet;
    timer_.start(SelectionPause);
}

void PreviewPane::showSoon() {
    timer_.start(TypingPause);
}

void PreviewPane::showNow() {
    if (!isVisible()) return;
    showWhereUsed();
    if (!snippet_) return preview_->show(nullptr, services_.groups());
    services_.readClipboard(
        [pane = QPointer<PreviewPane>(this), shown = snippet_](const std::optional<std::u16string>& text) {
            if (!pane || pane->snippet_ != shown) return;
            pane->preview_->setClipboard(text);
            pane->preview_->show(shown, pane->services_.groups());
        });
}

void PreviewPane::showWhereUsed() {
    users_.clear();
    if (snippet_) users_ = snippetsThatInclude(*snippet_, services_.groups());
    QStringList links;
    for (std::size_t i = 0; i < users_.size() && i < MostNamed; ++i) {
        links.append(QStringLiteral("<a href=\"%1\">%2</a>").arg(i).arg(nameOf(*users_[i]).toHtmlEscaped()));
    }
    if (users_.size() > MostNamed) links.append(tr("%n more", "", static_cast<int>(users_.size() - MostNamed)));
    whereUsed_->setVisible(!links.isEmpty());
    whereUsed_->setText(tr("Included by %1").arg(links.join(QStringLiteral(", "))));
}

void PreviewPane::follow(const QString& link) {
    const std::size_t row = link.toULongLong();
    if (row < users_.size()) Q_EMIT chosen(users_[row]);
}

bool PreviewPane::eventFilter(QObject* watched, QEvent* event) {
    if (watched == trial_ && event->type() == QEvent::FocusIn) services_.setExpandsInOwnWindows(true);
    if (watched == trial_ && event->type() == QEvent::FocusOut) services_.setExpandsInOwnWindows(false);
    return QWidget::eventFilter(watched, event);
}

}  // namespace plume
