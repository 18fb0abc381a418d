// What the focused element of the application in front tells of its text and its place on the screen.
//
// No state: every question goes to the accessibility port at once, which bounds how long it may take. Whatever goes
// unanswered (no application in front, no permission, no such attribute, a value of another type) gives nothing, zero
// or NSIntegerMax, as each operation says. Rectangles have their origin at the bottom left of the main screen.
#pragma once

#include <cstdint>
#include <limits>
#include <memory>
#include <optional>
#include <string>

#include "Foundation/text/AttributedString.h"
#include "platform/Accessibility.h"

namespace plume {

// The location of a selection that is not known.
inline constexpr std::int64_t NSIntegerMax = std::numeric_limits<std::int64_t>::max();

class AXUtils {
  public:
    using Element = std::shared_ptr<UIElement>;

    // Null when there is none.
    static Element getFocusedUIElement(const Accessibility& accessibility);
    static Element getFocusedTopLevelUIElement(const Accessibility& accessibility);
    // The field in which the user searches the help menu of the application in front.
    static Element getHelpSearchFieldUIElement(const Accessibility& accessibility);

    // The selected text as it looks; nothing without a selection.
    static std::optional<AttributedString> copySelectedAttributedString(const Accessibility& accessibility);
    // In UTF-16 units; 0 when nothing is selected or nobody knows.
    static std::int64_t getSelectedTextLength(const Accessibility& accessibility);
    // Location NSIntegerMax and length 0 when it is not known.
    static TextRange getSelectedTextRange(const Accessibility& accessibility);
    static Rectangle getSelectedTextBound(const Accessibility& accessibility);

    // The focused element's value when that is a text.
    static std::optional<std::u16string> getValue(const Accessibility& accessibility);
    // Up to `maxLength` units before the selection; empty, not nothing, at the start of the text.
    static std::optional<std::u16string> getTextBeforeCaretWithMaxLength(const Accessibility& accessibility,
                                                                         std::int64_t maxLength);

    static Rectangle getFocusedUIElementBound(const Accessibility& accessibility);
};

}  // namespace plume
