#include "app/form/helper/PageWindow.h"

#include <QApplication>
#include <QBoxLayout>
#include <QCloseEvent>
#include <QScreen>
#include <QWebChannel>
#include <QWindow>
#include <algorithm>
#include <utility>

#include "app/form/helper/LockedPage.h"
#include "app/form/helper/PageProfile.h"
#include "app/form/helper/PageTemplate.h"
#include "app/form/helper/PageView.h"
#include "app/qt/PopupPlace.h"

namespace plume {

namespace {

constexpr double LargestHeight = 0.7;  // of the screen's
constexpr QSize SmallestSize(240, 100);
// What a window manager may put around it, until it is known.
constexpr QMargins LikelyFrame(2, 32, 2, 6);

}  // namespace

PageWindow::PageWindow(PageProfile& profile, const PrepareForm& form, Events events)
    : QWidget(nullptr, Qt::Window | Qt::WindowStaysOnTopHint),
      form_(form.form),
      events_(std::move(events)),
      link_(linkEvents()),
      view_(new PageView(this)) {
    setWindowTitle(form.title);
    setMinimumSize(SmallestSize);
    auto* const layout = new QVBoxLayout(this);
    layout->setContentsMargins({});
    layout->addWidget(view_);
    setFocusProxy(view_);
    profile.scheme().setPage(form_, pageOf(form));
    makePage(profile);
}

PageWindow::~PageWindow() = default;

PageLink::Events PageWindow::linkEvents() {
    return {.measured =
                [this](QSize size) {
                    measured_ = size;
                    appearWhenReady();
                },
            .drawn = [this] { pageDrawn(); },
            .filled =
                [this](int field, const QString& value, int choice, bool isUnreadable) {
                    FormFilled report{form_, field, value, {}, isUnreadable};
                    if (choice >= 0) report.choice = choice;
                    events_.reported(report);
                },
            .selected =
                [this](int field, bool selected) {
                    events_.reported(FormSelected{form_, field, selected});
                },
            .accepted = [this] { events_.reported(FormAccepted{form_}); },
            .cancelled = [this] { events_.reported(FormCancelled{form_}); },
            .stayed = [this] { events_.reported(FormStayed{form_}); }};
}

void PageWindow::makePage(PageProfile& profile) {
    auto* const page = new LockedPage(&profile.profile(), view_);
    auto* const channel = new QWebChannel(page);
    channel->registerObject(QStringLiteral("form"), &link_);
    page->setWebChannel(channel);
    page->setBackgroundColor(palette().color(QPalette::Window));
    connect(page, &QWebEnginePage::renderProcessTerminated, this, [this] { events_.died(); });
    view_->setPage(page);
    page->open(FormScheme::addressOf(form_));
}

// ---- Coming ----

void PageWindow::place(const FormPlace& place) {
    if (place_) return;
    place_ = place;
    appearWhenReady();
}

// The page is drawn while nobody waits for it, as a window that is not on the screen yet: it comes there complete.
void PageWindow::drawAhead(QSize size) {
    setAttribute(Qt::WA_DontShowOnScreen);
    resize(size);
    view_->setFocus();
    show();
    isDrawn_ = false;
    link_.appear();
}

void PageWindow::appearWhenReady() {
    if (!measured_ || isOnScreen_) return;
    const CaretPlace caret = place_ ? place_->caret : CaretPlace();
    const QSize inside = fittingSize(popupGeometry(caret, QSize(QWIDGETSIZE_MAX, QWIDGETSIZE_MAX)).size());
    if (!isVisible() || inside != size()) return drawAhead(inside);
    if (place_ && isDrawn_) comeToScreen(popupGeometry(caret, inside.grownBy(LikelyFrame)));
}

void PageWindow::comeToScreen(const QRect& frame) {
    isOnScreen_ = true;
    setGeometry(frame.marginsRemoved(LikelyFrame));
    setAttribute(Qt::WA_DontShowOnScreen, false);
    view_->focusProxy()->installEventFilter(this);
    windowHandle()->installEventFilter(this);
    windowHandle()->show();
    raise();
}

QSize PageWindow::fittingSize(QSize room) const {
    if (place_ && place_->size) {
        const QSize wanted(qRound(place_->size->width), qRound(place_->size->height));
        return wanted.expandedTo(SmallestSize).boundedTo(room.shrunkBy(LikelyFrame));
    }
    const QSize most(room.shrunkBy(LikelyFrame).width(), qRound(room.height() * LargestHeight));
    return measured_->boundedTo(most).expandedTo(SmallestSize);
}

// The window manager's frame counts too, which is known only once it is there.
void PageWindow::keepOnScreen() {
    const QRect room = screen()->availableGeometry();
    const QRect frame = frameGeometry();
    const int x = std::max(room.left(), std::min(frame.left(), room.right() + 1 - frame.width()));
    const int y = std::max(room.top(), std::min(frame.top(), room.bottom() + 1 - frame.height()));
    if (QPoint(x, y) != frame.topLeft()) move(x, y);
}

void PageWindow::pageDrawn() {
    isDrawn_ = true;
    appearWhenReady();
}

// What was painted before the window was there is painted once more, so that it can be waited for.
bool PageWindow::eventFilter(QObject* watched, QEvent* event) {
    const bool isThere = windowHandle()->isExposed();
    if (isThere && event->type() == QEvent::Expose) view_->focusProxy()->update();
    if (isThere && event->type() == QEvent::Paint) {
        QMetaObject::invokeMethod(this, "painted", Qt::QueuedConnection);
    }
    return QWidget::eventFilter(watched, event);
}

void PageWindow::painted() {
    if (std::exchange(isTold_, true)) return;
    view_->focusProxy()->removeEventFilter(this);
    windowHandle()->removeEventFilter(this);
    keepOnScreen();
    events_.reported(FormSized{form_, {double(width()), double(height())}});
    events_.reported(FormShown{form_, static_cast<std::uint32_t>(winId())});
}

// ---- While it is there ----

void PageWindow::update(const UpdateForm& order) {
    link_.update(objectOf(order));
}

void PageWindow::changeEvent(QEvent* event) {
    QWidget::changeEvent(event);
    if (event->type() != QEvent::PaletteChange || !view_->page()) return;
    view_->page()->setBackgroundColor(palette().color(QPalette::Window));
    link_.setColours(coloursOfPage());
}

void PageWindow::closeEvent(QCloseEvent* event) {
    // Plume closes it, once it has taken the keyboard back.
    event->ignore();
    events_.reported(FormCancelled{form_});
}

void PageWindow::resizeEvent(QResizeEvent* event) {
    QWidget::resizeEvent(event);
    if (isTold_) events_.reported(FormSized{form_, {double(width()), double(height())}});
}

}  // namespace plume
