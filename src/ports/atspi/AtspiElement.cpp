#include "ports/atspi/AtspiElement.h"

#include <algorithm>
#include <utility>

#include "Foundation/Strings.h"

namespace plume {

namespace {

constexpr int MostChildren = 200;

std::optional<std::u16string> textFrom(std::u16string_view text) {
    return text.empty() ? std::nullopt : std::optional<std::u16string>(text);
}

std::optional<std::u16string> stringOf(AtspiBus& bus, const AtspiPart& part, const std::string& name) {
    if (name == "AXRole") return textFrom(roleOf(bus, part));
    if (name == "AXSubrole") return textFrom(subroleOf(bus, part));
    if (name == "AXValue") return AtspiTextReader(bus, part, {}).wholeText();
    if (name == "AXTitle") {
        const auto title = bus.property(part, AccessibleInterface, "Name").values().inside().string();
        return title ? std::optional(fromUtf8(*title)) : std::nullopt;
    }
    return std::nullopt;
}

}  // namespace

AtspiApplicationElement::Element AtspiApplicationElement::elementAttribute(std::string_view name) const {
    if (name != "AXFocusedUIElement") return nullptr;
    auto focused = session_->askForFocus();
    if (!focused || !focused->part) return nullptr;
    return std::make_shared<AtspiElement>(session_, std::move(*focused));
}

std::optional<std::u16string> AtspiApplicationElement::stringAttribute(std::string_view name) const {
    return name == "AXRole" ? std::optional<std::u16string>(u"AXApplication") : std::nullopt;
}

AtspiElement::AtspiElement(std::shared_ptr<AtspiSession> session, AtspiFocused focused)
    : session_(std::move(session)),
      part_(std::move(focused.part)),
      isText_(focused.isText),
      selectsNothing_(focused.selectsNothing) {}

AtspiElement::Element AtspiElement::elementFor(AtspiPart part) const {
    return part ? std::make_shared<AtspiElement>(session_, AtspiFocused{std::move(part), false, {}}) : nullptr;
}

AtspiElement::Element AtspiElement::elementAttribute(std::string_view name) const {
    const bool parent = name == "AXParent";
    if (!parent && name != "AXTopLevelUIElement") return nullptr;
    auto found = session_->ask<AtspiPart>([part = part_, parent](AtspiBus& bus) {
        return std::optional(parent ? parentOf(bus, part) : topLevelOf(bus, part));
    });
    return found ? elementFor(std::move(*found)) : nullptr;
}

std::vector<AtspiElement::Element> AtspiElement::elementsAttribute(std::string_view name) const {
    if (name != "AXChildren") return {};
    auto found = session_->ask<std::vector<AtspiPart>>(
        [part = part_](AtspiBus& bus) { return std::optional(childrenOf(bus, part, MostChildren)); });
    std::vector<Element> elements;
    if (!found) return elements;
    for (AtspiPart& child : *found) elements.push_back(elementFor(std::move(child)));
    return elements;
}

std::optional<std::u16string> AtspiElement::stringAttribute(std::string_view name) const {
    if (isText_ && name == "AXSubrole") return std::nullopt;  // texts have none
    return session_->ask<std::u16string>(
        [part = part_, name = std::string(name)](AtspiBus& bus) { return stringOf(bus, part, name); });
}

std::optional<TextRange> AtspiElement::rangeAttribute(std::string_view name) const {
    if (name != "AXSelectedTextRange") return std::nullopt;
    using Selection = std::pair<TextRange, AtspiTextReader::Anchor>;
    const auto selection = session_->ask<Selection>([part = part_](AtspiBus& bus) -> std::optional<Selection> {
        AtspiTextReader reader(bus, part, {});
        const auto range = reader.selectedRange();
        return range ? std::optional(Selection(*range, reader.anchor())) : std::nullopt;
    });
    if (!selection) return std::nullopt;
    anchor_ = selection->second;
    return selection->first;
}

std::optional<Rectangle> AtspiElement::place() const {
    return session_->ask<Rectangle>([part = part_](AtspiBus& bus) { return screenBounds(bus, part); });
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
    return session_->ask<std::u16string>([part = part_, anchor = anchor_, range](AtspiBus& bus) {
        return AtspiTextReader(bus, part, anchor).string(range);
    });
}

std::optional<Rectangle> AtspiElement::rectangleForRange(std::string_view name, TextRange range) const {
    if (name != "AXBoundsForRange") return std::nullopt;
    return session_->ask<Rectangle>([part = part_, anchor = anchor_, range](AtspiBus& bus) {
        return AtspiTextReader(bus, part, anchor).bounds(range);
    });
}

bool AtspiElement::selectsNothing() const {
    if (selectsNothing_) return *selectsNothing_;
    return session_
        ->ask<bool>([part = part_](AtspiBus& bus) { return AtspiTextReader(bus, part, {}).selectsNothing(); })
        .value_or(false);
}

}  // namespace plume
