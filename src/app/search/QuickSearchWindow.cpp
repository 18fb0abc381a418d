#include "app/search/QuickSearchWindow.h"

#include <QAction>
#include <QBoxLayout>
#include <QCloseEvent>
#include <QKeyEvent>
#include <QLabel>
#include <QLineEdit>
#include <QListView>
#include <QMenu>
#include <QPointer>
#include <QScrollBar>
#include <QStackedWidget>
#include <QTimer>
#include <QToolButton>
#include <algorithm>
#include <array>
#include <chrono>
#include <utility>

#include "app/qt/Labels.h"
#include "app/qt/PopupPlace.h"
#include "app/qt/Text.h"
#include "app/search/QuickSearchModel.h"
#include "app/search/SnippetPreview.h"
#include "app/search/SnippetRowDelegate.h"

namespace plume {

namespace {

constexpr QSize WindowSize(620, 430);
constexpr int PreviewHeight = 110;
constexpr std::size_t DigitRows = 10;
// A search that is not repeated soon needs no memory.
constexpr std::chrono::seconds ReleaseDelay{60};

constexpr const char* SearchByKey = "SnippetQuickSearchSearchBy";
constexpr const char* WildcardKey = "SnippetQuickSearchWildcardSearch";

// Codes of the keys of the upper row, as an X server numbers them, which are digits whatever is held with them.
std::optional<std::size_t> digitKeyIndex(const QKeyEvent& key) {
    constexpr quint32 FirstDigitKey = 10;
    const quint32 code = key.nativeScanCode();
    if (code >= FirstDigitKey && code < FirstDigitKey + DigitRows) return code - FirstDigitKey;
    if (key.key() < Qt::Key_0 || key.key() > Qt::Key_9) return std::nullopt;
    return key.key() == Qt::Key_0 ? DigitRows - 1 : static_cast<std::size_t>(key.key() - Qt::Key_1);
}

// What is typed behind such a key waits until the other side knows whether the search has ended.
bool mayEndSearch(const QKeyEvent& key) {
    switch (key.key()) {
        case Qt::Key_Return:
        case Qt::Key_Enter:
        case Qt::Key_Escape:
            return true;
        case Qt::Key_E:
        case Qt::Key_W:
            return key.modifiers() == Qt::ControlModifier;
        default:
            return digitKeyIndex(key).has_value();
    }
}

}  // namespace

QuickSearchWindow::QuickSearchWindow(QuickSearchServices services)
    : QFrame(nullptr, Qt::Tool | Qt::FramelessWindowHint | Qt::WindowStaysOnTopHint),
      services_(std::move(services)),
      model_(new QuickSearchModel(this)),
      query_(new QLineEdit),
      options_(new QToolButton),
      list_(new QListView),
      results_(new QStackedWidget),
      nothing_(makeTextLabel()),
      preview_(new SnippetPreview),
      release_(new QTimer(this)) {
    setAttribute(Qt::WA_QuitOnClose, false);
    setFrameShape(QFrame::Box);
    setForegroundRole(QPalette::Mid);
    setWindowTitle(tr("Quick Search"));
    ranking_.setUses(services_.uses);
    makeField();
    makeList();
    auto* line = new QFrame;
    line->setFrameShape(QFrame::HLine);
    line->setForegroundRole(QPalette::Mid);
    auto* hint = makeHelpLabel(tr("Return inserts, Ctrl+Return copies, Ctrl+E edits, Esc closes"));
    hint->setContentsMargins(8, 2, 8, 4);
    preview_->setFixedHeight(PreviewHeight);
    auto* layout = new QVBoxLayout(this);
    layout->setContentsMargins({});
    layout->setSpacing(0);
    auto* top = new QHBoxLayout;
    top->setContentsMargins(8, 8, 8, 8);
    top->addWidget(query_, 1);
    makeOptions();
    top->addWidget(options_);
    layout->addLayout(top);
    layout->addWidget(results_, 1);
    layout->addWidget(line);
    layout->addWidget(preview_);
    layout->addWidget(hint);
    release_->setSingleShot(true);
    release_->setInterval(ReleaseDelay);
    connect(release_, &QTimer::timeout, this, [this] { ranking_.release(); });
}

QuickSearchWindow::~QuickSearchWindow() = default;

void QuickSearchWindow::makeField() {
    query_->setPlaceholderText(tr("Search snippets"));
    query_->setAccessibleName(tr("Search snippets"));
    query_->setClearButtonEnabled(true);
    // A click in a menu that sticks out of the window would be one outside it.
    query_->setContextMenuPolicy(Qt::NoContextMenu);
    query_->installEventFilter(this);
    QFont large = query_->font();
    constexpr double Scale = 1.2;
    large.setPointSizeF(large.pointSizeF() * Scale);
    query_->setFont(large);
    connect(query_, &QLineEdit::textChanged, this, &QuickSearchWindow::search);
}

void QuickSearchWindow::makeList() {
    list_->setModel(model_);
    list_->setItemDelegate(new SnippetRowDelegate(list_));
    list_->setAccessibleName(tr("Found snippets"));
    // The field keeps the focus, and hands the keys on that move the selection.
    list_->setFocusPolicy(Qt::NoFocus);
    list_->setFrameShape(QFrame::NoFrame);
    list_->setUniformItemSizes(true);
    list_->setHorizontalScrollBarPolicy(Qt::ScrollBarAlwaysOff);
    list_->setEditTriggers(QAbstractItemView::NoEditTriggers);
    connect(list_, &QListView::clicked, this,
            [this](const QModelIndex& index) { send(model_->snippetAt(index.row())); });
    connect(list_->selectionModel(), &QItemSelectionModel::currentRowChanged, this, &QuickSearchWindow::currentChanged);
    nothing_->setAlignment(Qt::AlignCenter);
    nothing_->setBackgroundRole(QPalette::Base);
    nothing_->setAutoFillBackground(true);
    results_->addWidget(list_);
    results_->addWidget(nothing_);
}

void QuickSearchWindow::makeOptions() {
    options_->setText(tr("Search in"));
    options_->setToolTip(tr("What is searched"));
    options_->setPopupMode(QToolButton::InstantPopup);
    options_->setAutoRaise(true);
    options_->installEventFilter(this);
    makeMenu();
    options_->setMenu(menu_);
}

void QuickSearchWindow::makeMenu() {
    menu_ = new QMenu(this);
    menu_->installEventFilter(this);
    addFieldAction(*menu_, SearchRule::Abbreviation, tr("&Abbreviations"));
    addFieldAction(*menu_, SearchRule::Content, tr("&Contents"));
    addFieldAction(*menu_, SearchRule::Label, tr("&Labels"));
    menu_->addSeparator();
    addWildcardAction(*menu_);
    // The click that chooses is outside the window, and is none that closes it.
    connect(menu_, &QMenu::aboutToShow, this, &QuickSearchWindow::tellPlace, Qt::QueuedConnection);
    connect(menu_, &QMenu::aboutToHide, this, &QuickSearchWindow::tellPlace, Qt::QueuedConnection);
}

void QuickSearchWindow::addFieldAction(QMenu& menu, std::int64_t field, const QString& text) {
    QAction* const action = menu.addAction(text);
    action->setCheckable(true);
    connect(&menu, &QMenu::aboutToShow, action, [this, action, field] {
        const std::int64_t fields = rule().searchBy;
        action->setChecked((fields & field) != 0);
        // A search that looks nowhere would find nothing: the last field stays.
        action->setEnabled(fields != field);
    });
    connect(action, &QAction::triggered, this, [this, field](bool checked) {
        const std::int64_t fields = services_.settings.integerForKey(SearchByKey);
        static_cast<void>(services_.settings.setObject(SearchByKey, checked ? fields | field : fields & ~field));
        search();
    });
}

void QuickSearchWindow::addWildcardAction(QMenu& menu) {
    QAction* const action = menu.addAction(tr("&Wildcards"));
    action->setCheckable(true);
    connect(&menu, &QMenu::aboutToShow, action, [this, action] { action->setChecked(rule().isWildcard); });
    connect(action, &QAction::triggered, this, [this](bool checked) {
        static_cast<void>(services_.settings.setObject(WildcardKey, std::int64_t{checked ? 1 : 0}));
        search();
    });
}

SearchRule QuickSearchWindow::rule() const {
    constexpr std::int64_t Fields = SearchRule::Abbreviation | SearchRule::Content | SearchRule::Label;
    return {.searchBy = services_.settings.integerForKey(SearchByKey) & Fields,
            .isWildcard = services_.settings.integerForKey(WildcardKey) == 1};
}

// ---- Coming and going ----

void QuickSearchWindow::show(const QuickSearchOpening& opening) {
    release_->stop();
    ranking_.setLibrary(services_.groups());
    model_->setSelectorKeyModifier(opening.selectorKeyModifier);
    selectorKeyModifier_ = opening.selectorKeyModifier;
    preview_->setClipboard({});
    {
        const QSignalBlocker searchesOnce(query_);
        query_->setText(toQString(opening.query));
    }
    search();
    query_->selectAll();
    query_->setFocus();
    setGeometry(opening.place ? popupGeometry(*opening.place, WindowSize) : cornerGeometry(WindowSize));
    QFrame::show();
    raise();
    tellPlace();
    if (events_.shown) events_.shown(static_cast<std::uint32_t>(winId()));
    readClipboard();
}

void QuickSearchWindow::readClipboard() {
    services_.readClipboard([window = QPointer(this)](const std::optional<std::u16string>& text) {
        // The answer may come when nothing is searched for any more.
        if (!window || !window->isVisible()) return;
        window->preview_->setClipboard(text);
        window->currentChanged();
    });
}

void QuickSearchWindow::tellPlace() {
    if (!isVisible() || !events_.placed) return;
    Rectangle frame = screenFrame(*this);
    if (menu_->isVisible()) {
        const Rectangle menu = screenFrame(*menu_);
        const double left = std::min(frame.origin.x, menu.origin.x);
        const double top = std::min(frame.origin.y, menu.origin.y);
        const double right = std::max(frame.origin.x + frame.size.width, menu.origin.x + menu.size.width);
        const double bottom = std::max(frame.origin.y + frame.size.height, menu.origin.y + menu.size.height);
        frame = {{left, top}, {right - left, bottom - top}};
    }
    events_.placed(frame);
}

void QuickSearchWindow::close() {
    menu_->hide();
    disappear();
}

void QuickSearchWindow::dismiss() {
    disappear();
    if (events_.closed) events_.closed();
}

// What was searched for is nobody's business any more.
void QuickSearchWindow::disappear() {
    hide();
    const QSignalBlocker silent(query_);
    // Unlike clear(), this leaves nothing that could be undone.
    query_->setText({});
    model_->setResults({}, {}, {});
    preview_->show(nullptr, services_.groups());
    preview_->setClipboard({});
    release_->start();
}

void QuickSearchWindow::closeEvent(QCloseEvent* event) {
    dismiss();
    // Else the program could not end meanwhile.
    event->accept();
}

// ---- Searching ----

void QuickSearchWindow::search() {
    const std::u16string query = fromQString(query_->text());
    const SearchRule searched = rule();
    std::vector<RankedSnippet> found = ranking_.search(query, searched);
    const bool isEmpty = found.empty();
    model_->setResults(std::move(found), query, searched);
    nothing_->setText(query.empty() ? tr("You have no snippets yet.") : tr("Nothing was found."));
    results_->setCurrentWidget(isEmpty ? static_cast<QWidget*>(nothing_) : list_);
    selectRow(0, 1);
    if (isEmpty) currentChanged();
    services_.setFirstRows(model_->firstSnippets(DigitRows));
}

void QuickSearchWindow::currentChanged() {
    preview_->show(current(), services_.groups());
}

std::shared_ptr<Snippet> QuickSearchWindow::current() const {
    const QModelIndex index = list_->currentIndex();
    return index.isValid() ? model_->snippetAt(index.row()) : nullptr;
}

// The divider is passed over in the direction in which one moves.
void QuickSearchWindow::selectRow(int row, int direction) {
    const int rows = model_->rowCount();
    row = std::clamp(row, 0, std::max(0, rows - 1));
    if (!model_->snippetAt(row)) row += direction;
    if (row < 0 || row >= rows) return;
    list_->setCurrentIndex(model_->index(row, 0));
    list_->scrollTo(list_->currentIndex());
}

// ---- Keys ----

bool QuickSearchWindow::eventFilter(QObject* watched, QEvent* event) {
    if (watched == query_ && event->type() == QEvent::ShortcutOverride) event->accept();
    if (event->type() != QEvent::KeyPress) return QFrame::eventFilter(watched, event);
    const auto& key = static_cast<const QKeyEvent&>(*event);
    const bool isForAll = key.key() == Qt::Key_Escape || key.modifiers() == Qt::ControlModifier;
    const bool isUsed = (watched == query_ || (watched == options_ && isForAll)) && keyPressed(key);
    if (mayEndSearch(key) && isVisible() && events_.stayed) events_.stayed();
    return isUsed || QFrame::eventFilter(watched, event);
}

bool QuickSearchWindow::keyPressed(const QKeyEvent& key) {
    const auto modifiers = key.modifiers() & ~Qt::KeypadModifier;
    if (digitPressed(key)) return true;
    if (modifiers == Qt::ControlModifier) return commandPressed(key);
    if (modifiers != Qt::NoModifier) return false;
    switch (key.key()) {
        case Qt::Key_Return:
        case Qt::Key_Enter:
            send(current());
            return true;
        case Qt::Key_Escape:
            query_->text().isEmpty() ? dismiss() : query_->clear();
            return true;
        default:
            return moveBy(key.key());
    }
}

bool QuickSearchWindow::commandPressed(const QKeyEvent& key) {
    switch (key.key()) {
        case Qt::Key_Return:
        case Qt::Key_Enter:
            copy();
            return true;
        case Qt::Key_E:
            edit();
            return true;
        case Qt::Key_W:
            dismiss();
            return true;
        default:
            return false;
    }
}

bool QuickSearchWindow::digitPressed(const QKeyEvent& key) {
    constexpr std::array Modifiers{Qt::NoModifier, Qt::ShiftModifier, Qt::ControlModifier, Qt::AltModifier,
                                   Qt::MetaModifier};
    if (selectorKeyModifier_ < 0 || selectorKeyModifier_ >= std::ssize(Modifiers)) return false;
    const auto held = key.modifiers() & ~Qt::KeypadModifier;
    if (held != Modifiers.at(static_cast<std::size_t>(selectorKeyModifier_))) return false;
    const auto index = digitKeyIndex(key);
    const auto snippet = index ? model_->snippetAtIndex(*index) : nullptr;
    if (!snippet) return false;
    send(snippet);
    return true;
}

bool QuickSearchWindow::moveBy(int key) {
    const int row = list_->currentIndex().row();
    const int page = std::max(1, list_->viewport()->height() / std::max(1, list_->sizeHintForRow(0)) - 1);
    switch (key) {
        case Qt::Key_Down:
            selectRow(row + 1, 1);
            return true;
        case Qt::Key_Up:
            selectRow(row - 1, -1);
            return true;
        case Qt::Key_PageDown:
            selectRow(row + page, 1);
            return true;
        case Qt::Key_PageUp:
            selectRow(row - page, -1);
            return true;
        case Qt::Key_Home:
            selectRow(0, 1);
            return true;
        case Qt::Key_End:
            selectRow(model_->rowCount() - 1, -1);
            return true;
        default:
            return false;
    }
}

// ---- What is done with it ----

void QuickSearchWindow::send(const std::shared_ptr<Snippet>& snippet) {
    if (!snippet) return;
    disappear();
    services_.send(snippet);
}

void QuickSearchWindow::copy() {
    if (!current()) return;
    preview_->copyToClipboard();
    dismiss();
}

void QuickSearchWindow::edit() {
    const std::shared_ptr<Snippet> snippet = current();
    if (!snippet) return;
    disappear();
    if (events_.replaced) events_.replaced();
    services_.edit(snippet);
}

}  // namespace plume
