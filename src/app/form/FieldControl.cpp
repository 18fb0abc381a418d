#include "app/form/FieldControl.h"

#include <QBoxLayout>
#include <QCheckBox>
#include <QFontDatabase>
#include <QGuiApplication>
#include <QInputMethod>
#include <QInputMethodEvent>
#include <QKeyEvent>
#include <QLabel>
#include <QPainter>
#include <QSignalBlocker>
#include <QStyle>
#include <algorithm>

#include "app/qt/Text.h"

namespace plume {

namespace {

// The tick says the same: the colours only help to find it.
constexpr QColor Ticked(0x32, 0xcd, 0x32);
constexpr QColor Unticked(0xdc, 0x14, 0x3c);
constexpr int Tint = 38;  // of 255: what is written on it can be read on light and dark windows
constexpr int BarWidth = 4;
constexpr int Rounding = 4;
constexpr QMargins OptionalMargins(10, 4, 8, 4);
constexpr QMargins UsualMargins(2, 2, 2, 2);

bool isReturn(const QKeyEvent& key) {
    return key.key() == Qt::Key_Return || key.key() == Qt::Key_Enter;
}

QLabel* makeScriptSymbol() {
    auto* symbol = new QLabel(QStringLiteral(">_"));
    symbol->setFont(QFontDatabase::systemFont(QFontDatabase::FixedFont));
    symbol->setForegroundRole(QPalette::PlaceholderText);
    symbol->setLayoutDirection(Qt::LeftToRight);
    return symbol;
}

}  // namespace

FieldControl::FieldControl(const FormModel::Field& field, const Names& names)
    : layout_(new QBoxLayout(QBoxLayout::LeftToRight, this)),
      input_(makeFieldInput(field,
                            [this] {
                                isEdited_ = true;
                                Q_EMIT edited();
                            })),
      warning_(new QWidget),
      problem_(new QLabel),
      name_(names.name),
      description_(names.description),
      isReadonly_(field.isReadonly()) {
    layout_->setContentsMargins(field.variable->isOptional ? OptionalMargins : UsualMargins);
    // The box of a script says its name, and there is no more to be shown of it.
    const bool isScript = field.variable->script != nullptr;
    if (field.variable->isOptional) makeBox(names.boxText, isScript);
    layout_->addWidget(input_.widget);
    if (isScript) input_.widget->hide();
    layout_->addWidget(makeWarning());
    input_.widget->setToolTip(names.name);
    input_.widget->installEventFilter(this);
    display(field, {});
}

QWidget* FieldControl::makeWarning() {
    auto* layout = new QHBoxLayout(warning_);
    layout->setContentsMargins({});
    auto* icon = new QLabel;
    const int size = fontMetrics().height();
    icon->setPixmap(style()->standardIcon(QStyle::SP_MessageBoxWarning).pixmap(size, size));
    problem_->setTextFormat(Qt::PlainText);
    layout->addWidget(icon);
    layout->addWidget(problem_);
    warning_->hide();
    return warning_;
}

void FieldControl::makeBox(const QString& text, bool isScript) {
    if (isScript) layout_->addWidget(makeScriptSymbol());
    box_ = new QCheckBox(text);
    box_->installEventFilter(this);
    connect(box_, &QCheckBox::clicked, this, &FieldControl::ticked);
    connect(box_, &QCheckBox::toggled, this, qOverload<>(&QWidget::update));
    layout_->addWidget(box_);
}

QWidget* FieldControl::input() const {
    return isReadonly_ ? nullptr : input_.widget;
}

void FieldControl::display(const FormModel::Field& field, const QString& problem) {
    const bool isBeingEdited = isEdited_ && input_.isText && input_.widget->hasFocus();
    if (!isBeingEdited) input_.show(field.value);
    if (box_) {
        const QSignalBlocker silence(box_);
        if (box_->isChecked() != field.selected) update();
        box_->setChecked(field.selected);
    }
    problem_->setText(problem);
    warning_->setVisible(!problem.isEmpty());
    describe(problem);
}

// For those who do not see the field: told anew only where it is another, because it is read out then.
void FieldControl::describe(const QString& problem) {
    QWidget& widget = *input_.widget;
    const QString value = isReadonly_ ? toQString(input_.value()) : QString();
    const QString name = value.isEmpty() ? name_ : tr("%1: %2", "a field's name and value").arg(name_, value);
    if (widget.accessibleName() != name) widget.setAccessibleName(name);
    const QString separator = problem.isEmpty() || description_.isEmpty() ? QString() : QStringLiteral(" ");
    const QString description = problem + separator + description_;
    if (widget.accessibleDescription() != description) widget.setAccessibleDescription(description);
}

void FieldControl::setRoom(int width) {
    room_ = width;
    if (auto* label = qobject_cast<QLabel*>(input_.widget)) {
        label->setWordWrap(false);
        label->setWordWrap(label->sizeHint().width() > width);
    }
    // Beside each other as long as there is room for that.
    layout_->setDirection(QBoxLayout::LeftToRight);
    const bool isBoxAbove = box_ && input_.isLarge;
    if (isBoxAbove || layout_->sizeHint().width() > width) layout_->setDirection(QBoxLayout::TopToBottom);
}

QSize FieldControl::sizeHint() const {
    const QSize wanted = layout_->sizeHint();
    if (room_ == 0 || wanted.width() <= room_) return wanted;
    return {room_, layout_->hasHeightForWidth() ? layout_->heightForWidth(room_) : wanted.height()};
}

bool FieldControl::eventFilter(QObject* object, QEvent* event) {
    switch (event->type()) {
        case QEvent::Shortcut:
            // At once, and without taking the focus from what the user types into.
            if (object != box_) break;
            box_->click();
            return true;
        case QEvent::InputMethod:
            isComposing_ = !static_cast<const QInputMethodEvent*>(event)->preeditString().isEmpty();
            break;
        case QEvent::KeyPress:
            return object != box_ && filterKey(*static_cast<QKeyEvent*>(event));
        case QEvent::FocusIn:
            Q_EMIT entered();
            break;
        case QEvent::FocusOut:
            if (static_cast<const QFocusEvent*>(event)->reason() != Qt::PopupFocusReason) Q_EMIT left();
            break;
        default:
            break;
    }
    return false;
}

bool FieldControl::filterKey(QKeyEvent& key) {
    if (isComposing_ && (isReturn(key) || key.key() == Qt::Key_Escape)) {
        if (isReturn(key)) {
            Q_EMIT keptReturn();
            QGuiApplication::inputMethod()->commit();
        } else {
            QGuiApplication::inputMethod()->reset();
        }
        return true;
    }
    if (!isReturn(key)) return false;
    if (!key.modifiers().testFlag(Qt::ControlModifier)) {
        if (isLarge()) Q_EMIT keptReturn();
        return false;
    }
    // It makes no line: it is the window's, as a key is that nobody has taken.
    key.ignore();
    return true;
}

void FieldControl::paintEvent(QPaintEvent* event) {
    InlineWidget::paintEvent(event);
    if (!box_) return;
    QPainter painter(this);
    painter.setRenderHint(QPainter::Antialiasing);
    painter.setPen(Qt::NoPen);
    QColor color = box_->isChecked() ? Ticked : Unticked;
    QRect bar = rect();
    bar.setWidth(BarWidth);
    if (layoutDirection() == Qt::RightToLeft) bar.moveRight(rect().right());
    painter.fillRect(bar, color);
    color.setAlpha(Tint);
    painter.setBrush(color);
    painter.drawRoundedRect(rect(), Rounding, Rounding);
}

ScriptMark::ScriptMark(const QString& name) : label_(new QLabel) {
    auto* layout = new QHBoxLayout(this);
    layout->setContentsMargins(UsualMargins);
    label_->setTextFormat(Qt::PlainText);
    label_->setText(name);
    label_->setAccessibleName(tr("Script: %1").arg(name));
    label_->setToolTip(tr("What this script prints comes here."));
    label_->setForegroundRole(QPalette::PlaceholderText);
    layout->addWidget(makeScriptSymbol());
    layout->addWidget(label_);
}

void ScriptMark::setRoom(int width) {
    room_ = width;
    label_->setWordWrap(false);
    label_->setWordWrap(layout()->sizeHint().width() > width);
}

QSize ScriptMark::sizeHint() const {
    const QSize wanted = layout()->sizeHint();
    if (room_ == 0 || wanted.width() <= room_) return wanted;
    return {room_, layout()->hasHeightForWidth() ? layout()->heightForWidth(room_) : wanted.height()};
}

}  // namespace plume
