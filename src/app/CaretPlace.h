// Where on the screen the user types.
//
// A program that is slow to tell of it holds up nobody.
#pragma once

#include <cstdint>
#include <functional>
#include <memory>
#include <optional>

#include "platform/Accessibility.h"
#include "platform/ProcessManager.h"
#include "platform/RunLoop.h"

namespace plume {

struct CaretPlace {
    // Unknown: the rectangle says nothing, and the pointer is the best guess.
    enum class Kind : std::uint8_t { Unknown, Field, Caret };

    Kind kind = Kind::Unknown;
    // In pixels of the screen, from its top left. A caret may have no width.
    Rectangle rectangle;

    bool operator==(const CaretPlace&) const = default;
};

// The caret, else the field that has the focus, as the program in front tells them; `window` is where its window really
// is, if that is known.
CaretPlace caretPlaceIn(const FocusedPlaces& told, const std::optional<Rectangle>& window);

// Asks for it. Belongs to the tap thread.
class CaretFinder {
  public:
    using Found = std::function<void(const CaretPlace& place)>;

    // Not owned; all of it outlives the finder.
    CaretFinder(const Accessibility& accessibility, const ProcessManager& processManager, RunLoop& tapLoop)
        : accessibility_(accessibility), processManager_(processManager), tapLoop_(tapLoop) {}

    // `found` is called once, from the loop, a fifth of a second later at most; not any more after cancel(), another
    // find() or the end of the finder.
    void find(Found found);
    void cancel();

  private:
    struct Question {
        Found found;
        bool isRepeated = false;
        Timer limit;
        Timer repetition;
    };

    void ask(const std::shared_ptr<Question>& question);
    void told(const std::shared_ptr<Question>& question, const FocusedPlaces& places);
    void answer(const CaretPlace& place);

    const Accessibility& accessibility_;
    const ProcessManager& processManager_;
    RunLoop& tapLoop_;
    std::shared_ptr<Question> asked_;  // belongs to the tap thread; others hold it weakly
};

}  // namespace plume
