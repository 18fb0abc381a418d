// What the forms of placeholders and the menu that inserts them need of the program around them.
//
// Everything is called on the main thread, nothing waits, and all of it outlives the forms. What is empty is done
// without. Answers may come when a form is gone: the form guards against that.
#pragma once

#include <QRect>
#include <functional>
#include <memory>
#include <optional>
#include <string>

#include "content/ContentEnvironment.h"
#include "input/GeneralHotKey.h"
#include "library/LibraryArchive.h"

namespace plume {

struct ChipFormServices {
    std::function<const SnippetGroups&()> groups;
    // That in which the placeholder stands; it is not offered to be put into itself. Null: none.
    std::shared_ptr<Snippet> inside;
    // The clock and the place for what is shown of dates.
    ContentEnvironment environment;
    // What the user has on the clipboard.
    std::function<void(std::function<void(const std::optional<std::u16string>&)> told)> readClipboard;
    // What the key of this code is called: "K", "F5".
    std::function<std::u16string(KeyCode)> keyName;
    // From now on keys go to `pressed` instead of anywhere else, until endRecordingKey().
    std::function<void(std::function<void(const GeneralHotKey&)> pressed)> beginRecordingKey;
    std::function<void()> endRecordingKey;
    // Where the placeholder is on the screen; null: at the widget.
    QRect place;
};

}  // namespace plume
