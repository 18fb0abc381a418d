#include "app/editor/OutlinePane.h"

#include <QAction>
#include <QApplication>
#include <QFontInfo>
#include <QKeyEvent>
#include <QLabel>
#include <QLineEdit>
#include <QMenu>
#include <QToolButton>
#include <QVBoxLayout>
#include <algorithm>

#include "app/editor/OutlineView.h"
#include "app/qt/Labels.h"
#include "app/qt/Text.h"

namespace plume {

namespace {

// Identities of groups, apart by spaces.
constexpr const char* OpenGroupsKey = "WindowPlace.MacrosOpenGroups";
constexpr const char* FontSizeKey = "FontSizeDelta";

}  // namespace

OutlinePane::OutlinePane(LibraryEditor& editor, WritableUserDefaults& settings)
    : editor_(editor),
      settings_(settings),
      filter_(settings),
      model_([&editor](const Snippet& snippet) { return editor.isDuplicated(snippet); }),
      field_(new QLineEdit),
      options_(new QMenu(tr("&Search By"), this)),
      view_(new OutlineView(model_)),
      nothing_(makeTextLabel(tr("Nothing was found."))),
      status_(makeHelpLabel({})) {
    field_->setPlaceholderText(tr("Search"));
    field_->setAccessibleName(tr("Search in the snippets"));
    field_->setClearButtonEnabled(true);
    field_->installEventFilter(this);
    nothing_->setAlignment(Qt::AlignCenter);
    nothing_->hide();
    makeOptions();
    auto* button = new QToolButton;
    button->setText(QStringLiteral("…"));
    button->setAccessibleName(tr("What is searched"));
    button->setToolTip(tr("What is searched"));
    button->setMenu(options_);
    button->setPopupMode(QToolButton::InstantPopup);
    auto* top = new QHBoxLayout;
    top->addWidget(field_, 1);
    top->addWidget(button);
    auto* layout = new QVBoxLayout(this);
    layout->addLayout(top);
    layout->addWidget(nothing_);
    layout->addWidget(view_, 1);
    layout->addWidget(status_);
    setFocusProxy(view_);
    connect(field_, &QLineEdit::textChanged, this, &OutlinePane::onFilterChanged);
    connect(view_, &OutlineView::selectionWasChanged, this, &OutlinePane::refreshStatusString);
    fontSize_ = settings_.changedEvent.addObserver(this, &OutlinePane::settingsChanged);
    setFontSize();
    reload();
    const QString open = toQString(settings_.stringForKey(OpenGroupsKey).value_or(u""));
    if (settings_.hasKey(OpenGroupsKey)) {
        view_->setOpenGroups(open.split(QLatin1Char(' '), Qt::SkipEmptyParts));
    } else if (editor_.groups().size() == 1) {
        view_->openAll();
    }
}

void OutlinePane::settingsChanged(UserDefaultsChange& change) {
    if (std::ranges::count(change.keys, FontSizeKey) > 0) setFontSize();
}

void OutlinePane::setFontSize() {
    constexpr double Smallest = 6;
    QFont font = QApplication::font("QAbstractItemView");
    const auto delta = static_cast<double>(settings_.integerForKey(FontSizeKey));
    if (delta != 0) font.setPointSizeF(std::max(QFontInfo(font).pointSizeF() + delta, Smallest));
    view_->setFont(font);
}

void OutlinePane::keepOpenGroups() {
    std::u16string open = fromQString(view_->openGroups().join(QLatin1Char(' ')));
    // Where it cannot be kept, groups are opened again by hand.
    if (open != settings_.stringForKey(OpenGroupsKey))
        static_cast<void>(settings_.setObject(OpenGroupsKey, std::move(open)));
}

// ---- Searching ----

void OutlinePane::makeOptions() {
    addField(SnippetSearch::Abbreviation, tr("&Abbreviation"));
    addField(SnippetSearch::Label, tr("&Label"));
    addField(SnippetSearch::Content, tr("&Content"));
    options_->addSeparator();
    QAction* wildcards = options_->addAction(tr("&Wildcards: * and ?"));
    wildcards->setCheckable(true);
    wildcards->setChecked(filter_.isWildcardSearch());
    connect(wildcards, &QAction::triggered, this, [this, wildcards] {
        filter_.flipWildcardSearchOption();
        wildcards->setChecked(filter_.isWildcardSearch());
        onFilterChanged();
    });
}

void OutlinePane::addField(SnippetSearch::SearchBy field, const QString& text) {
    QAction* action = options_->addAction(text);
    action->setCheckable(true);
    action->setChecked(filter_.searchesBy(field));
    connect(action, &QAction::triggered, this, [this, action, field] {
        filter_.onSearchByChanged(field);
        action->setChecked(filter_.searchesBy(field));
        onFilterChanged();
    });
}

void OutlinePane::onFilterChanged() {
    filter_.onFilterChanged(fromQString(field_->text()), editor_.groups());
    const auto show = [this] {
        if (filter_.filtering()) {
            model_.showFound(filter_.filteredGroups(), filter_.filteredGroupsMacros(), filter_.filter(),
                             filter_.isWildcardSearch());
        } else {
            model_.show(editor_.groups());
        }
    };
    view_->reload(show, filter_.filtering());
    nothing_->setVisible(filter_.filtering() && model_.rowCount() == 0);
    refreshStatusString();
}

void OutlinePane::reload() {
    onFilterChanged();
}

void OutlinePane::clearFilter() {
    field_->clear();
}

void OutlinePane::focusFilter() {
    field_->setFocus();
    field_->selectAll();
}

void OutlinePane::refreshStatusString() {
    const std::size_t selected = view_->selection().snippets.size();
    status_->setText(toQString(statusString(selected, filter_.total(editor_.groups()))));
}

// From the field into the list: the first snippet found is two keys away.
bool OutlinePane::eventFilter(QObject* watched, QEvent* event) {
    if (watched != field_ || event->type() != QEvent::KeyPress) return QWidget::eventFilter(watched, event);
    const int key = static_cast<QKeyEvent*>(event)->key();
    if (key == Qt::Key_Escape && !field_->text().isEmpty()) {
        field_->clear();
        return true;
    }
    if (key != Qt::Key_Down && key != Qt::Key_Return && key != Qt::Key_Enter) return false;
    const QModelIndex first = filter_.filtering() ? model_.index(0, 0, model_.index(0, 0)) : model_.index(0, 0);
    if (view_->selection().isEmpty() && first.isValid()) view_->setCurrentIndex(first);
    view_->setFocus();
    return true;
}

}  // namespace plume
