#include "app/form/PlainFormWindow.h"

#include <QCheckBox>
#include <QCloseEvent>
#include <QCoreApplication>
#include <QDialogButtonBox>
#include <QGuiApplication>
#include <QKeyEvent>
#include <QLabel>
#include <QPointer>
#include <QPushButton>
#include <QScreen>
#include <QScrollBar>
#include <QVBoxLayout>
#include <algorithm>
#include <utility>

#include "app/form/FieldControl.h"
#include "app/form/FieldLetters.h"
#include "app/form/FormWords.h"
#include "app/form/InlineText.h"
#include "app/qt/Labels.h"
#include "app/qt/PopupPlace.h"
#include "app/qt/Text.h"

namespace plume {

namespace {

constexpr int LeastWindowWidth = 420;
constexpr int MostWindowWidth = 640;
constexpr int MostWindowWidthInLines = 40;  // where letters are large
constexpr double MostOfScreen = 0.7;        // of its height
constexpr QSize RoomForFrame(16, 48);       // nobody knows it before the window stands there
constexpr qsizetype LongestName = 60;
constexpr qsizetype LongestDescription = 200;

QTextCharFormat formatOf(const SharedAttributes& attributes) {
    QTextCharFormat format;
    if (!attributes) return format;
    if (attributes->font && attributes->font->bold) format.setFontWeight(QFont::Bold);
    if (attributes->font && attributes->font->italic) format.setFontItalic(true);
    if (attributes->underlineStyle != 0) format.setFontUnderline(true);
    if (attributes->strikethroughStyle != 0) format.setFontStrikeOut(true);
    return format;
}

// Pictures and other things that a snippet holds are not drawn.
QString readable(const std::u16string& text) {
    return toQString(text).replace(QChar(QChar::ObjectReplacementCharacter), QChar(u'▢'));
}

QString shortened(const QString& name) {
    return name.size() > LongestName ? name.left(LongestName - 1) + QChar(u'…') : name;
}

// In titles of windows "[*]" is a mark of Qt's.
QString titleText(const std::u16string& title) {
    return toQString(title).simplified().replace(QLatin1String("[*]"), QLatin1String("[*][*]"));
}

}  // namespace

PlainFormWindow::PlainFormWindow(const FormModel& model, const SnippetExpandedContent& content,
                                 const std::u16string& title, Events events)
    : QDialog(nullptr, Qt::Window | Qt::WindowStaysOnTopHint | Qt::WindowTitleHint | Qt::WindowSystemMenuHint |
                           Qt::WindowCloseButtonHint),
      model_(model),
      events_(std::move(events)),
      text_(new InlineText),
      hint_(makeHelpLabel({})),
      length_(makeHelpLabel({})),
      fields_(model.fields().size()) {
    setAttribute(Qt::WA_QuitOnClose, false);
    setWindowTitle(titleText(title));
    text_->setAccessibleName(tr("Text of the snippet"));
    auto* layout = new QVBoxLayout(this);
    layout->addWidget(text_, 1);
    auto* line = new QFrame;
    line->setFrameShape(QFrame::HLine);
    line->setForegroundRole(QPalette::Mid);
    layout->addWidget(line);
    fillText(formLines(content));
    layout->addWidget(makeFoot());
    focusFirst();
    update();
}

// Fields that lose the focus on the way have nothing to tell.
PlainFormWindow::~PlainFormWindow() {
    for (const Shown& field : fields_) {
        if (field.control) field.control->disconnect(this);
    }
}

QWidget* PlainFormWindow::makeFoot() {
    auto* foot = new QWidget;
    auto* layout = new QVBoxLayout(foot);
    layout->setContentsMargins({});
    layout->addWidget(length_);
    layout->addWidget(hint_);
    auto* buttons = new QDialogButtonBox;
    // Alt and a letter are the optional parts'.
    auto* insert = buttons->addButton(insertLabel(), QDialogButtonBox::AcceptRole);
    insert->setDefault(true);
    buttons->addButton(cancelLabel(), QDialogButtonBox::RejectRole);
    connect(buttons, &QDialogButtonBox::accepted, this, &PlainFormWindow::accept);
    connect(buttons, &QDialogButtonBox::rejected, this, &PlainFormWindow::reject);
    layout->addWidget(buttons);
    return foot;
}

void PlainFormWindow::fillText(const std::vector<FormLine>& lines) {
    const std::vector<QString> texts = boxTexts();
    // The text is laid out once.
    QTextCursor filling(text_->document());
    filling.beginEditBlock();
    for (std::size_t index = 0; index < lines.size(); ++index) {
        if (index > 0) text_->appendLineBreak();
        lineState_ = LineState::Empty;
        QString before;
        for (const FormPiece& piece : lines[index]) addPiece(piece, texts, before);
    }
    filling.endEditBlock();
}

void PlainFormWindow::addPiece(const FormPiece& piece, const std::vector<QString>& boxTexts, QString& before) {
    if (piece.kind == FormPiece::Kind::Field) {
        addField(piece.field, boxTexts[piece.field], before.trimmed().right(LongestDescription));
        before += QChar(u'…');
        return;
    }
    beginPiece(false);
    if (piece.kind == FormPiece::Kind::Script) {
        text_->appendWidget(new ScriptMark(shortened(toQString(piece.text))));
    } else {
        text_->appendText(readable(piece.text), formatOf(piece.attributes));
    }
    before += toQString(piece.text);
}

// What takes whole lines begins one, and ends it before whatever follows.
void PlainFormWindow::beginPiece(bool isLarge) {
    const bool follows = lineState_ != LineState::Empty;
    if (lineState_ == LineState::Full || (isLarge && follows)) text_->appendLineBreak();
    lineState_ = isLarge ? LineState::Full : LineState::Begun;
}

void PlainFormWindow::addField(std::size_t field, const QString& boxText, const QString& before) {
    const FormModel::Field& shown = model_.fields()[field];
    if (!shown.hasControl()) return;
    auto* control = new FieldControl(shown, {nameOf(field), boxText, before});
    beginPiece(control->isLarge());
    text_->appendWidget(control);
    fields_[field].control = control;
    connectField(field);
}

QString PlainFormWindow::nameOf(std::size_t field) const {
    const SnippetFieldVariable& variable = *model_.fields()[field].variable;
    QString name = toQString(variable.name.value_or(u"")).simplified();
    if (!name.isEmpty()) return name;
    if (variable.script) return toQString(variable.value.value_or(u"")).simplified();
    return tr("Field %1").arg(field + 1);
}

// Of fields that are not optional: nothing.
std::vector<QString> PlainFormWindow::boxTexts() const {
    std::vector<std::size_t> optional;
    std::vector<QString> names;
    for (std::size_t field = 0; field < model_.fields().size(); ++field) {
        const FormModel::Field& shown = model_.fields()[field];
        if (!shown.variable->isOptional || !shown.hasControl()) continue;
        optional.push_back(field);
        names.push_back(shortened(nameOf(field)));
    }
    std::vector<QString> texts(model_.fields().size());
    std::vector<QString> lettered = withLetters(names);
    for (std::size_t index = 0; index < optional.size(); ++index) texts[optional[index]] = std::move(lettered[index]);
    return texts;
}

void PlainFormWindow::connectField(std::size_t field) {
    const FieldControl& control = *fields_[field].control;
    connect(&control, &FieldControl::edited, this, [this, field] { edited(field); });
    connect(&control, &FieldControl::ticked, this, [this, field](bool isOn) {
        post([this, field, isOn] {
            const auto selected = events_.selected;
            selected(field, isOn);
        });
    });
    connect(&control, &FieldControl::entered, text_, [this, &control] { text_->reveal(control); });
    // Behind what was typed into it last.
    connect(&control, &FieldControl::keptReturn, this, [this] {
        if (events_.stayed) post(events_.stayed);
    });
    connect(&control, &FieldControl::left, this, [this, field] {
        post([this, field] {
            fields_[field].control->finishEditing();
            display(field);
        });
    });
}

// As when the user comes there with Tab: what stands there is selected.
void PlainFormWindow::focusFirst() {
    for (const Shown& shown : fields_) {
        QWidget* input = shown.control ? shown.control->input() : nullptr;
        if (!input) continue;
        input->setFocus(Qt::TabFocusReason);
        return;
    }
}

void PlainFormWindow::show(const FormPlace& place) {
    const QRect caret = popupGeometry(place.caret, {1, 1});
    const QScreen* screen = QGuiApplication::screenAt(caret.topLeft());
    if (!screen) screen = QGuiApplication::primaryScreen();
    const QRect room = screen->availableGeometry();
    QSize wanted = wantedSize(room);
    if (place.size) wanted = QSize(qRound(place.size->width), qRound(place.size->height));
    const QRect frame = popupGeometry(place.caret, wanted + RoomForFrame);
    move(frame.topLeft());
    resize(frame.size() - RoomForFrame);
    QDialog::show();
}

QSize PlainFormWindow::wantedSize(const QRect& room) const {
    const QMargins edges = layout()->contentsMargins();
    const int aside = edges.left() + edges.right();
    const int most = std::max(MostWindowWidth, MostWindowWidthInLines * fontMetrics().height());
    const int width = std::clamp(text_->idealWidth() + aside, LeastWindowWidth, most);
    const int foot = layout()->totalHeightForWidth(width) - text_->sizeHint().height();
    const int height = text_->heightForWidth(width - aside) + foot;
    return {std::min(width, room.width()), std::min(height, static_cast<int>(room.height() * MostOfScreen))};
}

void PlainFormWindow::update() {
    for (std::size_t field = 0; field < fields_.size(); ++field) display(field);
    hint_->setText(hintLine(model_));
    length_->setText(lengthLine(model_));
}

// Not before the model knows what the user has done last.
void PlainFormWindow::display(std::size_t field) {
    const Shown& shown = fields_[field];
    if (shown.control && shown.isTold) {
        shown.control->display(model_.fields()[field], wordsFor(model_.problem(field)));
    }
}

std::optional<Size> PlainFormWindow::size() const {
    if (!isDrawn_) return std::nullopt;
    return Size{static_cast<double>(width()), static_cast<double>(height())};
}

void PlainFormWindow::accept() {
    end(events_.accepted);
}

void PlainFormWindow::reject() {
    end(events_.cancelled);
}

void PlainFormWindow::keyPressEvent(QKeyEvent* event) {
    const bool isReturn = event->key() == Qt::Key_Return || event->key() == Qt::Key_Enter;
    if (isReturn && event->modifiers().testFlag(Qt::ControlModifier)) {
        accept();
    } else if (event->key() == Qt::Key_PageDown) {
        text_->verticalScrollBar()->triggerAction(QAbstractSlider::SliderPageStepAdd);
    } else if (event->key() == Qt::Key_PageUp) {
        text_->verticalScrollBar()->triggerAction(QAbstractSlider::SliderPageStepSub);
    } else {
        QDialog::keyPressEvent(event);
    }
}

// The window goes when its owner lets it go.
void PlainFormWindow::closeEvent(QCloseEvent* event) {
    event->ignore();
    reject();
}

void PlainFormWindow::paintEvent(QPaintEvent* event) {
    QDialog::paintEvent(event);
    if (std::exchange(isDrawn_, true)) return;
    post([this] {
        const auto shown = events_.shown;
        shown(static_cast<std::uint32_t>(winId()));
    });
}

void PlainFormWindow::edited(std::size_t field) {
    // What is typed before the first letter is told is told with it.
    if (!std::exchange(fields_[field].isTold, false)) return;
    post([this, field] { tellFilled(field); });
}

void PlainFormWindow::tellFilled(std::size_t field) {
    fields_[field].isTold = true;
    const auto filled = events_.filled;
    filled(field, fields_[field].control->value());
}

void PlainFormWindow::end(std::function<void()> event) {
    if (std::exchange(isEnded_, true)) return;
    post([window = QPointer(this), event = std::move(event)] {
        event();
        // Who keeps it wants more of the user.
        if (window) window->isEnded_ = false;
    });
}

// Events come in the order of what the user does, and from outside the window's own calls, where it may be destroyed.
void PlainFormWindow::post(std::function<void()> event) {
    posted_.push_back(std::move(event));
    QMetaObject::invokeMethod(this, "deliver", Qt::QueuedConnection);
}

// Who is told may end the window.
void PlainFormWindow::deliver() {
    const auto event = std::move(posted_.front());
    posted_.pop_front();
    event();
}

}  // namespace plume
