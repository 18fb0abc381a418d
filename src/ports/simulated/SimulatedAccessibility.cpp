#include "ports/simulated/SimulatedAccessibility.h"

namespace plume {

template <typename Type>
std::optional<Type> SimulatedUIElement::value(std::string_view name) const {
    const auto found = attributes_.find(name);
    if (found == attributes_.end()) return std::nullopt;
    const Type* held = std::get_if<Type>(&found->second);
    return held ? std::optional<Type>(*held) : std::nullopt;
}

template <typename Type>
std::optional<Type> SimulatedUIElement::answer(std::string_view name, TextRange range) const {
    const auto found = rangeAttributes_.find(name);
    if (found == rangeAttributes_.end()) return std::nullopt;
    std::optional<RangeAnswer> given = found->second(range);
    Type* held = given ? std::get_if<Type>(&*given) : nullptr;
    return held ? std::optional<Type>(std::move(*held)) : std::nullopt;
}

void SimulatedUIElement::setRangeAttribute(std::string name, RangeQuestion question) {
    rangeAttributes_.insert_or_assign(std::move(name), std::move(question));
}

void SimulatedUIElement::setMarkerRangeAttribute(std::string name, MarkerQuestion question) {
    markerRangeAttributes_.insert_or_assign(std::move(name), std::move(question));
}

void SimulatedUIElement::setText(std::u16string text) {
    setRangeAttribute("AXStringForRange", [text = std::move(text)](TextRange range) -> std::optional<RangeAnswer> {
        const auto size = static_cast<std::int64_t>(text.size());
        if (range.location < 0 || range.length < 0 || range.location > size) return std::nullopt;
        if (range.length > size - range.location) return std::nullopt;
        return text.substr(static_cast<std::size_t>(range.location), static_cast<std::size_t>(range.length));
    });
}

SimulatedUIElement::Element SimulatedUIElement::elementAttribute(std::string_view name) const {
    return value<Element>(name).value_or(nullptr);
}

std::vector<SimulatedUIElement::Element> SimulatedUIElement::elementsAttribute(std::string_view name) const {
    return value<std::vector<Element>>(name).value_or(std::vector<Element>());
}

std::optional<std::u16string> SimulatedUIElement::stringAttribute(std::string_view name) const {
    return value<std::u16string>(name);
}

std::optional<TextRange> SimulatedUIElement::rangeAttribute(std::string_view name) const {
    return value<TextRange>(name);
}

std::optional<TextMarkerRange> SimulatedUIElement::markerRangeAttribute(std::string_view name) const {
    return value<TextMarkerRange>(name);
}

std::optional<Point> SimulatedUIElement::pointAttribute(std::string_view name) const {
    return value<Point>(name);
}

std::optional<Size> SimulatedUIElement::sizeAttribute(std::string_view name) const {
    return value<Size>(name);
}

std::optional<std::u16string> SimulatedUIElement::stringForRange(std::string_view name, TextRange range) const {
    return answer<std::u16string>(name, range);
}

std::optional<std::u16string> SimulatedUIElement::stringForMarkerRange(std::string_view name,
                                                                       TextMarkerRange range) const {
    const auto found = markerRangeAttributes_.find(name);
    return found == markerRangeAttributes_.end() ? std::nullopt : found->second(range);
}

std::optional<AttributedString> SimulatedUIElement::attributedStringForRange(std::string_view name,
                                                                             TextRange range) const {
    return answer<AttributedString>(name, range);
}

std::optional<std::string> SimulatedUIElement::dataForRange(std::string_view name, TextRange range) const {
    return answer<std::string>(name, range);
}

std::optional<Rectangle> SimulatedUIElement::rectangleForRange(std::string_view name, TextRange range) const {
    return answer<Rectangle>(name, range);
}

void SimulatedAccessibility::askForFocusedPlaces(std::function<void(const FocusedPlaces&)> told) const {
    const auto placeOf = [](const UIElement& element) -> std::optional<Rectangle> {
        const auto origin = element.pointAttribute("AXPosition");
        const auto size = element.sizeAttribute("AXSize");
        return origin && size ? std::optional(Rectangle{*origin, *size}) : std::nullopt;
    };
    FocusedPlaces places;
    const auto application = frontApplicationElement();
    if (const auto focused = application ? application->elementAttribute("AXFocusedUIElement") : nullptr) {
        const auto selected = focused->rangeAttribute("AXSelectedTextRange");
        if (selected) places.caret = focused->rectangleForRange("AXBoundsForRange", *selected);
        places.element = placeOf(*focused);
        places.elementName = std::to_string(reinterpret_cast<std::uintptr_t>(focused.get()));
        const auto window = focused->elementAttribute("AXTopLevelUIElement");
        if (window) places.window = placeOf(*window);
    }
    told(places);
}

}  // namespace plume
