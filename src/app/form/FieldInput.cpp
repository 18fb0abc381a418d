#include "app/form/FieldInput.h"

#include <QComboBox>
#include <QLabel>
#include <QLineEdit>
#include <QPlainTextEdit>
#include <QScrollBar>
#include <QSignalBlocker>
#include <QTextDocument>
#include <QValidator>
#include <algorithm>
#include <limits>
#include <utility>

#include "app/qt/Text.h"
#include "app/qt/WheelGuard.h"

namespace plume {

namespace {

// In characters; a field is not wider than the text in any case.
constexpr int NumberWidth = 12;
constexpr std::int64_t MostWidth = 200;
constexpr std::int64_t MostHeight = 15;
constexpr int LeastMenuWidth = 6;
constexpr int ReadonlyMargin = 3;

QString withoutLineBreaks(QString text) {
    text.replace(QLatin1String("\r\n"), QLatin1String(" "));
    for (const char16_t lineBreak : {u'\n', u'\r', u'\v', u'\f', u'\x85', u'\u2028', u'\u2029'}) {
        text.replace(QChar(lineBreak), QLatin1Char(' '));
    }
    return text;
}

// Nothing is refused, but one line has no line breaks, wherever they come from.
class OneLine final : public QValidator {
  public:
    using QValidator::QValidator;

    State validate(QString& input, int& position) const override {
        position = static_cast<int>(withoutLineBreaks(input.left(position)).size());
        input = withoutLineBreaks(input);
        return Acceptable;
    }
};

int widthOf(const QWidget& widget, std::int64_t characters) {
    return static_cast<int>(std::clamp<std::int64_t>(characters, 1, MostWidth)) *
           widget.fontMetrics().averageCharWidth();
}

class LineField final : public QLineEdit {
  public:
    explicit LineField(std::int64_t characters) : characters_(characters) {}

    QSize sizeHint() const override {
        constexpr int Frame = 12;
        return {widthOf(*this, characters_) + Frame, QLineEdit::sizeHint().height()};
    }
    QSize minimumSizeHint() const override { return {widthOf(*this, 2), QLineEdit::minimumSizeHint().height()}; }

  private:
    std::int64_t characters_;
};

FieldInput makeLine(const FormModel::Field& field, std::function<void()> edited) {
    const bool isNumber = field.variable->isNumber();
    auto* line = new LineField(isNumber ? NumberWidth : field.variable->width());
    line->setMaxLength(std::numeric_limits<int>::max());
    line->setValidator(new OneLine(line));
    line->setPlaceholderText(toQString(field.variable->name.value_or(u"")));
    if (isNumber) {
        line->setAlignment(Qt::AlignRight);
        line->setInputMethodHints(Qt::ImhFormattedNumbersOnly);
    }
    QObject::connect(line, &QLineEdit::textEdited, line, std::move(edited));
    return {line, [line] { return fromQString(line->text()); },
            [line](const std::u16string& value) {
                const QString text = withoutLineBreaks(toQString(value));
                if (line->text() != text) line->setText(text);
            },
            true, false};
}

class AreaField final : public QPlainTextEdit {
  public:
    AreaField(std::int64_t columns, std::int64_t rows) : columns_(columns), rows_(rows) {
        setTabChangesFocus(true);
        setLineWrapMode(QPlainTextEdit::WidgetWidth);
        ignoreWheelWithoutFocus(*this);
    }

    // An input method that composes says that the text has changed, too.
    bool takeChange() { return value() != std::exchange(known_, value()); }
    void show(const std::u16string& value) {
        const QSignalBlocker silence(this);
        setPlainText(toQString(value));
        known_ = this->value();
    }

    // Unlike toPlainText() it keeps spaces that do not break.
    std::u16string value() const {
        QString text = document()->toRawText();
        for (const char16_t lineBreak : {u'\u2028', u'\u2029'}) text.replace(QChar(lineBreak), QLatin1Char('\n'));
        return fromQString(text);
    }

    QSize sizeHint() const override {
        const int edge = 2 * (frameWidth() + qRound(document()->documentMargin()));
        const auto rows = static_cast<int>(std::clamp<std::int64_t>(rows_, 1, MostHeight));
        return {widthOf(*this, columns_) + edge + verticalScrollBar()->sizeHint().width(),
                rows * fontMetrics().lineSpacing() + edge};
    }
    QSize minimumSizeHint() const override { return {widthOf(*this, 2), sizeHint().height()}; }

  private:
    std::int64_t columns_;
    std::int64_t rows_;
    std::u16string known_;
};

FieldInput makeArea(const FormModel::Field& field, std::function<void()> edited) {
    auto* area = new AreaField(field.variable->width(), field.variable->height());
    area->setPlaceholderText(toQString(field.variable->name.value_or(u"")));
    QObject::connect(area, &QPlainTextEdit::textChanged, area, [area, edited = std::move(edited)] {
        if (area->takeChange()) edited();
    });
    return {area, [area] { return area->value(); },
            [area](const std::u16string& value) {
                if (area->value() != value) area->show(value);
            },
            true, true};
}

FieldInput makeMenu(const FormModel::Field& field, std::function<void()> edited) {
    auto* menu = new QComboBox;
    for (const std::u16string& choice : field.choices) menu->addItem(toQString(choice));
    menu->setSizeAdjustPolicy(QComboBox::AdjustToContents);
    menu->setMinimumWidth(widthOf(*menu, LeastMenuWidth));
    ignoreWheelWithoutFocus(*menu);
    QObject::connect(menu, &QComboBox::activated, menu, [edited = std::move(edited)] { edited(); });
    return {menu, [menu] { return fromQString(menu->currentText()); },
            [menu](const std::u16string& value) {
                // Lines may be equal, and the one that was picked stays picked.
                if (menu->currentText() != toQString(value)) menu->setCurrentIndex(menu->findText(toQString(value)));
            },
            false, false};
}

FieldInput makeReadonly(const FormModel::Field& field) {
    auto* label = new QLabel;
    label->setTextFormat(Qt::PlainText);
    label->setFrameShape(QFrame::StyledPanel);
    label->setMargin(ReadonlyMargin);
    label->setTextInteractionFlags(Qt::TextSelectableByMouse);
    label->setFocusPolicy(Qt::NoFocus);
    const bool isLarge = field.variable->isMultiline();
    return {label, [label] { return fromQString(label->text()); },
            [label](const std::u16string& value) { label->setText(toQString(value)); }, false, isLarge};
}

bool hasLineBreak(const std::u16string& text) {
    return text.find_first_of(u"\r\n\u2028\u2029") != std::u16string::npos;
}

}  // namespace

FieldInput makeFieldInput(const FormModel::Field& field, std::function<void()> edited) {
    if (field.isReadonly()) return makeReadonly(field);
    if (field.variable->isPopupMenu()) return makeMenu(field, std::move(edited));
    // An optional snippet of several lines is a field of one line, which would lose its line breaks when it is changed.
    const bool needsLines = field.variable->isSingleline() && hasLineBreak(field.value);
    if (field.variable->isMultiline() || needsLines) return makeArea(field, std::move(edited));
    return makeLine(field, std::move(edited));
}

}  // namespace plume
