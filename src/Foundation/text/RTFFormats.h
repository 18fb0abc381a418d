// The state of RTF's formatting, in RTF's own units: what the control words before a piece of text amount to.
#pragma once

#include <compare>
#include <cstddef>
#include <memory>
#include <vector>

#include "Foundation/text/TextAttributes.h"

namespace plume {

inline constexpr int RTFHalfPointsPerPoint = 2;
inline constexpr int RTFTwipsPerPoint = 20;
inline constexpr int RTFUnitsPerLine = 240;
inline constexpr int RTFDefaultHalfPoints = 24;
inline constexpr int RTFDeepestListLevel = 8;

// Limits of the reader; the writer stays within them.
inline constexpr int RTFMaximumTwips = 1'000'000;
inline constexpr int RTFMaximumHalfPoints = 20'000;
inline constexpr std::size_t RTFMaximumFonts = 10'000;
inline constexpr std::size_t RTFMaximumColors = 10'000;
inline constexpr std::size_t RTFMaximumLists = 4096;
inline constexpr std::size_t RTFMaximumTabStops = 64;
inline constexpr std::size_t RTFMaximumMarkerLength = 64;
inline constexpr int RTFExpandedColorUnits = 100'000;

// Comparing the members is enough to tell whether two pieces of one document look the same.
struct RTFCharacterFormat {
    bool hasFont = false;  // a font, a size or a face was asked for
    int font = -1;         // number in the font table
    int halfPoints = RTFDefaultHalfPoints;
    bool bold = false;
    bool italic = false;
    bool hidden = false;
    int foreground = 0;  // index in the colour table; 0 is the automatic colour
    int background = 0;
    int underline = 0;
    int strikethrough = 0;
    int superscript = 0;
    int raisedHalfPoints = 0;
    int link = 0;        // 1-based, in the document's order of links; 0 is none
    int attachment = 0;  // likewise

    auto operator<=>(const RTFCharacterFormat&) const = default;
};

// Distances are in twips.
struct RTFParagraphFormat {
    TextAlignment alignment = TextAlignment::Natural;
    int leftIndent = 0;
    int firstLineIndent = 0;  // from the left indent
    int rightIndent = 0;
    int spaceBefore = 0;
    int spaceAfter = 0;
    int leading = 0;
    int lineHeight = 0;  // 240 is one line, when `isLineMultiple`
    bool isLineMultiple = false;
    int list = 0;  // number in the list override table; 0 is none
    int listLevel = 0;
    std::shared_ptr<const std::vector<int>> tabStops;  // null: the default ones

    bool operator==(const RTFParagraphFormat& other) const;
};

inline bool RTFParagraphFormat::operator==(const RTFParagraphFormat& other) const {
    const bool sameTabs = tabStops == other.tabStops || (tabStops && other.tabStops && *tabStops == *other.tabStops);
    return sameTabs && alignment == other.alignment && leftIndent == other.leftIndent &&
           firstLineIndent == other.firstLineIndent && rightIndent == other.rightIndent &&
           spaceBefore == other.spaceBefore && spaceAfter == other.spaceAfter && leading == other.leading &&
           lineHeight == other.lineHeight && isLineMultiple == other.isLineMultiple && list == other.list &&
           listLevel == other.listLevel;
}

}  // namespace plume
