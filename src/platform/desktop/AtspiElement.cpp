#include "platform/desktop/AtspiElement.h"

#include <algorithm>
#include <utility>

#include "Foundation/Strings.h"
#include "platform/desktop/AtspiRoles.h"

namespace plume {

namespace {

constexpr int DeepestPart = 100;
constexpr int MostChildren = 200;

// The window: the part right below the program, for which a toolkit may have a part or none.
AtspiAccessible* topLevelOf(AtspiAccessible* part) {
    GObjectOwned<AtspiAccessible> at(ATSPI_ACCESSIBLE(g_object_ref(part)));
    for (int depth = 0; depth < DeepestPart; ++depth) {
        GObjectOwned<AtspiAccessible> parent(atspi_accessible_get_parent(at.get(), nullptr));
        if (!parent) return nullptr;
        if (atspi_accessible_get_role(parent.get(), nullptr) == ATSPI_ROLE_APPLICATION) return at.release();
        at = std::move(parent);
    }
    return nullptr;
}

std::optional<std::u16string> textFrom(std::u16string_view text) {
    return text.empty() ? std::nullopt : std::optional<std::u16string>(text);
}

std::optional<std::u16string> stringOf(AtspiAccessible* part, const std::string& name) {
    if (name == "AXRole") return textFrom(roleOf(part));
    if (name == "AXSubrole") return textFrom(subroleOf(part));
    if (name == "AXValue") return AtspiTextReader(part, {}).wholeText();
    if (name == "AXTitle") {
        const GlibOwned<char> title(atspi_accessible_get_name(part, nullptr));
        return title ? std::optional(fromUtf8(title.get())) : std::nullopt;
    }
    return std::nullopt;
}

}  // namespace

AtspiElement::AtspiElement(std::shared_ptr<AtspiQueue> queue, AtspiPart part)
    : queue_(std::move(queue)), part_(std::move(part)) {}

AtspiElement::Element AtspiElement::elementFor(AtspiPart part) const {
    return part ? std::make_shared<AtspiElement>(queue_, std::move(part)) : nullptr;
}

AtspiElement::Element AtspiElement::elementAttribute(std::string_view name) const {
    const bool parent = name == "AXParent";
    if (!parent && name != "AXTopLevelUIElement") return nullptr;
    auto found = queue_->ask<AtspiPart>([queue = queue_, part = part_, parent] {
        AtspiAccessible* at = parent ? atspi_accessible_get_parent(part.get(), nullptr) : topLevelOf(part.get());
        return std::optional(queue->share(at));
    });
    return found ? elementFor(std::move(*found)) : nullptr;
}

std::vector<AtspiElement::Element> AtspiElement::elementsAttribute(std::string_view name) const {
    if (name != "AXChildren") return {};
    auto found = queue_->ask<std::vector<AtspiPart>>([queue = queue_, part = part_] {
        std::vector<AtspiPart> children;
        const int count = std::min(atspi_accessible_get_child_count(part.get(), nullptr), MostChildren);
        for (int i = 0; i < count; ++i) {
            AtspiPart child = queue->share(atspi_accessible_get_child_at_index(part.get(), i, nullptr));
            if (child) children.push_back(std::move(child));
        }
        return std::optional(std::move(children));
    });
    std::vector<Element> elements;
    if (!found) return elements;
    for (AtspiPart& child : *found) elements.push_back(elementFor(std::move(child)));
    return elements;
}

std::optional<std::u16string> AtspiElement::stringAttribute(std::string_view name) const {
    return queue_->ask<std::u16string>([part = part_, name = std::string(name)] { return stringOf(part.get(), name); });
}

std::optional<TextRange> AtspiElement::rangeAttribute(std::string_view name) const {
    if (name != "AXSelectedTextRange") return std::nullopt;
    using Selection = std::pair<TextRange, AtspiTextReader::Anchor>;
    const auto selection = queue_->ask<Selection>([part = part_]() -> std::optional<Selection> {
        AtspiTextReader reader(part.get(), {});
        const auto range = reader.selectedRange();
        return range ? std::optional(Selection(*range, reader.anchor())) : std::nullopt;
    });
    if (!selection) return std::nullopt;
    anchor_ = selection->second;
    return selection->first;
}

std::optional<TextMarkerRange> AtspiElement::markerRangeAttribute(std::string_view) const {
    return std::nullopt;
}

std::optional<Rectangle> AtspiElement::place() const {
    return queue_->ask<Rectangle>([part = part_] { return screenBounds(part.get()); });
}

std::optional<Point> AtspiElement::pointAttribute(std::string_view name) const {
    if (name != "AXPosition") return std::nullopt;
    const auto rectangle = place();
    return rectangle ? std::optional(rectangle->origin) : std::nullopt;
}

std::optional<Size> AtspiElement::sizeAttribute(std::string_view name) const {
    if (name != "AXSize") return std::nullopt;
    const auto rectangle = place();
    return rectangle ? std::optional(rectangle->size) : std::nullopt;
}

std::optional<std::u16string> AtspiElement::stringForRange(std::string_view name, TextRange range) const {
    if (name != "AXStringForRange") return std::nullopt;
    return queue_->ask<std::u16string>(
        [part = part_, anchor = anchor_, range] { return AtspiTextReader(part.get(), anchor).string(range); });
}

std::optional<std::u16string> AtspiElement::stringForMarkerRange(std::string_view, TextMarkerRange) const {
    return std::nullopt;
}

std::optional<AttributedString> AtspiElement::attributedStringForRange(std::string_view, TextRange) const {
    return std::nullopt;
}

std::optional<std::string> AtspiElement::dataForRange(std::string_view, TextRange) const {
    return std::nullopt;
}

std::optional<Rectangle> AtspiElement::rectangleForRange(std::string_view name, TextRange range) const {
    if (name != "AXBoundsForRange") return std::nullopt;
    return queue_->ask<Rectangle>(
        [part = part_, anchor = anchor_, range] { return AtspiTextReader(part.get(), anchor).bounds(range); });
}

}  // namespace plume
