// The text of one part of a program, counted in UTF-16 units. All on the accessibility thread.
//
// AT-SPI counts characters; some toolkits count UTF-16 units all the same, which shows when text is fetched. Counting
// from the start of a long text for every question would take too long, so positions are counted from an anchor: a
// place of which both counts are known.
#pragma once

#include <cstdint>
#include <optional>
#include <string>

#include "platform/Accessibility.h"
#include "ports/atspi/AtspiParts.h"

namespace plume {

class AtspiTextReader {
  public:
    // A place in the text: as the program counts, and in units. The start of the text is one.
    struct Anchor {
        std::int64_t offset = 0;
        std::int64_t units = 0;
    };

    AtspiTextReader(AtspiBus& bus, AtspiPart part, Anchor anchor);

    // Whether it says so itself.
    std::optional<bool> selectsNothing() const;
    // The same in two steps, so that something else can be asked meanwhile.
    static AtspiPendingCall askForSelections(AtspiBus& bus, const AtspiPart& part);
    static std::optional<bool> selectsNothing(const AtspiBus& bus, const AtspiPart& part, AtspiPendingCall asked);
    // What was selected, or the caret as an empty stretch; the anchor then is its start. What lies more than 65,536
    // characters before the selection is counted as one unit a character.
    std::optional<TextRange> selectedRange();
    Anchor anchor() const { return anchor_; }

    // Nothing for a stretch that is not all inside the text, is longer than a million units, or is a password.
    std::optional<std::u16string> string(TextRange range) const;
    std::optional<std::u16string> wholeText() const;
    // For an empty stretch the caret there, without width.
    std::optional<Rectangle> bounds(TextRange range) const;

  private:
    // Also when the part does not say what it is.
    bool isPassword() const;
    BusAnswer ask(const char* method, std::initializer_list<BusValue> arguments = {}) const;
    std::optional<std::int64_t> number(const char* property) const;
    std::optional<std::u16string> fetch(std::int64_t from, std::int64_t to) const;
    std::optional<std::int64_t> offsetOf(std::int64_t units) const;
    std::optional<Rectangle> caretAt(std::int64_t offset) const;
    std::optional<Rectangle> characterAt(std::int64_t offset) const;

    AtspiBus& bus_;
    AtspiPart part_;
    Anchor anchor_;
};

// Where a part is on the screen; nothing when it does not tell.
std::optional<Rectangle> screenBounds(AtspiBus& bus, const AtspiPart& part);

}  // namespace plume
