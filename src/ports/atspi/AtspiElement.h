// One part of a program's user interface, as the rest of Plume asks it: every attribute is a question to the
// accessibility thread and answers in time or not at all.
#pragma once

#include "platform/Accessibility.h"
#include "ports/atspi/AtspiSession.h"
#include "ports/atspi/AtspiText.h"

namespace plume {

// Attributes without a counterpart answer nothing: text markers, attributed text, RTF.
class AtspiElement final : public UIElement {
  public:
    using Element = std::shared_ptr<UIElement>;

    AtspiElement(std::shared_ptr<AtspiSession> session, AtspiPart part);

    Element elementAttribute(std::string_view name) const override;
    std::vector<Element> elementsAttribute(std::string_view name) const override;
    std::optional<std::u16string> stringAttribute(std::string_view name) const override;
    std::optional<TextRange> rangeAttribute(std::string_view name) const override;
    std::optional<TextMarkerRange> markerRangeAttribute(std::string_view name) const override;
    std::optional<Point> pointAttribute(std::string_view name) const override;
    std::optional<Size> sizeAttribute(std::string_view name) const override;
    std::optional<std::u16string> stringForRange(std::string_view name, TextRange range) const override;
    std::optional<std::u16string> stringForMarkerRange(std::string_view name, TextMarkerRange range) const override;
    std::optional<AttributedString> attributedStringForRange(std::string_view name, TextRange range) const override;
    std::optional<std::string> dataForRange(std::string_view name, TextRange range) const override;
    std::optional<Rectangle> rectangleForRange(std::string_view name, TextRange range) const override;
    bool selectsNothing() const override;

  private:
    Element elementFor(AtspiPart part) const;
    std::optional<Rectangle> place() const;

    std::shared_ptr<AtspiSession> session_;
    AtspiPart part_;
    mutable AtspiTextReader::Anchor anchor_;  // the selection when it was asked for last
};

}  // namespace plume
