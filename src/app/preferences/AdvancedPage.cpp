#include <QCoreApplication>
#include <QHBoxLayout>
#include <QHeaderView>
#include <QLineEdit>
#include <QPushButton>
#include <QSortFilterProxyModel>
#include <QTreeView>
#include <QVBoxLayout>

#include "app/preferences/PreferencesPages.h"
#include "app/preferences/SettingsModel.h"
#include "library/LibrarySync.h"

namespace plume {

namespace {

constexpr int ValueWidth = 26;  // characters

class AdvancedPage final : public PreferencesPage {
    Q_DECLARE_TR_FUNCTIONS(AdvancedPage)
  public:
    explicit AdvancedPage(const Around& around) : PreferencesPage(around) {
        addNote(
            tr("Every setting by its name, as “plume settings” shows it. Values are JSON; those that you have set "
               "are bold. Press F2 to change one."));
        addFilling(tr("All settings"), makeList());
        connect(model_, &SettingsModel::told, this, &AdvancedPage::settingTold);
    }

    void follow(const Keys& keys) override {
        PreferencesPage::follow(keys);
        model_->follow();
        updateButton();
    }

  private:
    QWidget* makeList() {
        auto* all = new QWidget;
        auto* filter = new QLineEdit;
        filter->setPlaceholderText(tr("Filter settings"));
        filter->setAccessibleName(tr("Filter settings"));
        filter->setClearButtonEnabled(true);
        model_ = new SettingsModel(settings(), this);
        shown_ = new QSortFilterProxyModel(this);
        shown_->setSourceModel(model_);
        shown_->setFilterKeyColumn(-1);
        shown_->setFilterCaseSensitivity(Qt::CaseInsensitive);
        view_ = new QTreeView;
        view_->setModel(shown_);
        view_->setAccessibleName(tr("All settings"));
        view_->setRootIsDecorated(false);
        view_->setUniformRowHeights(true);
        view_->setAlternatingRowColors(true);
        view_->setEditTriggers(QAbstractItemView::DoubleClicked | QAbstractItemView::EditKeyPressed |
                               QAbstractItemView::SelectedClicked);
        view_->resizeColumnToContents(SettingsModel::Name);
        view_->header()->resizeSection(SettingsModel::Value, fontMetrics().averageCharWidth() * ValueWidth);
        all->setFocusProxy(view_);
        auto* layout = new QVBoxLayout(all);
        layout->setContentsMargins(0, 0, 0, 0);
        layout->addWidget(filter);
        layout->addWidget(view_, 1);
        layout->addLayout(makeButtons());
        connect(filter, &QLineEdit::textChanged, shown_, &QSortFilterProxyModel::setFilterFixedString);
        connect(view_->selectionModel(), &QItemSelectionModel::currentChanged, this, [this] { updateButton(); });
        return all;
    }

    QLayout* makeButtons() {
        auto* row = new QHBoxLayout;
        change_ = new QPushButton(tr("&Change…"));
        restore_ = new QPushButton(tr("&Use Default"));
        auto* diagnostics = new QPushButton(tr("&Show Diagnostics"));
        row->addWidget(change_);
        row->addWidget(restore_);
        row->addStretch(1);
        row->addWidget(diagnostics);
        connect(change_, &QPushButton::clicked, this, [this] {
            const QModelIndex value = view_->currentIndex().siblingAtColumn(SettingsModel::Value);
            view_->setCurrentIndex(value);
            view_->edit(value);
        });
        connect(restore_, &QPushButton::clicked, this, [this] { model_->restoreDefault(currentRow()); });
        connect(diagnostics, &QPushButton::clicked, this, [this] { services().showDiagnostics(); });
        updateButton();
        return row;
    }

    void settingTold(const QString& key, const QString& reason) {
        complain(reason);
        if (reason.isEmpty() && LibrarySync::isFolderSetting(key.toStdString())) services().syncSettingsChanged();
    }

    // Negative: none.
    int currentRow() const { return shown_->mapToSource(view_->currentIndex()).row(); }

    void updateButton() {
        const int row = currentRow();
        change_->setEnabled(row >= 0);
        restore_->setEnabled(row >= 0 && model_->isOwn(row));
    }

    SettingsModel* model_ = nullptr;
    QSortFilterProxyModel* shown_ = nullptr;
    QTreeView* view_ = nullptr;
    QPushButton* change_ = nullptr;
    QPushButton* restore_ = nullptr;
};

}  // namespace

PreferencesPage* makeAdvancedPage(const PreferencesPage::Around& around) {
    return new AdvancedPage(around);
}

}  // namespace plume
