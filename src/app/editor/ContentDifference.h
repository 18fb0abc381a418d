// What of a text another one has in the same way at its beginning and its end.
//
// Pure; takes time linear in both.
#pragma once

#include <cstddef>

#include "Foundation/text/AttributedString.h"

namespace plume {

// The two texts are equal before `start`, and behind their ends. All are in the texts' units.
struct ContentDifference {
    std::size_t start = 0;
    std::size_t endInFirst = 0;
    std::size_t endInSecond = 0;

    // Widened to whole paragraphs, which may be parted by a carriage return with a line feed.
    ContentDifference inParagraphs(const AttributedString& first, const AttributedString& second) const;
    bool isEmpty() const { return start == endInFirst && start == endInSecond; }
};

ContentDifference differenceBetween(const AttributedString& first, const AttributedString& second);

}  // namespace plume
