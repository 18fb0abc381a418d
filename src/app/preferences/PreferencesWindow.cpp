#include "app/preferences/PreferencesWindow.h"

#include <QAccessible>
#include <QHBoxLayout>
#include <QKeyEvent>
#include <QLabel>
#include <QLineEdit>
#include <QListWidget>
#include <QPushButton>
#include <QScrollArea>
#include <QShortcut>
#include <QStackedWidget>
#include <QStyle>
#include <QVBoxLayout>

#include "app/preferences/PreferencesPages.h"
#include "app/preferences/SettingMark.h"
#include "app/qt/Messages.h"
#include "app/qt/Text.h"
#include "app/qt/WindowPlaces.h"

namespace plume {

namespace {

constexpr const char* LastPage = "PreferencesPage";
constexpr QSize Opening(880, 640);
constexpr int Margin = 12;
constexpr int HitSpacing = 3;
constexpr int IconSize = 20;
constexpr int SeenAround = 60;

constexpr int PageRole = Qt::UserRole;
constexpr int RowRole = Qt::UserRole + 1;

bool matches(const PreferencesPage::Row& row, const QString& title, const QStringList& words) {
    const QString all = row.label + u' ' + row.help + u' ' + row.keys.join(u' ') + u' ' + title;
    for (const QString& word : words) {
        if (!all.contains(word, Qt::CaseInsensitive)) return false;
    }
    return true;
}

}  // namespace

PreferencesWindow::PreferencesWindow(PreferencesServices services, QWidget* parent)
    : QWidget(parent, Qt::Window), services_(std::move(services)), programs_(services_.programs) {
    setAttribute(Qt::WA_DeleteOnClose);
    setWindowTitle(tr("Preferences"));
    resize(Opening);
    auto* layout = new QHBoxLayout(this);
    layout->setContentsMargins(Margin, Margin, Margin, Margin);
    layout->setSpacing(Margin);
    layout->addWidget(makeSide());
    layout->addWidget(makeContent(), 1);
    addPages();
    makeShortcuts();
    rememberPlace(*this, services_.settings, "Preferences");
    changed_ = services_.settings.changedEvent.addObserver(this, &PreferencesWindow::settingsChanged);
    showPage({});
    list_->setFocus();
}

PreferencesWindow::~PreferencesWindow() {
    // Fields that are left tell what was typed in them, which has to be while everything is still there.
    if (QWidget* field = focusWidget()) field->clearFocus();
    for (const Page& page : pages_) {
        if (page.page) page.page->finish();
    }
}

// ---- Making ----

void PreferencesWindow::addPages() {
    pages_ = {
        {"General", tr("General"), PageIcon::General, makeGeneralPage},
        {"Expansion", tr("Expansion"), PageIcon::Expansion, makeExpansionPage},
        {"Search", tr("Suggestions and search"), PageIcon::Search, makeSearchPage},
        {"Typing", tr("Typing and clipboard"), PageIcon::Typing, makeTypingPage},
        {"Correction", tr("Correction"), PageIcon::Correction, makeCorrectionPage},
        {"HotKeys", tr("Hot keys"), PageIcon::HotKeys, makeHotKeysPage},
        {"Applications", tr("Applications"), PageIcon::Applications, makeApplicationsPage},
        {"Backups", tr("Backups and sync"), PageIcon::Backups, makeBackupsPage},
        {"ImportExport", tr("Import and export"), PageIcon::ImportExport, makeImportExportPage},
        {"Advanced", tr("Advanced"), PageIcon::Advanced, makeAdvancedPage},
    };
    for (Page& page : pages_) {
        new QListWidgetItem(iconOfPage(page.icon), page.title, list_);
        page.area = new QScrollArea;
        page.area->setWidgetResizable(true);
        page.area->setFrameShape(QFrame::NoFrame);
        page.area->setFocusPolicy(Qt::NoFocus);
        content_->addWidget(page.area);
    }
    // As wide as the longest title, with a scroll bar beside it where the font is large.
    side_->setFixedWidth(list_->sizeHintForColumn(0) + 2 * list_->frameWidth() + Margin +
                         style()->pixelMetric(QStyle::PM_ScrollBarExtent));
    connect(list_, &QListWidget::currentRowChanged, this, [this](int row) {
        if (row >= 0) showAt(static_cast<std::size_t>(row));
    });
}

QWidget* PreferencesWindow::makeSide() {
    auto* side = new QWidget;
    side->setSizePolicy(QSizePolicy::Fixed, QSizePolicy::Preferred);
    search_ = new QLineEdit;
    search_->setPlaceholderText(tr("Search settings"));
    search_->setAccessibleName(tr("Search settings"));
    search_->setClearButtonEnabled(true);
    search_->installEventFilter(this);
    list_ = new QListWidget;
    list_->setAccessibleName(tr("Pages"));
    list_->setIconSize({IconSize, IconSize});
    list_->setSpacing(1);
    list_->setHorizontalScrollBarPolicy(Qt::ScrollBarAlwaysOff);
    hits_ = new QListWidget;
    hits_->setAccessibleName(tr("Settings that were found"));
    hits_->setWordWrap(true);
    hits_->setSpacing(HitSpacing);
    hits_->setResizeMode(QListView::Adjust);
    // One that comes and goes would leave rows measured for the other width.
    hits_->setVerticalScrollBarPolicy(Qt::ScrollBarAlwaysOn);
    hits_->setHorizontalScrollBarPolicy(Qt::ScrollBarAlwaysOff);
    noHit_ = new QLabel(tr("Nothing was found."));
    noHit_->setAlignment(Qt::AlignHCenter | Qt::AlignTop);
    noHit_->setMargin(12);
    side_ = new QStackedWidget;
    for (QWidget* each : {static_cast<QWidget*>(list_), static_cast<QWidget*>(hits_), static_cast<QWidget*>(noHit_)}) {
        side_->addWidget(each);
    }
    auto* layout = new QVBoxLayout(side);
    layout->setContentsMargins(0, 0, 0, 0);
    layout->addWidget(search_);
    layout->addWidget(side_, 1);
    connect(search_, &QLineEdit::textChanged, this, &PreferencesWindow::search);
    connect(search_, &QLineEdit::returnPressed, this, [this] { chooseHit(hits_->item(0)); });
    connect(hits_, &QListWidget::itemClicked, this, &PreferencesWindow::chooseHit);
    connect(hits_, &QListWidget::itemActivated, this, &PreferencesWindow::chooseHit);
    return side;
}

QWidget* PreferencesWindow::makeContent() {
    auto* all = new QWidget;
    complaint_ = new QFrame;
    complaint_->setFrameShape(QFrame::StyledPanel);
    complaint_->setAutoFillBackground(true);
    complaint_->setBackgroundRole(QPalette::ToolTipBase);
    complaintText_ = new QLabel;
    complaintText_->setForegroundRole(QPalette::ToolTipText);
    complaintText_->setWordWrap(true);
    complaintText_->setTextFormat(Qt::PlainText);
    complaintText_->setTextInteractionFlags(Qt::TextSelectableByMouse);
    complaintText_->setAccessibleName(tr("What went wrong"));
    auto* sign = new QLabel;
    sign->setPixmap(style()->standardIcon(QStyle::SP_MessageBoxWarning).pixmap(IconSize));
    auto* hide = new QPushButton(tr("Hide"));
    connect(hide, &QPushButton::clicked, complaint_, &QWidget::hide);
    auto* complaintRow = new QHBoxLayout(complaint_);
    complaintRow->addWidget(sign);
    complaintRow->addWidget(complaintText_, 1);
    complaintRow->addWidget(hide);
    complaint_->hide();
    content_ = new QStackedWidget;
    content_->setObjectName(QStringLiteral("Content"));
    restore_ = new QPushButton(tr("Restore &Defaults"));
    connect(restore_, &QPushButton::clicked, this, &PreferencesWindow::askToRestore);
    auto* bottom = new QHBoxLayout;
    bottom->addStretch(1);
    bottom->addWidget(restore_);
    auto* layout = new QVBoxLayout(all);
    layout->setContentsMargins(0, 0, 0, 0);
    layout->addWidget(complaint_);
    layout->addWidget(content_, 1);
    layout->addLayout(bottom);
    return all;
}

void PreferencesWindow::makeShortcuts() {
    connect(new QShortcut(QKeySequence::Find, this), &QShortcut::activated, this, [this] {
        search_->setFocus();
        search_->selectAll();
    });
    connect(new QShortcut(QKeySequence(Qt::CTRL | Qt::Key_W), this), &QShortcut::activated, this, &QWidget::close);
}

// ---- Pages ----

PreferencesPage& PreferencesWindow::made(std::size_t place) {
    Page& page = pages_[place];
    if (!page.page) {
        page.page = page.make({services_, programs_, [this](const QString& reason) { complain(reason); }});
        page.page->setAccessibleName(page.title);
        page.area->setWidget(page.page);
        page.page->setAutoFillBackground(false);
        page.area->viewport()->setAutoFillBackground(false);
    }
    return *page.page;
}

void PreferencesWindow::showPage(const std::string& name) {
    const std::u16string last = services_.settings.stringForKey(LastPage).value_or(u"");
    const QString wanted = name.empty() ? toQString(last) : QString::fromStdString(name);
    for (std::size_t i = 0; i < pages_.size(); ++i) {
        if (QLatin1String(pages_[i].name) == wanted) return showAt(i);
    }
    if (!pages_[current_].page) showAt(current_);
}

void PreferencesWindow::showAt(std::size_t place) {
    // What went wrong on a page is told there.
    if (place != current_) complain({});
    current_ = place;
    const PreferencesPage& page = made(place);
    restore_->setVisible(!page.ownKeys().empty());
    content_->setCurrentIndex(int(place));
    list_->setCurrentRow(int(place));
}

void PreferencesWindow::closeEvent(QCloseEvent* event) {
    // The page to begin with is no reason to complain.
    static_cast<void>(services_.settings.setObject(LastPage, fromQString(QLatin1String(pages_[current_].name))));
    QWidget::closeEvent(event);
}

void PreferencesWindow::settingsChanged(UserDefaultsChange& change) {
    for (const Page& page : pages_) {
        if (page.page) page.page->follow(change.keys);
    }
}

void PreferencesWindow::complain(const QString& reason) {
    complaintText_->setText(reason);
    complaint_->setVisible(!reason.isEmpty());
    if (reason.isEmpty()) return;
    QAccessibleEvent event(complaintText_, QAccessible::Alert);
    QAccessible::updateAccessibility(&event);
}

void PreferencesWindow::askToRestore() {
    PreferencesPage& page = made(current_);
    ask(this, tr("Restore the defaults of the page “%1”?").arg(pages_[current_].title),
        tr("What you have set on this page is forgotten. Other pages stay as they are."), tr("&Restore Defaults"),
        [&page] { page.restoreDefaults(); });
}

// ---- Searching ----

bool PreferencesWindow::eventFilter(QObject* object, QEvent* event) {
    if (object != search_ || event->type() != QEvent::KeyPress) return QWidget::eventFilter(object, event);
    const int key = static_cast<QKeyEvent*>(event)->key();
    if (key == Qt::Key_Escape && !search_->text().isEmpty()) return search_->clear(), true;
    if (key != Qt::Key_Down || !side_->currentWidget()->isEnabled()) return false;
    side_->currentWidget()->setFocus();
    if (hits_->isVisible() && !hits_->currentItem()) hits_->setCurrentRow(0);
    return true;
}

void PreferencesWindow::search(const QString& words) {
    const QStringList all = words.simplified().split(u' ', Qt::SkipEmptyParts);
    if (all.isEmpty()) return side_->setCurrentWidget(list_);
    listHits(all);
    side_->setCurrentWidget(hits_->count() > 0 ? static_cast<QWidget*>(hits_) : noHit_);
}

void PreferencesWindow::listHits(const QStringList& words) {
    hits_->clear();
    for (std::size_t i = 0; i < pages_.size(); ++i) {
        const auto& rows = made(i).rows();
        for (std::size_t row = 0; row < rows.size(); ++row) {
            if (!matches(rows[row], pages_[i].title, words)) continue;
            QString label = rows[row].label;
            if (label.endsWith(u':')) label.chop(1);
            auto* hit = new QListWidgetItem(iconOfPage(pages_[i].icon), label + u'\n' + pages_[i].title, hits_);
            hit->setData(PageRole, int(i));
            hit->setData(RowRole, int(row));
        }
    }
}

void PreferencesWindow::chooseHit(const QListWidgetItem* hit) {
    if (!hit) return;
    const auto place = static_cast<std::size_t>(hit->data(PageRole).toInt());
    const auto row = static_cast<std::size_t>(hit->data(RowRole).toInt());
    showAt(place);
    reveal(place, made(place).rows()[row]);
}

void PreferencesWindow::reveal(std::size_t place, const PreferencesPage::Row& row) {
    PreferencesPage& page = made(place);
    // The page may not have had its size yet.
    QCoreApplication::sendPostedEvents(pages_[place].area, QEvent::LayoutRequest);
    page.layout()->activate();
    pages_[place].area->ensureWidgetVisible(row.control, 0, SeenAround);
    row.control->setFocus(Qt::ShortcutFocusReason);
    SettingMark::show(*row.control, page);
}

}  // namespace plume
