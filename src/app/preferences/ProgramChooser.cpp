#include "app/preferences/ProgramChooser.h"

#include <QDialogButtonBox>
#include <QHeaderView>
#include <QKeyEvent>
#include <QLabel>
#include <QLineEdit>
#include <QPushButton>
#include <QSortFilterProxyModel>
#include <QStandardItemModel>
#include <QTreeView>
#include <QVBoxLayout>

#include "app/preferences/ProgramCatalog.h"
#include "app/qt/Text.h"

namespace plume {

namespace {

constexpr QSize Opening(520, 420);

}  // namespace

ProgramChooser::ProgramChooser(const QString& title, ProgramCatalog& programs, QWidget* parent)
    : QDialog(parent),
      programs_(programs),
      model_(new QStandardItemModel(0, 2, this)),
      shown_(new QSortFilterProxyModel(this)),
      filter_(new QLineEdit),
      view_(new QTreeView),
      nothing_(new QLabel(tr("No programs are there to choose from."))) {
    setAttribute(Qt::WA_DeleteOnClose);
    setWindowTitle(title);
    resize(Opening);
    model_->setHorizontalHeaderLabels({tr("Program"), tr("Identifier")});
    shown_->setSourceModel(model_);
    shown_->setFilterKeyColumn(-1);
    shown_->setFilterCaseSensitivity(Qt::CaseInsensitive);
    shown_->setSortCaseSensitivity(Qt::CaseInsensitive);
    filter_->setPlaceholderText(tr("Filter"));
    filter_->setAccessibleName(tr("Filter"));
    filter_->setClearButtonEnabled(true);
    filter_->installEventFilter(this);
    view_->setModel(shown_);
    view_->setAccessibleName(tr("Programs"));
    view_->setRootIsDecorated(false);
    view_->setUniformRowHeights(true);
    view_->setEditTriggers(QAbstractItemView::NoEditTriggers);
    view_->setSelectionMode(QAbstractItemView::ExtendedSelection);
    view_->setSelectionBehavior(QAbstractItemView::SelectRows);
    view_->setSortingEnabled(true);
    view_->sortByColumn(0, Qt::AscendingOrder);

    auto* buttons = new QDialogButtonBox;
    add_ = buttons->addButton(tr("&Add Program"), QDialogButtonBox::AcceptRole);
    buttons->addButton(tr("&Cancel"), QDialogButtonBox::RejectRole);
    auto* layout = new QVBoxLayout(this);
    layout->addWidget(filter_);
    layout->addWidget(view_, 1);
    layout->addWidget(nothing_);
    layout->addWidget(buttons);
    connect(buttons, &QDialogButtonBox::accepted, this, &ProgramChooser::choose);
    connect(buttons, &QDialogButtonBox::rejected, this, &ProgramChooser::reject);
    connect(view_, &QTreeView::activated, this, &ProgramChooser::choose);
    connect(view_->selectionModel(), &QItemSelectionModel::selectionChanged, this, &ProgramChooser::updateButton);
    connect(filter_, &QLineEdit::textChanged, this, [this](const QString& text) {
        shown_->setFilterFixedString(text);
        if (!view_->selectionModel()->hasSelection()) view_->setCurrentIndex(shown_->index(0, 0));
    });
    updateButton();
    filter_->setFocus();
}

void ProgramChooser::setPrograms(const Identifiers& identifiers) {
    model_->removeRows(0, model_->rowCount());
    for (const std::u16string& identifier : identifiers) {
        auto* name = new QStandardItem(programs_.iconOf(identifier), programs_.nameOf(identifier));
        model_->appendRow({name, new QStandardItem(toQString(identifier))});
    }
    nothing_->setVisible(identifiers.empty());
    view_->header()->resizeSection(0, width() / 2);
    view_->setCurrentIndex(shown_->index(0, 0));
    updateButton();
}

// The list is walked from the filter's line.
bool ProgramChooser::eventFilter(QObject* object, QEvent* event) {
    if (object != filter_ || event->type() != QEvent::KeyPress) return QDialog::eventFilter(object, event);
    if (static_cast<QKeyEvent*>(event)->key() != Qt::Key_Down) return false;
    view_->setFocus();
    return true;
}

void ProgramChooser::updateButton() {
    add_->setEnabled(view_->selectionModel()->hasSelection());
}

void ProgramChooser::choose() {
    Identifiers identifiers;
    for (const QModelIndex& index : view_->selectionModel()->selectedRows(1)) {
        identifiers.push_back(fromQString(index.data().toString()));
    }
    if (identifiers.empty()) return;
    Q_EMIT chosen(identifiers);
    accept();
}

}  // namespace plume
