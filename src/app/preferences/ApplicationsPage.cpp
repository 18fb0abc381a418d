#include <QComboBox>
#include <QCoreApplication>
#include <QDoubleSpinBox>
#include <QFormLayout>
#include <QGroupBox>
#include <QHBoxLayout>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QSignalBlocker>
#include <QSortFilterProxyModel>
#include <QStandardItemModel>
#include <QTreeView>
#include <QVBoxLayout>

#include "Foundation/Strings.h"
#include "app/preferences/OwnApplicationRows.h"
#include "app/preferences/PreferencesPages.h"
#include "app/preferences/ProgramAdder.h"
#include "app/preferences/SettingControls.h"
#include "app/qt/Sentences.h"
#include "app/qt/Text.h"
#include "app/qt/WheelGuard.h"
#include "input/delivery/ApplicationTable.h"

namespace plume {

namespace {

constexpr const char* Setting = "CustomApplicationSettings";
constexpr int NameRole = Qt::UserRole;
constexpr double LongestPause = 5;  // seconds
constexpr double PauseStep = 0.01;
constexpr int PauseDecimals = 3;
constexpr int VisibleRows = 9;

class ApplicationsPage final : public PreferencesPage {
    Q_DECLARE_TR_FUNCTIONS(ApplicationsPage)
  public:
    explicit ApplicationsPage(const Around& around) : PreferencesPage(around) {
        addNote(
            tr("Plume knows how many programs want to be typed to. Add a program where texts arrive damaged, or "
               "not at all."));
        addFilling(tr("Programs"), makeList(), {QLatin1String(Setting)});
        addWide(tr("How texts are inserted in the chosen program"), makeDetails(), {}, {QLatin1String(Setting)});
        problem_ = addNote({});
        bind(Setting, [this] { showRows(); });
    }

  private:
    // ---- The list ----

    QWidget* makeList() {
        auto* all = new QWidget;
        auto* filter = new QLineEdit;
        filter->setPlaceholderText(tr("Filter programs"));
        filter->setAccessibleName(tr("Filter programs"));
        filter->setClearButtonEnabled(true);
        model_ = new QStandardItemModel(this);
        shown_ = new QSortFilterProxyModel(this);
        shown_->setSourceModel(model_);
        shown_->setFilterKeyColumn(-1);
        shown_->setFilterCaseSensitivity(Qt::CaseInsensitive);
        view_ = new QTreeView;
        view_->setModel(shown_);
        view_->setAccessibleName(tr("Programs"));
        view_->setRootIsDecorated(false);
        view_->setUniformRowHeights(true);
        view_->setAllColumnsShowFocus(true);
        view_->setEditTriggers(QAbstractItemView::NoEditTriggers);
        view_->setMinimumHeight(fontMetrics().height() * VisibleRows);
        all->setFocusProxy(view_);
        auto* layout = new QVBoxLayout(all);
        layout->setContentsMargins(0, 0, 0, 0);
        layout->addWidget(filter);
        layout->addWidget(view_, 1);
        layout->addLayout(makeButtons());
        connect(filter, &QLineEdit::textChanged, shown_, &QSortFilterProxyModel::setFilterFixedString);
        connect(view_->selectionModel(), &QItemSelectionModel::currentRowChanged, this, &ApplicationsPage::showDetails);
        return all;
    }

    QLayout* makeButtons() {
        auto* row = new QHBoxLayout;
        add_ = new ProgramAdder(services().programs, programs());
        change_ = new QPushButton(tr("Change as &Mine"));
        change_->setToolTip(tr("Makes a row of your own that begins as this one of Plume’s."));
        remove_ = new QPushButton(tr("Remo&ve"));
        auto* words = new QLabel;
        row->addWidget(add_);
        row->addWidget(change_);
        row->addWidget(remove_);
        row->addWidget(words, 1);
        connect(add_, &ProgramAdder::chosen, this, &ApplicationsPage::addAll);
        connect(add_, &ProgramAdder::told, words, &QLabel::setText);
        connect(change_, &QPushButton::clicked, this, [this] { addAll({fromUtf8(current())}); });
        connect(remove_, &QPushButton::clicked, this, [this] {
            rows_.remove(current());
            keep();
        });
        return row;
    }

    void addRow(const std::string& name, const QString& from, const QString& like) {
        const std::u16string identifier = fromUtf8(name);
        auto* item = new QStandardItem(programs().iconOf(identifier), programs().nameOf(identifier));
        item->setData(QString::fromStdString(name), NameRole);
        model_->appendRow(
            {item, new QStandardItem(toQString(identifier)), new QStandardItem(from), new QStandardItem(like)});
    }

    void showRows() {
        const std::string before = current();
        const auto read = OwnApplicationRows::read(services().builtInApplicationRows,
                                                   toUtf8(settings().stringForKey(Setting).value_or(u"")));
        rows_ = read ? read.value() : OwnApplicationRows();
        // What cannot be read is not written over.
        add_->setEnabled(read.ok());
        tell(read ? QString() : inUsersLanguage(read.error().message));
        model_->clear();
        model_->setHorizontalHeaderLabels({tr("Program"), tr("Identifier"), tr("Row of"), tr("Kind")});
        for (const std::string& name : rows_.names()) addRow(name, tr("Yours"), {});
        for (const auto& row : rows_.builtInRows()) {
            if (!rows_.has(row.name)) addRow(row.name, tr("Plume"), QString::fromStdString(row.family));
        }
        for (int column = 0; column < model_->columnCount(); ++column) view_->resizeColumnToContents(column);
        select(before);
    }

    void select(const std::string& name) {
        QModelIndexList found;
        if (!name.empty()) {
            found = shown_->match(shown_->index(0, 0), NameRole, QString::fromStdString(name), 1, Qt::MatchExactly);
        }
        view_->setCurrentIndex(found.isEmpty() ? shown_->index(0, 0) : found.front());
        showDetails();
    }

    // Of the chosen row; empty: none.
    std::string current() const {
        const QModelIndex index = view_->currentIndex().siblingAtColumn(0);
        return index.data(NameRole).toString().toStdString();
    }

    void addAll(const ProgramAdder::Identifiers& identifiers) {
        std::string last;
        for (const std::u16string& identifier : identifiers) last = rows_.add(toUtf8(identifier));
        if (!keep()) return;
        select(last);
        insertion_->setFocus();
    }

    // ---- The chosen row ----

    QWidget* makeDetails() {
        details_ = new QGroupBox;
        details_->setSizePolicy(QSizePolicy::Expanding, QSizePolicy::Fixed);
        auto* form = new QFormLayout(details_);
        form->setLabelAlignment(Qt::AlignLeft);
        form->setFieldGrowthPolicy(QFormLayout::FieldsStayAtSizeHint);
        insertion_ = new QComboBox;
        insertion_->addItems({tr("Automatic"), tr("Typed"), tr("Pasted")});
        ignoreWheelWithoutFocus(*insertion_);
        form->addRow(tr("&Insert texts:"), insertion_);
        pasteKeys_ = new QComboBox;
        pasteKeys_->setEditable(true);
        pasteKeys_->setInsertPolicy(QComboBox::NoInsert);
        pasteKeys_->addItems({QStringLiteral("Control+V"), QStringLiteral("Control+Shift+V"),
                              QStringLiteral("Shift+Insert"), QStringLiteral("Super+V")});
        pasteKeys_->lineEdit()->setPlaceholderText(tr("As usual"));
        ignoreWheelWithoutFocus(*pasteKeys_);
        form->addRow(tr("&Keys that paste:"), pasteKeys_);
        form->addRow(tr("Pause &before pasting:"), makePause(OwnApplicationRows::BeforePasting));
        form->addRow(tr("Pause &after pasting:"), makePause(OwnApplicationRows::AfterPasting));
        form->addRow(tr("Pause after &erasing:"), makePause(OwnApplicationRows::AfterErasing));
        auto* trial = new QLabel(tr("Try it: click in the program and type an abbreviation. Changes hold at once."));
        trial->setWordWrap(true);
        form->addRow(trial);
        connect(insertion_, &QComboBox::activated, this, [this](int index) {
            rows_.setInsertion(current(), OwnApplicationRows::Insertion(index));
            keep();
        });
        connect(pasteKeys_, &QComboBox::textActivated, this, &ApplicationsPage::takePasteKeys);
        connect(pasteKeys_->lineEdit(), &QLineEdit::editingFinished, this,
                [this] { takePasteKeys(pasteKeys_->currentText()); });
        // A frame that had the keyboard by proxy would look as if it had it itself.
        auto* all = new QWidget;
        auto* layout = new QVBoxLayout(all);
        layout->setContentsMargins(0, 0, 0, 0);
        layout->addWidget(details_);
        all->setSizePolicy(details_->sizePolicy());
        all->setFocusProxy(insertion_);
        return all;
    }

    void takePasteKeys(const QString& keys) {
        const std::string text = keys.trimmed().toStdString();
        if (!rows_.has(current()) || rows_.pasteKeys(current()) == text) return;
        rows_.setPasteKeys(current(), text);
        keep();
    }

    QWidget* makePause(const char* key) {
        auto* box = new QDoubleSpinBox;
        box->setRange(0, LongestPause);
        box->setSingleStep(PauseStep);
        box->setDecimals(PauseDecimals);
        box->setSuffix(tr(" seconds"));
        box->setKeyboardTracking(false);
        box->setAlignment(Qt::AlignRight);
        ignoreWheelWithoutFocus(*box);
        pauses_.emplace_back(key, box);
        connect(box, &QDoubleSpinBox::valueChanged, this, [this, key](double seconds) {
            rows_.setSeconds(current(), key, seconds);
            keep();
        });
        return box;
    }

    void showDetails() {
        const std::string name = current();
        const bool isOwn = !name.empty() && rows_.has(name);
        details_->setEnabled(isOwn);
        details_->setTitle(name.empty() ? QString() : programs().nameOf(fromUtf8(name)));
        remove_->setEnabled(isOwn);
        change_->setEnabled(!isOwn && !name.empty() && add_->isEnabled());
        const QSignalBlocker quietKeys(pasteKeys_);
        insertion_->setCurrentIndex(isOwn ? int(rows_.insertion(name)) : 0);
        pasteKeys_->setCurrentText(isOwn ? QString::fromStdString(rows_.pasteKeys(name)) : QString());
        pasteKeys_->setEnabled(!isOwn || rows_.insertion(name) != OwnApplicationRows::Insertion::Typed);
        for (const auto& [key, box] : pauses_) {
            const QSignalBlocker quiet(box);
            box->setValue(isOwn ? rows_.seconds(name, key) : 0);
        }
    }

    // A row with a mistake would make all of them count for nothing, so it is not kept.
    bool keep() {
        const std::string text = rows_.names().empty() ? std::string() : rows_.text();
        const auto table = ApplicationTable::read(services().builtInApplicationRows, "applications.json");
        const auto read =
            table && !text.empty() ? table.value().readRows(text, Setting) : Result<ApplicationRows>(ApplicationRows());
        if (!read) {
            showRows();
            tell(inUsersLanguage(read.error().message));
            return false;
        }
        const bool kept = text.empty() ? giveUp(Setting) : write(Setting, fromUtf8(text));
        return kept;
    }

    void tell(const QString& words) {
        problem_->setText(words);
        problem_->setVisible(!words.isEmpty());
    }

    OwnApplicationRows rows_;
    QStandardItemModel* model_ = nullptr;
    QSortFilterProxyModel* shown_ = nullptr;
    QTreeView* view_ = nullptr;
    ProgramAdder* add_ = nullptr;
    QPushButton* change_ = nullptr;
    QPushButton* remove_ = nullptr;
    QGroupBox* details_ = nullptr;
    QComboBox* insertion_ = nullptr;
    QComboBox* pasteKeys_ = nullptr;
    std::vector<std::pair<const char*, QDoubleSpinBox*>> pauses_;
    QLabel* problem_ = nullptr;
};

}  // namespace

PreferencesPage* makeApplicationsPage(const PreferencesPage::Around& around) {
    return new ApplicationsPage(around);
}

}  // namespace plume
