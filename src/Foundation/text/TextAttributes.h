// What a stretch of rich text looks like: a value shared by all runs that look the same.
#pragma once

#include <cstdint>
#include <memory>
#include <optional>
#include <string>
#include <vector>

namespace plume {

struct FontAttribute {
    std::u16string family;
    double size = 12;  // points
    bool bold = false;
    bool italic = false;

    bool operator==(const FontAttribute&) const = default;
};

// Components from 0 to 1.
struct ColorAttribute {
    double red = 0;
    double green = 0;
    double blue = 0;
    double alpha = 1;

    bool operator==(const ColorAttribute&) const = default;
};

enum class TextAlignment { Left = 0, Right = 1, Center = 2, Justified = 3, Natural = 4 };

// One level of list that a paragraph stands in, outermost first in ParagraphStyle::textLists.
struct TextList {
    std::u16string markerFormat;  // "{disc}", "{decimal}."
    std::int64_t startingItemNumber = 1;

    bool operator==(const TextList&) const = default;
};

// Distances are in points.
struct ParagraphStyle {
    TextAlignment alignment = TextAlignment::Natural;
    double firstLineHeadIndent = 0;
    double headIndent = 0;
    double tailIndent = 0;
    double lineSpacing = 0;
    double lineHeightMultiple = 0;
    double paragraphSpacing = 0;
    double paragraphSpacingBefore = 0;
    std::vector<double> tabStops;  // locations; empty means the default ones
    std::vector<TextList> textLists;

    bool operator==(const ParagraphStyle&) const = default;
};

// What stands in the text as one U+FFFC: a file with its bytes, or a chip of the editor that shows `cellText`.
struct TextAttachment {
    std::u16string fileName;
    std::string contents;
    std::u16string cellText;

    bool operator==(const TextAttachment&) const = default;
};

struct TextAttributes {
    std::optional<FontAttribute> font;
    std::optional<ColorAttribute> foregroundColor;
    std::optional<ColorAttribute> backgroundColor;
    std::int64_t underlineStyle = 0;      // 0 none, 1 single
    std::int64_t strikethroughStyle = 0;  // 0 none, 1 single
    std::int64_t superscript = 0;         // 1 raised, -1 lowered
    std::optional<double> baselineOffset;
    std::optional<std::u16string> link;
    std::optional<std::u16string> toolTip;
    std::optional<ParagraphStyle> paragraphStyle;
    std::shared_ptr<const TextAttachment> attachment;

    // Attachments compare by what they hold.
    bool operator==(const TextAttributes& other) const;
};

// Null means no attributes at all; equal attributes may or may not be the same object.
using SharedAttributes = std::shared_ptr<const TextAttributes>;

bool sameAttributes(const SharedAttributes& a, const SharedAttributes& b);

}  // namespace plume
