// One form as the user sees it, whatever draws it: the controls of a snippet's fields in its text.
//
// Made before it is shown, and owned by whoever has the form's rules; its window is gone when it is. Everything belongs
// to the main thread, the events too. It shows what the model says, tells what the user does, and decides nothing.
#pragma once

#include <cstddef>
#include <cstdint>
#include <functional>
#include <optional>
#include <string>

#include "app/CaretPlace.h"

namespace plume {

// Where a form goes.
struct FormPlace {
    CaretPlace caret;
    // Of what is inside the window, in Qt's pixels; nothing: as its content wants it.
    std::optional<Size> size;
};

class FormSurface {
  public:
    // None is called from inside a call of the surface, nor after its end.
    struct Events {
        // It stands there, drawn, and its first field takes the keys that this window of the system's gets.
        std::function<void(std::uint32_t window)> shown;
        // The user has typed this, or picked that line. Of a number it is what the locale writes.
        std::function<void(std::size_t field, const std::u16string& value)> filled;
        // The box of an optional field.
        std::function<void(std::size_t field, bool selected)> selected;
        std::function<void()> accepted;
        std::function<void()> cancelled;
        // Return has come, and did not accept.
        std::function<void()> stayed = {};
    };

    virtual ~FormSurface() = default;
    // Once.
    virtual void show(const FormPlace& place) = 0;
    // The model has changed. What the user is typing into stays as it is until it is left.
    virtual void update() = 0;
    // Of what is inside the window, in Qt's pixels; nothing when it is not known.
    virtual std::optional<Size> size() const = 0;
};

}  // namespace plume
