#include "app/editor/ContentDifference.h"

#include <algorithm>
#include <vector>

namespace plume {

namespace {

// The attributes of a text unit by unit.
class UnitAttributes {
  public:
    explicit UnitAttributes(const AttributedString& text) : text_(text) {
        runOf_.reserve(text.length());
        for (std::size_t run = 0; run < text.runs().size(); ++run)
            runOf_.insert(runOf_.end(), text.runs()[run].length, run);
    }

    const SharedAttributes& at(std::size_t index) const { return text_.runs()[runOf_[index]].attributes; }
    char16_t unitAt(std::size_t index) const { return text_.string()[index]; }

  private:
    const AttributedString& text_;
    std::vector<std::size_t> runOf_;
};

bool sameUnit(const UnitAttributes& a, std::size_t i, const UnitAttributes& b, std::size_t j) {
    return a.unitAt(i) == b.unitAt(j) && sameAttributes(a.at(i), b.at(j));
}

bool startsParagraph(const std::u16string& text, std::size_t index) {
    if (index == 0) return true;
    const char16_t before = text[index - 1];
    if (before == u'\r') return index == text.size() || text[index] != u'\n';
    return before == u'\n' || before == u'\u2029' || before == 0xFDD0 || before == 0xFDD1;
}

}  // namespace

ContentDifference differenceBetween(const AttributedString& first, const AttributedString& second) {
    const UnitAttributes a(first);
    const UnitAttributes b(second);
    const std::size_t shorter = std::min(first.length(), second.length());
    ContentDifference difference{0, first.length(), second.length()};
    while (difference.start < shorter && sameUnit(a, difference.start, b, difference.start)) ++difference.start;
    while (difference.endInFirst > difference.start && difference.endInSecond > difference.start &&
           sameUnit(a, difference.endInFirst - 1, b, difference.endInSecond - 1)) {
        --difference.endInFirst;
        --difference.endInSecond;
    }
    return difference;
}

ContentDifference ContentDifference::inParagraphs(const AttributedString& first, const AttributedString& second) const {
    ContentDifference wide = *this;
    while (!startsParagraph(first.string(), wide.start) || !startsParagraph(second.string(), wide.start)) --wide.start;
    while (wide.endInFirst < first.length() &&
           (!startsParagraph(first.string(), wide.endInFirst) || !startsParagraph(second.string(), wide.endInSecond))) {
        ++wide.endInFirst;
        ++wide.endInSecond;
    }
    return wide;
}

}  // namespace plume
