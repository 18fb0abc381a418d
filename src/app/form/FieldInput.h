// What the value of a field is typed into, or chosen or read in: one widget for each kind of field.
//
// On the main thread; whoever puts the widget into a layout gives it an owner.
#pragma once

#include <functional>
#include <string>

#include "app/FormModel.h"

class QWidget;

namespace plume {

struct FieldInput {
    QWidget* widget = nullptr;
    std::function<std::u16string()> value;
    // What is shown already stays, with its caret and its selection.
    std::function<void(const std::u16string& value)> show;
    // Text can be typed into it.
    bool isText = false;
    // It takes lines of its own in the text.
    bool isLarge = false;
};

// `edited` is called when the user has changed the value, from inside what the user does.
FieldInput makeFieldInput(const FormModel::Field& field, std::function<void()> edited);

}  // namespace plume
