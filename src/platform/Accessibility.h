// What the focused program tells of its user interface. Rectangles have their origin at the top left of the main
// screen.
//
// Every question may go unanswered: no permission, no such attribute, a program that does not answer in time.
#pragma once

#include <cstdint>
#include <functional>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

#include "Foundation/text/AttributedString.h"

namespace plume {

struct Point {
    double x = 0;
    double y = 0;
    bool operator==(const Point&) const = default;
};

struct Size {
    double width = 0;
    double height = 0;
    bool operator==(const Size&) const = default;
};

struct Rectangle {
    Point origin;
    Size size;
    bool operator==(const Rectangle&) const = default;
};

// A stretch of an element's text as accessibility reports it: either number may be negative when it is not known.
struct TextRange {
    std::int64_t location = 0;
    std::int64_t length = 0;
    bool operator==(const TextRange&) const = default;
};

// A stretch of text named by opaque markers instead of numbers; means something to the element it came from alone.
struct TextMarkerRange {
    std::uint64_t handle = 0;
};

// One element of a program's user interface. Attributes are asked for by name ("AXRole", "AXSelectedTextRange", …).
class UIElement {
  public:
    virtual ~UIElement() = default;
    virtual std::shared_ptr<UIElement> elementAttribute(std::string_view name) const = 0;
    virtual std::vector<std::shared_ptr<UIElement>> elementsAttribute(std::string_view name) const = 0;
    virtual std::optional<std::u16string> stringAttribute(std::string_view name) const = 0;
    virtual std::optional<TextRange> rangeAttribute(std::string_view name) const = 0;
    virtual std::optional<TextMarkerRange> markerRangeAttribute(std::string_view name) const = 0;
    virtual std::optional<Point> pointAttribute(std::string_view name) const = 0;
    virtual std::optional<Size> sizeAttribute(std::string_view name) const = 0;
    // Attributes that take a range: the text, the attributed text, RTF bytes or the bounds of that stretch.
    virtual std::optional<std::u16string> stringForRange(std::string_view name, TextRange range) const = 0;
    virtual std::optional<std::u16string> stringForMarkerRange(std::string_view name, TextMarkerRange range) const = 0;
    virtual std::optional<AttributedString> attributedStringForRange(std::string_view name, TextRange range) const = 0;
    virtual std::optional<std::string> dataForRange(std::string_view name, TextRange range) const = 0;
    virtual std::optional<Rectangle> rectangleForRange(std::string_view name, TextRange range) const = 0;
    // True when the element can tell, sooner than by its selected range, that nothing is selected.
    virtual bool selectsNothing() const { return false; }
};

// Where the user types, as the program in front tells it: what has the focus, the caret in it, and the window. What is
// not told is nothing.
struct FocusedPlaces {
    std::optional<Rectangle> caret;  // may have no width
    std::optional<Rectangle> element;
    std::optional<Rectangle> window;
    // Names the element as long as it lives; empty: not told.
    std::string elementName = {};
    // The user has just come there: what is not told now may be told in a moment.
    bool isMoving = false;
};

class Accessibility {
  public:
    virtual ~Accessibility() = default;
    // The element that stands for the application in front, or nothing.
    virtual std::shared_ptr<UIElement> frontApplicationElement() const = 0;
    // Asks for the places without waiting for them: `told` is called once, at once or on any thread, or never when the
    // program hangs.
    virtual void askForFocusedPlaces(std::function<void(const FocusedPlaces&)> told) const = 0;
    // Height of the main screen, for turning rectangles over.
    virtual double mainScreenHeight() const = 0;
};

}  // namespace plume
