// Attributed texts of any kind, to be shown and read back.
#pragma once

#include <rapidcheck.h>

#include <memory>
#include <optional>
#include <string>
#include <vector>

#include "Foundation/text/AttributedString.h"

namespace plume::test {

inline SharedAttributes looking(TextAttributes attributes) {
    return std::make_shared<const TextAttributes>(std::move(attributes));
}

inline SharedAttributes boldLook() {
    TextAttributes attributes;
    attributes.font = FontAttribute{u"", 0, true, false};
    return looking(attributes);
}

inline bool tossed() {
    return *rc::gen::arbitrary<bool>();
}

// With all that documents have a meaning of their own for.
inline std::u16string anyText() {
    const auto unit = rc::gen::oneOf(
        rc::gen::inRange<int>(0, 0x10000),
        rc::gen::elementOf(std::vector<int>{'a', ' ', '\n', '\n', '\r', '\t', 0, 0xA0, 0x2028, 0x2029, 0xFDD0, 0xFDD1,
                                            0xFFFC, 0xFFFC, 0xD83D, 0xDE00, 0x3010, 0x3011}));
    return *rc::gen::nonEmpty(
        rc::gen::container<std::u16string>(rc::gen::map(unit, [](int value) { return static_cast<char16_t>(value); })));
}

inline double anyNumber() {
    return *rc::gen::elementOf(std::vector<double>{-1e9, -20, -0.5, 0, 0.25, 1, 12, 36, 400, 1e9});
}

inline ParagraphStyle anyStyle() {
    ParagraphStyle style;
    style.alignment = static_cast<TextAlignment>(*rc::gen::inRange(0, 5));
    style.firstLineHeadIndent = anyNumber();
    style.headIndent = anyNumber();
    style.tailIndent = anyNumber();
    style.lineSpacing = anyNumber();
    style.lineHeightMultiple = anyNumber();
    style.paragraphSpacing = anyNumber();
    style.paragraphSpacingBefore = anyNumber();
    if (tossed()) style.tabStops = {anyNumber(), anyNumber()};
    if (tossed()) style.textLists = {{u"{disc}", 1}, {u"{decimal}.", *rc::gen::inRange<std::int64_t>(-3, 9)}};
    return style;
}

inline TextAttributes anyCharacters() {
    TextAttributes attributes;
    if (tossed()) attributes.font = FontAttribute{tossed() ? u"Helvetica" : u"", anyNumber(), tossed(), tossed()};
    if (tossed()) attributes.foregroundColor = ColorAttribute{anyNumber(), 0, 0, anyNumber()};
    if (tossed()) attributes.backgroundColor = ColorAttribute{0, anyNumber(), 0, 1};
    attributes.underlineStyle = *rc::gen::element<std::int64_t>(0, 1, 9);
    attributes.strikethroughStyle = *rc::gen::element<std::int64_t>(0, 1, 9);
    attributes.superscript = *rc::gen::inRange<std::int64_t>(-2, 3);
    if (tossed()) attributes.baselineOffset = anyNumber();
    if (tossed()) attributes.link = anyText();
    if (tossed()) attributes.toolTip = anyText();
    if (tossed()) {
        attributes.attachment = std::make_shared<const TextAttachment>(TextAttachment{anyText(), "no picture", {}});
    }
    return attributes;
}

// Paragraphs may be in several styles, and files may stand anywhere.
inline AttributedString anyContent() {
    AttributedString text;
    const bool isTidy = tossed();
    auto style = tossed() ? std::optional(anyStyle()) : std::nullopt;
    for (int runs = *rc::gen::inRange(0, 8); runs > 0; --runs) {
        TextAttributes attributes = tossed() ? anyCharacters() : TextAttributes();
        attributes.paragraphStyle = style;
        text.append(anyText(), looking(attributes));
        if (!isTidy && tossed()) style = tossed() ? std::optional(anyStyle()) : std::nullopt;
    }
    return text;
}

}  // namespace plume::test
