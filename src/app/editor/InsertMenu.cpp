#include "app/editor/InsertMenu.h"

#include <QGuiApplication>
#include <QKeyEvent>
#include <QLabel>
#include <QLineEdit>
#include <QListView>
#include <QPointer>
#include <QScreen>
#include <QVBoxLayout>
#include <algorithm>
#include <utility>

#include "app/editor/ChipForm.h"
#include "app/editor/InsertModel.h"
#include "app/qt/Labels.h"
#include "app/search/SnippetRowDelegate.h"

namespace plume {

namespace {

constexpr int WidthInLines = 26;
constexpr int HeightInLines = 24;

// Its window is out of the way while a row of it is dragged.
class DraggedOutList final : public QListView {
  public:
    using QListView::QListView;

  protected:
    void startDrag(Qt::DropActions actions) override {
        // The pointer belongs to the window in which the drag began until the button is let go: the window may be
        // anywhere, but it has to be there.
        const QPointer<QWidget> menu = window();
        constexpr int OutOfSight = -20'000;
        menu->move(OutOfSight, OutOfSight);
        QListView::startDrag(actions);
        if (menu) menu->hide();
    }
};

}  // namespace

InsertMenu::InsertMenu(ChipFormServices services, QWidget* parent)
    : QFrame(parent, Qt::Popup),
      services_(std::move(services)),
      model_(new InsertModel(this)),
      query_(new QLineEdit),
      list_(new DraggedOutList),
      nothing_(makeHelpLabel(tr("Nothing was found."))) {
    setFrameShape(StyledPanel);
    setAccessibleName(tr("Insert"));
    query_->setPlaceholderText(tr("Search what to insert"));
    query_->setAccessibleName(tr("Search what to insert"));
    query_->setClearButtonEnabled(true);
    query_->setContextMenuPolicy(Qt::NoContextMenu);
    query_->installEventFilter(this);
    connect(query_, &QLineEdit::textChanged, this, &InsertMenu::search);
    list_->setModel(model_);
    list_->setItemDelegate(new SnippetRowDelegate(list_));
    list_->setAccessibleName(tr("What can be inserted"));
    list_->setFocusPolicy(Qt::NoFocus);
    list_->setFrameShape(NoFrame);
    list_->setUniformItemSizes(true);
    list_->setHorizontalScrollBarPolicy(Qt::ScrollBarAlwaysOff);
    list_->setEditTriggers(QAbstractItemView::NoEditTriggers);
    list_->setDragEnabled(true);
    list_->setDragDropMode(QAbstractItemView::DragOnly);
    connect(list_, &QListView::clicked, this, [this](const QModelIndex& index) { choose(index.row()); });
    const int space = fontMetrics().height() / 2;
    nothing_->setContentsMargins(space, 0, space, space);
    auto* layout = new QVBoxLayout(this);
    layout->setContentsMargins({});
    auto* top = new QVBoxLayout;
    top->setContentsMargins(space, space, space, 0);
    top->addWidget(query_);
    layout->addLayout(top);
    layout->addWidget(nothing_);
    layout->addWidget(list_, 1);
}

void InsertMenu::open(const QPoint& corner) {
    model_->setRows(insertRows(services_));
    query_->clear();
    search();
    const int line = fontMetrics().height();
    const QScreen* screen = QGuiApplication::screenAt(corner);
    const QRect area = (screen ? screen : QGuiApplication::primaryScreen())->availableGeometry();
    const QSize size = QSize(WidthInLines * line, HeightInLines * line).boundedTo(area.size());
    resize(size);
    move(std::clamp(corner.x(), area.left(), area.right() + 1 - size.width()),
         std::clamp(corner.y(), area.top(), area.bottom() + 1 - size.height()));
    show();
    query_->setFocus();
}

// What was searched for is not kept.
void InsertMenu::hideEvent(QHideEvent* event) {
    QFrame::hideEvent(event);
    query_->setText({});
    model_->setRows({});
}

void InsertMenu::search() {
    model_->search(query_->text());
    nothing_->setVisible(model_->rowCount() == 0);
    selectRow(0);
}

void InsertMenu::selectRow(int row) {
    row = std::clamp(row, 0, std::max(0, model_->rowCount() - 1));
    list_->setCurrentIndex(model_->index(row, 0));
    list_->scrollTo(list_->currentIndex());
}

// ---- Keys ----

bool InsertMenu::eventFilter(QObject* watched, QEvent* event) {
    if (watched != query_ || event->type() != QEvent::KeyPress) return QFrame::eventFilter(watched, event);
    const auto& key = static_cast<const QKeyEvent&>(*event);
    if ((key.modifiers() & ~Qt::KeypadModifier) != Qt::NoModifier) return false;
    switch (key.key()) {
        case Qt::Key_Return:
        case Qt::Key_Enter:
            choose(list_->currentIndex().row());
            return true;
        case Qt::Key_Escape:
            hide();
            return true;
        default:
            return moveBy(key.key());
    }
}

bool InsertMenu::moveBy(int key) {
    const int row = list_->currentIndex().row();
    const int page = std::max(1, list_->viewport()->height() / std::max(1, list_->sizeHintForRow(0)) - 1);
    switch (key) {
        case Qt::Key_Down:
            selectRow(row + 1);
            return true;
        case Qt::Key_Up:
            selectRow(row - 1);
            return true;
        case Qt::Key_PageDown:
            selectRow(row + page);
            return true;
        case Qt::Key_PageUp:
            selectRow(row - page);
            return true;
        default:
            return false;
    }
}

// ---- What is chosen ----

void InsertMenu::choose(int row) {
    const InsertRow* chosenRow = model_->rowAt(row);
    if (!chosenRow) return;
    const std::u16string body = chosenRow->body;
    const bool asks = chosenRow->asks;
    hide();
    asks ? ask(body) : Q_EMIT chosen(body);
}

void InsertMenu::ask(const std::u16string& body) {
    QWidget* at = parentWidget() ? parentWidget() : this;
    ChipForm::open(at, body, services_, [menu = QPointer(this)](const std::u16string& accepted) {
        if (menu) Q_EMIT menu->chosen(accepted);
    });
}

}  // namespace plume
