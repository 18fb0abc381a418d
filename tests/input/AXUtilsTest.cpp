#include "input/AXUtils.h"

#include <gtest/gtest.h>

#include "Foundation/text/RTFD.h"
#include "ports/simulated/SimulatedAccessibility.h"

namespace plume {
namespace {

using Element = std::shared_ptr<SimulatedUIElement>;

class Queries : public ::testing::Test {
  protected:
    Queries() {
        application->setAttribute("AXFocusedUIElement", focused);
        screen.setFrontApplicationElement(application);
        screen.setMainScreenHeight(1000);
    }
    void select(std::int64_t location, std::int64_t length) {
        focused->setAttribute("AXSelectedTextRange", TextRange{location, length});
    }

    Element application = std::make_shared<SimulatedUIElement>();
    Element focused = std::make_shared<SimulatedUIElement>();
    SimulatedAccessibility screen;
};

// Everything at once, with nobody to ask.
void expectNothing(const Accessibility& screen) {
    EXPECT_EQ(AXUtils::getFocusedTopLevelUIElement(screen), nullptr);
    EXPECT_EQ(AXUtils::getHelpSearchFieldUIElement(screen), nullptr);
    EXPECT_FALSE(AXUtils::copySelectedAttributedString(screen));
    EXPECT_EQ(AXUtils::getSelectedTextLength(screen), 0);
    EXPECT_EQ(AXUtils::getSelectedTextRange(screen), (TextRange{NSIntegerMax, 0}));
    EXPECT_EQ(AXUtils::getSelectedTextBound(screen), Rectangle{});
    EXPECT_FALSE(AXUtils::getValue(screen));
    EXPECT_FALSE(AXUtils::getTextBeforeCaretWithMaxLength(screen, 3));
    EXPECT_EQ(AXUtils::getFocusedUIElementBound(screen), Rectangle{});
}

TEST_F(Queries, FindNothingWhereNobodyTells) {
    EXPECT_EQ(AXUtils::getFocusedUIElement(screen), focused);
    expectNothing(screen);

    // Values of other types than they should have.
    focused->setAttribute("AXSelectedTextRange", u"0,5");
    focused->setAttribute("AXValue", Size{1, 2});
    focused->setAttribute("AXTopLevelUIElement", u"window");
    focused->setAttribute("AXPosition", Size{1, 2});
    focused->setAttribute("AXSize", Point{1, 2});
    application->setAttribute("AXMenuBar", u"menus");
    expectNothing(screen);

    application->removeAttribute("AXFocusedUIElement");
    EXPECT_EQ(AXUtils::getFocusedUIElement(screen), nullptr);
    expectNothing(screen);
    screen.setFrontApplicationElement(nullptr);
    EXPECT_EQ(AXUtils::getFocusedUIElement(screen), nullptr);
    expectNothing(screen);
}

TEST_F(Queries, FindTheWindowAndTheValue) {
    const Element window = std::make_shared<SimulatedUIElement>();
    focused->setAttribute("AXTopLevelUIElement", window);
    focused->setAttribute("AXValue", u"text");
    EXPECT_EQ(AXUtils::getFocusedTopLevelUIElement(screen), window);
    EXPECT_EQ(AXUtils::getValue(screen), u"text");
}

struct SelectionCase {
    const char* about;
    TextRange range;
    std::int64_t length;
    TextRange answer;
};

TEST_F(Queries, KnowTheSelection) {
    const SelectionCase cases[] = {
        {"a selection", {3, 4}, 4, {3, 4}},
        {"a caret", {3, 0}, 0, {3, 0}},
        {"at the start", {0, 2}, 2, {0, 2}},
        {"a negative location", {-1, 4}, 0, {NSIntegerMax, 0}},
    };
    for (const SelectionCase& one : cases) {
        select(one.range.location, one.range.length);
        EXPECT_EQ(AXUtils::getSelectedTextLength(screen), one.length) << one.about;
        EXPECT_EQ(AXUtils::getSelectedTextRange(screen), one.answer) << one.about;
    }
}

TEST_F(Queries, MeasureASelectionThatIsMarkedInsteadOfNumbered) {
    focused->setAttribute("AXSelectedTextMarkerRange", TextMarkerRange{7});
    EXPECT_EQ(AXUtils::getSelectedTextLength(screen), 0);
    focused->setMarkerRangeAttribute("AXStringForTextMarkerRange", [](TextMarkerRange range) {
        return range.handle == 7 ? std::optional<std::u16string>(u"four") : std::nullopt;
    });
    EXPECT_EQ(AXUtils::getSelectedTextLength(screen), 4);
    select(-1, 9);
    EXPECT_EQ(AXUtils::getSelectedTextLength(screen), 0) << "the numbers come first";
}

struct CaretCase {
    std::int64_t location;
    std::int64_t maxLength;
    std::optional<std::u16string> answer;
};

TEST_F(Queries, ReadWhatStandsBeforeTheCaret) {
    select(0, 0);
    EXPECT_EQ(AXUtils::getTextBeforeCaretWithMaxLength(screen, 3), u"") << "at the start no text is needed";
    focused->setText(u"0123456789");
    const CaretCase cases[] = {{3, 10, u"012"}, {3, 2, u"12"},         {3, 3, u"012"},        {0, 3, u""},
                               {10, 1, u"9"},   {11, 3, std::nullopt}, {-1, 3, std::nullopt}, {5, -1, u""}};
    for (const CaretCase& one : cases) {
        select(one.location, 2);
        EXPECT_EQ(AXUtils::getTextBeforeCaretWithMaxLength(screen, one.maxLength), one.answer)
            << one.location << " " << one.maxLength;
    }
}

TEST_F(Queries, TurnRectanglesOver) {
    focused->setAttribute("AXPosition", Point{10, 100});
    EXPECT_EQ(AXUtils::getFocusedUIElementBound(screen), Rectangle{}) << "without a size";
    focused->setAttribute("AXSize", Size{300, 50});
    EXPECT_EQ(AXUtils::getFocusedUIElementBound(screen), (Rectangle{{10, 850}, {300, 50}}));

    focused->setRangeAttribute("AXBoundsForRange",
                               [](TextRange range) -> std::optional<SimulatedUIElement::RangeAnswer> {
                                   if (range.location != 3) return std::nullopt;
                                   return Rectangle{{20, 110}, {40, 15}};
                               });
    select(3, 4);
    EXPECT_EQ(AXUtils::getSelectedTextBound(screen), (Rectangle{{20, 875}, {40, 15}}));
    select(4, 4);
    EXPECT_EQ(AXUtils::getSelectedTextBound(screen), Rectangle{});
}

TEST_F(Queries, CopyTheSelectionFromRtfWhenThereIsSome) {
    TextAttributes bold;
    bold.font = FontAttribute{u"Helvetica", 12, true, false};
    const AttributedString fromRtf(u"rich", std::make_shared<const TextAttributes>(bold));
    const AttributedString fromAttributes(u"plain");
    focused->setRangeAttribute("AXAttributedStringForRange", [&](TextRange) { return fromAttributes; });
    EXPECT_FALSE(AXUtils::copySelectedAttributedString(screen)) << "no selection";
    select(2, 0);
    EXPECT_FALSE(AXUtils::copySelectedAttributedString(screen)) << "just a caret";
    select(2, 4);
    EXPECT_EQ(AXUtils::copySelectedAttributedString(screen), fromAttributes);

    focused->setRangeAttribute("AXRTFForRange", [](TextRange) { return std::string("no RTF"); });
    EXPECT_EQ(AXUtils::copySelectedAttributedString(screen), fromAttributes);
    focused->setRangeAttribute("AXRTFForRange", [&](TextRange) { return rtfFromAttributedString(fromRtf); });
    const auto copied = AXUtils::copySelectedAttributedString(screen);
    ASSERT_TRUE(copied);
    EXPECT_EQ(copied->string(), u"rich");
    ASSERT_TRUE(copied->attributesAt(0) && copied->attributesAt(0)->font);
    EXPECT_TRUE(copied->attributesAt(0)->font->bold);
}

Element withChildren(std::vector<SimulatedUIElement::Element> children) {
    const Element element = std::make_shared<SimulatedUIElement>();
    element->setAttribute("AXChildren", std::move(children));
    return element;
}

TEST_F(Queries, FindTheHelpMenusSearchField) {
    const Element field = withChildren({});
    const Element item = withChildren({field, withChildren({})});
    const Element menu = withChildren({item, withChildren({withChildren({})})});
    const Element title = withChildren({menu});
    application->setAttribute("AXMenuBar", withChildren({withChildren({}), title}));
    EXPECT_EQ(AXUtils::getHelpSearchFieldUIElement(screen), field);

    for (const Element& emptied : {item, menu, title}) {
        const std::vector<SimulatedUIElement::Element> children = emptied->elementsAttribute("AXChildren");
        emptied->setAttribute("AXChildren", std::vector<SimulatedUIElement::Element>());
        EXPECT_EQ(AXUtils::getHelpSearchFieldUIElement(screen), nullptr);
        emptied->setAttribute("AXChildren", children);
    }
    application->setAttribute("AXMenuBar", withChildren({}));
    EXPECT_EQ(AXUtils::getHelpSearchFieldUIElement(screen), nullptr);
}

}  // namespace
}  // namespace plume
