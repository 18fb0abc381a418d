#include "input/AXUtils.h"

#include <algorithm>
#include <string_view>
#include <vector>

#include "Foundation/text/RTFD.h"

namespace plume {

namespace {

constexpr TextRange UnknownRange{NSIntegerMax, 0};

// A rectangle measured from the top of the screen, measured from its bottom.
Rectangle turnedOver(const Rectangle& rectangle, double screenHeight) {
    const double y = screenHeight - rectangle.origin.y - rectangle.size.height;
    return {{rectangle.origin.x, y}, rectangle.size};
}

AXUtils::Element firstChild(const AXUtils::Element& element) {
    if (!element) return nullptr;
    const std::vector<AXUtils::Element> children = element->elementsAttribute("AXChildren");
    return children.empty() ? nullptr : children.front();
}

TextRange selectedRangeOf(const UIElement& element) {
    const std::optional<TextRange> range = element.rangeAttribute("AXSelectedTextRange");
    return range && range->location >= 0 ? *range : UnknownRange;
}

}  // namespace

AXUtils::Element AXUtils::getFocusedUIElement(const Accessibility& accessibility) {
    const Element application = accessibility.frontApplicationElement();
    return application ? application->elementAttribute("AXFocusedUIElement") : nullptr;
}

AXUtils::Element AXUtils::getFocusedTopLevelUIElement(const Accessibility& accessibility) {
    const Element focused = getFocusedUIElement(accessibility);
    return focused ? focused->elementAttribute("AXTopLevelUIElement") : nullptr;
}

AXUtils::Element AXUtils::getHelpSearchFieldUIElement(const Accessibility& accessibility) {
    const Element application = accessibility.frontApplicationElement();
    const Element menuBar = application ? application->elementAttribute("AXMenuBar") : nullptr;
    if (!menuBar) return nullptr;
    const std::vector<Element> menus = menuBar->elementsAttribute("AXChildren");
    if (menus.empty()) return nullptr;
    const Element& helpMenuTitle = menus.back();
    const Element helpMenu = firstChild(helpMenuTitle);
    const Element searchItem = firstChild(helpMenu);
    return firstChild(searchItem);
}

std::optional<AttributedString> AXUtils::copySelectedAttributedString(const Accessibility& accessibility) {
    const Element focused = getFocusedUIElement(accessibility);
    if (!focused) return std::nullopt;
    const TextRange range = selectedRangeOf(*focused);
    if (range.length <= 0) return std::nullopt;

    // RTF keeps more of the look than the attributes that accessibility names.
    if (const std::optional<std::string> rtf = focused->dataForRange("AXRTFForRange", range)) {
        Result<AttributedString> text = attributedStringFromRTF(*rtf);
        if (text) return std::move(text).value();
    }
    return focused->attributedStringForRange("AXAttributedStringForRange", range);
}

std::int64_t AXUtils::getSelectedTextLength(const Accessibility& accessibility) {
    const Element focused = getFocusedUIElement(accessibility);
    if (!focused || focused->selectsNothing()) return 0;
    if (const std::optional<TextRange> range = focused->rangeAttribute("AXSelectedTextRange")) {
        return range->location >= 0 ? std::max<std::int64_t>(range->length, 0) : 0;
    }
    const std::optional<TextMarkerRange> markers = focused->markerRangeAttribute("AXSelectedTextMarkerRange");
    if (!markers) return 0;
    const auto text = focused->stringForMarkerRange("AXStringForTextMarkerRange", *markers);
    return text ? static_cast<std::int64_t>(text->size()) : 0;
}

TextRange AXUtils::getSelectedTextRange(const Accessibility& accessibility) {
    const Element focused = getFocusedUIElement(accessibility);
    return focused ? selectedRangeOf(*focused) : UnknownRange;
}

Rectangle AXUtils::getSelectedTextBound(const Accessibility& accessibility) {
    const Element focused = getFocusedUIElement(accessibility);
    if (!focused) return {};
    const TextRange range = selectedRangeOf(*focused);
    if (range == UnknownRange) return {};
    const std::optional<Rectangle> bounds = focused->rectangleForRange("AXBoundsForRange", range);
    return bounds ? turnedOver(*bounds, accessibility.mainScreenHeight()) : Rectangle{};
}

std::optional<std::u16string> AXUtils::getValue(const Accessibility& accessibility) {
    const Element focused = getFocusedUIElement(accessibility);
    return focused ? focused->stringAttribute("AXValue") : std::nullopt;
}

std::optional<std::u16string> AXUtils::getTextBeforeCaretWithMaxLength(const Accessibility& accessibility,
                                                                       std::int64_t maxLength) {
    const Element focused = getFocusedUIElement(accessibility);
    if (!focused) return std::nullopt;
    const TextRange selection = selectedRangeOf(*focused);
    if (selection == UnknownRange) return std::nullopt;
    const std::int64_t length = std::clamp<std::int64_t>(maxLength, 0, selection.location);
    if (length == 0) return std::u16string();
    return focused->stringForRange("AXStringForRange", {selection.location - length, length});
}

Rectangle AXUtils::getFocusedUIElementBound(const Accessibility& accessibility) {
    const Element focused = getFocusedUIElement(accessibility);
    if (!focused) return {};
    const std::optional<Point> position = focused->pointAttribute("AXPosition");
    const std::optional<Size> size = focused->sizeAttribute("AXSize");
    if (!position || !size) return {};
    return turnedOver({*position, *size}, accessibility.mainScreenHeight());
}

}  // namespace plume
