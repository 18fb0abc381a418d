// Controls of the forms of placeholders that tell what the user does to them, and nothing else.
//
// On the main thread; whoever puts them into a layout gives them an owner. The wheel changes none of them without the
// focus.
#pragma once

#include <QString>
#include <functional>
#include <optional>
#include <string>
#include <utility>
#include <vector>

class QCheckBox;
class QComboBox;
class QLineEdit;
class QPlainTextEdit;
class QSpinBox;
class QWidget;

namespace plume {

QLineEdit* makeLine(const std::optional<std::u16string>& text, std::function<void(std::u16string)> edited);
// Tab leaves it. Its texts are with line feeds.
QPlainTextEdit* makeLines(const std::optional<std::u16string>& text, std::function<void(std::u16string)> edited);
// A number beyond what a control shows is kept until it is changed.
QSpinBox* makeNumber(std::int64_t value, std::int64_t least, std::int64_t most,
                     std::function<void(std::int64_t)> edited);
QCheckBox* makeTick(const QString& text, bool isOn, std::function<void(bool)> edited);

// A choice of values with their names. A value that has none is shown as `unnamed`, with its number for %1.
using Choices = std::vector<std::pair<std::int64_t, QString>>;
QComboBox* makeChoice(const Choices& choices, std::int64_t value, const QString& unnamed,
                      std::function<void(std::int64_t)> edited);

// Side by side.
QWidget* makeRow(const std::vector<QWidget*>& widgets);

}  // namespace plume
