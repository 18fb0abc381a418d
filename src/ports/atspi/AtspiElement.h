// The program in front and the parts of its user interface, as the rest of Plume asks them: every attribute is a
// question to the accessibility thread and answers in time or not at all.
#pragma once

#include "platform/Accessibility.h"
#include "ports/atspi/AtspiSession.h"
#include "ports/atspi/AtspiText.h"

namespace plume {

// Answers nothing. AT-SPI has no counterpart of text markers, attributed text and RTF.
class SilentElement : public UIElement {
  public:
    using Element = std::shared_ptr<UIElement>;

    Element elementAttribute(std::string_view) const override { return nullptr; }
    std::vector<Element> elementsAttribute(std::string_view) const override { return {}; }
    std::optional<std::u16string> stringAttribute(std::string_view) const override { return std::nullopt; }
    std::optional<TextRange> rangeAttribute(std::string_view) const override { return std::nullopt; }
    std::optional<TextMarkerRange> markerRangeAttribute(std::string_view) const override { return std::nullopt; }
    std::optional<Point> pointAttribute(std::string_view) const override { return std::nullopt; }
    std::optional<Size> sizeAttribute(std::string_view) const override { return std::nullopt; }
    std::optional<std::u16string> stringForRange(std::string_view, TextRange) const override { return std::nullopt; }
    std::optional<std::u16string> stringForMarkerRange(std::string_view, TextMarkerRange) const override {
        return std::nullopt;
    }
    std::optional<AttributedString> attributedStringForRange(std::string_view, TextRange) const override {
        return std::nullopt;
    }
    std::optional<std::string> dataForRange(std::string_view, TextRange) const override { return std::nullopt; }
    std::optional<Rectangle> rectangleForRange(std::string_view, TextRange) const override { return std::nullopt; }
};

// The program in front, of which something is known to have the focus: has neither text nor place. Nothing needs to be
// asked to make one.
class AtspiApplicationElement final : public SilentElement {
  public:
    explicit AtspiApplicationElement(std::shared_ptr<AtspiSession> session) : session_(std::move(session)) {}

    Element elementAttribute(std::string_view name) const override;
    std::optional<std::u16string> stringAttribute(std::string_view name) const override;

  private:
    std::shared_ptr<AtspiSession> session_;
};

class AtspiElement final : public SilentElement {
  public:
    AtspiElement(std::shared_ptr<AtspiSession> session, AtspiFocused focused);

    Element elementAttribute(std::string_view name) const override;
    std::vector<Element> elementsAttribute(std::string_view name) const override;
    std::optional<std::u16string> stringAttribute(std::string_view name) const override;
    std::optional<TextRange> rangeAttribute(std::string_view name) const override;
    std::optional<Point> pointAttribute(std::string_view name) const override;
    std::optional<Size> sizeAttribute(std::string_view name) const override;
    std::optional<std::u16string> stringForRange(std::string_view name, TextRange range) const override;
    std::optional<Rectangle> rectangleForRange(std::string_view name, TextRange range) const override;
    bool selectsNothing() const override;

  private:
    Element elementFor(AtspiPart part) const;
    std::optional<Rectangle> place() const;

    std::shared_ptr<AtspiSession> session_;
    AtspiPart part_;
    bool isText_;
    std::optional<bool> selectsNothing_;      // as told along with the focus; elements do not last
    mutable AtspiTextReader::Anchor anchor_;  // the selection when it was asked for last
};

}  // namespace plume
