// The forms of snippets with fields, as the thread that hears the keys drives them.
//
// Owned by whoever makes the windows; everything belongs to the main thread, the events too. A form takes the keyboard,
// which the other side gives back before anything is sent. Forms are named by numbers that are never used twice.
#pragma once

#include <cstdint>
#include <functional>
#include <memory>
#include <string>

#include "app/CaretPlace.h"
#include "content/SnippetExpandedContent.h"

namespace plume {

class FormView {
  public:
    using Id = std::uint64_t;

    struct Events {
        // It stands there, its first field takes keys, and this window of the system's wants the keyboard.
        std::function<void(std::uint32_t window)> shown;
        // Its window is gone, another comes in its place and is told of by shown().
        std::function<void()> lost;
        // The user has confirmed it, the fields of the content hold what the user wants, and the window is gone.
        std::function<void()> accepted;
        // The user has closed it, and nothing is to be sent.
        std::function<void()> cancelled;
        // A key that can end a form has come, and did not.
        std::function<void()> stayed;
    };

    virtual ~FormView() = default;
    // Begins whatever takes time. The content belongs to the form from here on, and to the other side again when it is
    // accepted.
    virtual void prepare(Id form, std::shared_ptr<SnippetExpandedContent> content, Events events) = 0;
    virtual void show(Id form, const CaretPlace& place) = 0;
    // Nobody waits for it any more.
    virtual void close(Id form) = 0;
    // An accepted form's text was not sent, for this reason: it is kept, and accepted() comes again when the user wants
    // that tried once more; cancelled() when not.
    virtual void keepUnsent(Id form, const std::string& reason) = 0;
};

}  // namespace plume
