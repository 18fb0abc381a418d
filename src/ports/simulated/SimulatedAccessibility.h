// A user interface whose elements say just what they were told to say.
#pragma once

#include <functional>
#include <map>
#include <utility>
#include <variant>

#include "platform/Accessibility.h"

namespace plume {

class SimulatedUIElement final : public UIElement {
  public:
    using Element = std::shared_ptr<UIElement>;
    using Value = std::variant<Element, std::vector<Element>, std::u16string, TextRange, TextMarkerRange, Point, Size>;
    // What is asked about a stretch of text, and the answer.
    using RangeAnswer = std::variant<std::u16string, AttributedString, std::string, Rectangle>;
    using RangeQuestion = std::function<std::optional<RangeAnswer>(TextRange)>;
    using MarkerQuestion = std::function<std::optional<std::u16string>(TextMarkerRange)>;

    void setAttribute(std::string name, Value value) {
        attributes_.insert_or_assign(std::move(name), std::move(value));
    }
    void removeAttribute(const std::string& name) { attributes_.erase(name); }
    void setRangeAttribute(std::string name, RangeQuestion question);
    void setMarkerRangeAttribute(std::string name, MarkerQuestion question);
    // Answers "AXStringForRange" from this text, and nothing for a range outside it.
    void setText(std::u16string text);

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

  private:
    template <typename Type>
    std::optional<Type> value(std::string_view name) const;
    template <typename Type>
    std::optional<Type> answer(std::string_view name, TextRange range) const;

    std::map<std::string, Value, std::less<>> attributes_;
    std::map<std::string, RangeQuestion, std::less<>> rangeAttributes_;
    std::map<std::string, MarkerQuestion, std::less<>> markerRangeAttributes_;
};

class SimulatedAccessibility final : public Accessibility {
  public:
    // Null: no application in front, or no permission to ask.
    void setFrontApplicationElement(std::shared_ptr<UIElement> element) { front_ = std::move(element); }
    // Asked for it whenever somebody wants to know, in place of a fixed one.
    void setFrontApplicationSource(std::function<std::shared_ptr<UIElement>()> source) { source_ = std::move(source); }
    void setMainScreenHeight(double height) { screenHeight_ = height; }

    std::shared_ptr<UIElement> frontApplicationElement() const override { return source_ ? source_() : front_; }
    // Those that the elements say when they are asked.
    void askForFocusedPlaces(std::function<void(const FocusedPlaces&)> told) const override;
    double mainScreenHeight() const override { return screenHeight_; }

  private:
    std::shared_ptr<UIElement> front_;
    std::function<std::shared_ptr<UIElement>()> source_;
    double screenHeight_ = 1080;
};

}  // namespace plume
