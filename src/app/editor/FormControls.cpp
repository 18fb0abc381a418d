#include "app/editor/FormControls.h"

#include <QCheckBox>
#include <QComboBox>
#include <QHBoxLayout>
#include <QLineEdit>
#include <QPlainTextEdit>
#include <QSpinBox>
#include <QTextDocument>
#include <algorithm>
#include <limits>

#include "app/qt/RawText.h"
#include "app/qt/Text.h"
#include "app/qt/WheelGuard.h"

namespace plume {

namespace {

constexpr int LinesShown = 4;

int shownNumber(std::int64_t number) {
    using Limits = std::numeric_limits<int>;
    return static_cast<int>(std::clamp<std::int64_t>(number, Limits::min(), Limits::max()));
}

}  // namespace

QLineEdit* makeLine(const std::optional<std::u16string>& text, std::function<void(std::u16string)> edited) {
    auto* line = new QLineEdit(toQString(text.value_or(u"")));
    QObject::connect(line, &QLineEdit::textChanged, line,
                     [edited = std::move(edited)](const QString& now) { edited(fromQString(now)); });
    return line;
}

QPlainTextEdit* makeLines(const std::optional<std::u16string>& text, std::function<void(std::u16string)> edited) {
    auto* lines = new QPlainTextEdit(toQString(text.value_or(u"")));
    lines->setTabChangesFocus(true);
    const int margins = static_cast<int>(2 * lines->document()->documentMargin()) + 2 * lines->frameWidth();
    lines->setMinimumHeight(LinesShown * lines->fontMetrics().lineSpacing() + margins);
    QObject::connect(lines, &QPlainTextEdit::textChanged, lines,
                     [lines, edited = std::move(edited)] { edited(fromQString(rawText(*lines->document()))); });
    return lines;
}

QSpinBox* makeNumber(std::int64_t value, std::int64_t least, std::int64_t most,
                     std::function<void(std::int64_t)> edited) {
    auto* number = new QSpinBox;
    number->setRange(shownNumber(least), shownNumber(most));
    number->setValue(shownNumber(value));
    ignoreWheelWithoutFocus(*number);
    QObject::connect(number, &QSpinBox::valueChanged, number, [edited = std::move(edited)](int now) { edited(now); });
    return number;
}

QCheckBox* makeTick(const QString& text, bool isOn, std::function<void(bool)> edited) {
    auto* tick = new QCheckBox(text);
    tick->setChecked(isOn);
    QObject::connect(tick, &QCheckBox::toggled, tick, std::move(edited));
    return tick;
}

QComboBox* makeChoice(const Choices& choices, std::int64_t value, const QString& unnamed,
                      std::function<void(std::int64_t)> edited) {
    auto* choice = new QComboBox;
    for (const auto& [each, name] : choices) choice->addItem(name, QVariant::fromValue<qlonglong>(each));
    int place = choice->findData(QVariant::fromValue<qlonglong>(value));
    if (place < 0) {
        choice->addItem(unnamed.arg(value), QVariant::fromValue<qlonglong>(value));
        place = choice->count() - 1;
    }
    choice->setCurrentIndex(place);
    choice->setSizeAdjustPolicy(QComboBox::AdjustToMinimumContentsLengthWithIcon);
    choice->setMinimumContentsLength(12);
    ignoreWheelWithoutFocus(*choice);
    QObject::connect(choice, &QComboBox::currentIndexChanged, choice,
                     [choice, edited = std::move(edited)](int) { edited(choice->currentData().toLongLong()); });
    return choice;
}

QWidget* makeRow(const std::vector<QWidget*>& widgets) {
    auto* row = new QWidget;
    auto* layout = new QHBoxLayout(row);
    layout->setContentsMargins({});
    for (QWidget* each : widgets) layout->addWidget(each);
    return row;
}

}  // namespace plume
