#include "app/preferences/ApplicationList.h"

#include <QHBoxLayout>
#include <QKeyEvent>
#include <QLabel>
#include <QListView>
#include <QPushButton>
#include <QStandardItemModel>
#include <QVBoxLayout>
#include <algorithm>

#include "app/preferences/ProgramAdder.h"
#include "app/preferences/ProgramCatalog.h"
#include "app/qt/Text.h"

namespace plume {

namespace {

constexpr int VisibleRows = 6;

}  // namespace

ApplicationList::ApplicationList(const ProgramServices& services, ProgramCatalog& programs, QWidget* parent)
    : QWidget(parent),
      programs_(programs),
      model_(new QStandardItemModel(this)),
      title_(new QLabel),
      view_(new QListView),
      remove_(new QPushButton(tr("Remove"))),
      words_(new QLabel) {
    view_->setModel(model_);
    view_->setUniformItemSizes(true);
    view_->setEditTriggers(QAbstractItemView::NoEditTriggers);
    view_->setSelectionMode(QAbstractItemView::ExtendedSelection);
    view_->setFixedHeight(fontMetrics().height() * VisibleRows * 4 / 3);
    view_->installEventFilter(this);
    title_->setBuddy(view_);
    setFocusProxy(view_);
    words_->setWordWrap(true);
    words_->hide();
    remove_->setEnabled(false);

    auto* adder = new ProgramAdder(services, programs);
    auto* buttons = new QVBoxLayout;
    buttons->addWidget(adder);
    buttons->addWidget(remove_);
    buttons->addStretch(1);
    auto* middle = new QHBoxLayout;
    middle->addWidget(view_, 1);
    middle->addLayout(buttons);
    auto* layout = new QVBoxLayout(this);
    layout->setContentsMargins(0, 0, 0, 0);
    layout->addWidget(title_);
    layout->addLayout(middle);
    layout->addWidget(words_);
    setSizePolicy(QSizePolicy::Expanding, QSizePolicy::Fixed);

    connect(adder, &ProgramAdder::chosen, this, &ApplicationList::addAll);
    connect(adder, &ProgramAdder::told, this, &ApplicationList::tell);
    connect(remove_, &QPushButton::clicked, this, &ApplicationList::removeSelected);
    connect(view_->selectionModel(), &QItemSelectionModel::selectionChanged, this,
            [this] { remove_->setEnabled(view_->selectionModel()->hasSelection()); });
}

void ApplicationList::setTitle(const QString& title) {
    title_->setText(title);
    view_->setAccessibleName(title);
}

void ApplicationList::setIdentifiers(const Identifiers& identifiers) {
    if (identifiers == identifiers_) return;
    identifiers_ = identifiers;
    model_->clear();
    for (const std::u16string& identifier : identifiers_) {
        auto* item = new QStandardItem(programs_.iconOf(identifier), programs_.nameOf(identifier));
        item->setToolTip(toQString(identifier));
        model_->appendRow(item);
    }
}

bool ApplicationList::eventFilter(QObject* object, QEvent* event) {
    if (event->type() == QEvent::KeyPress) {
        const int key = static_cast<QKeyEvent*>(event)->key();
        if (key == Qt::Key_Delete || key == Qt::Key_Backspace) {
            removeSelected();
            return true;
        }
    }
    return QWidget::eventFilter(object, event);
}

void ApplicationList::addAll(const Identifiers& added) {
    Identifiers all = identifiers_;
    QString there;
    for (const std::u16string& identifier : added) {
        if (std::find(all.begin(), all.end(), identifier) == all.end()) {
            all.push_back(identifier);
        } else {
            there = tr("%1 is in the list already.").arg(programs_.nameOf(identifier));
        }
    }
    tell(there);
    if (all == identifiers_) return;
    setIdentifiers(all);
    const QModelIndex last = model_->index(model_->rowCount() - 1, 0);
    view_->setCurrentIndex(last);
    Q_EMIT edited(identifiers_);
}

void ApplicationList::removeSelected() {
    Identifiers left;
    for (int row = 0; row < model_->rowCount(); ++row) {
        if (!view_->selectionModel()->isSelected(model_->index(row, 0))) {
            left.push_back(identifiers_[static_cast<std::size_t>(row)]);
        }
    }
    if (left == identifiers_) return;
    const int place = view_->currentIndex().row();
    tell({});
    setIdentifiers(left);
    view_->setCurrentIndex(model_->index(std::min(place, model_->rowCount() - 1), 0));
    Q_EMIT edited(identifiers_);
}

void ApplicationList::tell(const QString& words) {
    words_->setText(words);
    words_->setVisible(!words.isEmpty());
}

}  // namespace plume
