// Text with any attributes comes back from RTF and RTFD as it went in.
#include <algorithm>
#include <memory>
#include <optional>
#include <string>
#include <vector>

#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

#include "Foundation/text/RTFD.h"
#include "tests/Foundation/text/RTFTestSupport.h"

namespace plume {
namespace {

bool flipped() {
    return *rc::gen::arbitrary<bool>();
}

std::u16string arbitraryText() {
    const auto unit = rc::gen::oneOf(
        rc::gen::inRange<int>(0, 0x80), rc::gen::inRange<int>(0x80, 0x10000),
        rc::gen::elementOf(std::vector<int>{' ', '\\', '{', '}', '\t', 'a', '-', '7', '"', ';', '\r', 0x2028, 0xFFFC}));
    const auto inParagraph =
        rc::gen::map(unit, [](int value) { return value == '\n' ? u'a' : static_cast<char16_t>(value); });
    return *rc::gen::nonEmpty(rc::gen::container<std::u16string>(inParagraph));
}

// Of `parts` to a unit.
rc::Gen<double> fractions(double parts, int from, int to) {
    return rc::gen::map(rc::gen::inRange(from, to), [parts](int count) { return count / parts; });
}

// Colours of bytes, and finer ones with transparency.
ColorAttribute arbitraryColor() {
    const bool isFine = flipped();
    const auto part = isFine ? fractions(100'000, 0, 100'001) : fractions(255, 0, 256);
    return {*part, *part, *part, isFine ? *part : 1};
}

FontAttribute arbitraryFont() {
    const auto family =
        *rc::gen::element<std::u16string>(u"Helvetica", u"Gill Sans", u"\u30D2\u30E9\u30AE\u30CE", u"7{}\\", u"-");
    return {family, *fractions(2, 1, 200), flipped(), flipped()};
}

// Attachments of one name stand for different files.
std::shared_ptr<const TextAttachment> arbitraryAttachment() {
    return *rc::gen::elementOf(std::vector<std::shared_ptr<const TextAttachment>>{
        nullptr, attachment(u"a b.png", "one"), attachment(u"a b.png", std::string(5000, '\x80')),
        attachment(u"\u00E9\U0001F600{}\\.txt", ""), attachment(u"TXT.rtf", "{\\rtf1 not the text}")});
}

TextAttributes arbitraryCharacterAttributes() {
    TextAttributes attributes;
    if (flipped()) attributes.font = arbitraryFont();
    if (flipped()) attributes.foregroundColor = arbitraryColor();
    if (flipped()) attributes.backgroundColor = arbitraryColor();
    attributes.underlineStyle = *rc::gen::element<std::int64_t>(0, 0, 1, 9);
    attributes.strikethroughStyle = *rc::gen::element<std::int64_t>(0, 0, 1, 9);
    attributes.superscript = *rc::gen::inRange<std::int64_t>(-1, 2);
    if (const double offset = *fractions(2, -20, 20); offset != 0) attributes.baselineOffset = offset;
    if (flipped()) attributes.link = u"x" + arbitraryText();
    if (attributes.link && flipped()) attributes.toolTip = arbitraryText();
    attributes.attachment = arbitraryAttachment();
    return attributes;
}

std::optional<ParagraphStyle> arbitraryParagraphStyle() {
    const auto distance = fractions(20, -4000, 4000);
    ParagraphStyle style;
    style.alignment = static_cast<TextAlignment>(*rc::gen::inRange(0, 5));
    style.firstLineHeadIndent = *distance;
    style.headIndent = *distance;
    style.tailIndent = std::min(*distance, 0.0);
    style.lineSpacing = *distance;
    style.paragraphSpacing = *distance;
    style.paragraphSpacingBefore = *distance;
    style.lineHeightMultiple = *fractions(240, 0, 1000);
    style.tabStops = *rc::gen::container<std::vector<double>>(fractions(20, 0, 10000));
    if (style.tabStops.size() > 64) style.tabStops.resize(64);
    for (int i = *rc::gen::inRange(0, 10); i > 0; --i) {
        const auto marker =
            *rc::gen::element<std::u16string>(u"{disc}", u"({lower-alpha})", u"{decimal}.", u"\u2013", u"\\{x;");
        style.textLists.push_back({marker, *rc::gen::inRange<std::int64_t>(-3, 100)});
    }
    return style == ParagraphStyle{} ? std::nullopt : std::optional(style);
}

// Paragraphs of a few runs each, all in the style of their paragraph. An attachment stands on its character only.
AttributedString arbitraryDocument(bool withAttachments) {
    AttributedString text;
    const int paragraphs = *rc::gen::inRange(0, 4);
    for (int i = 0; i < paragraphs; ++i) {
        const auto style = flipped() ? arbitraryParagraphStyle() : std::nullopt;
        const int runs = *rc::gen::inRange(1, 4);
        for (int j = 0; j < runs; ++j) {
            TextAttributes attributes = arbitraryCharacterAttributes();
            attributes.paragraphStyle = style;
            std::u16string piece = arbitraryText();
            if (!withAttachments) attributes.attachment = nullptr;
            if (attributes.attachment) piece.assign(1, u'\uFFFC');
            if (j == runs - 1 && !attributes.attachment) piece += u"\n";
            const bool isPlain = attributes == TextAttributes{};
            text.append(piece, isPlain ? nullptr : std::make_shared<const TextAttributes>(attributes));
        }
        const TextAttributes last = attributesAt(text, text.length());
        if (last.attachment) {
            TextAttributes end;
            end.paragraphStyle = last.paragraphStyle;
            text.append(u"\n", std::make_shared<const TextAttributes>(end));
        }
    }
    return text;
}

RC_GTEST_PROP(RTFWriter, WhatIsWrittenReadsBackTheSame, ()) {
    const AttributedString text = arbitraryDocument(false);
    const std::string rtf = rtfFromAttributedString(text);
    for (const char byte : rtf) RC_ASSERT(static_cast<unsigned char>(byte) < 0x80);
    const auto again = attributedStringFromRTF(rtf);
    RC_ASSERT(again.ok());
    RC_ASSERT(again.value() == text);
}

RC_GTEST_PROP(RTFD, WhatIsWrittenReadsBackTheSame, ()) {
    const AttributedString text = arbitraryDocument(true);
    const auto again = attributedStringFromRTFD(rtfdFromAttributedString(text));
    RC_ASSERT(again.ok());
    RC_ASSERT(again.value() == text);
}

RC_GTEST_PROP(RTFReader, ATextCutShortGivesWhatStandsBeforeTheCut, ()) {
    const AttributedString text = arbitraryDocument(false);
    const std::string rtf = rtfFromAttributedString(text);
    const std::size_t length = *rc::gen::inRange<std::size_t>(5, rtf.size() + 1);
    const auto cut = attributedStringFromRTF(std::string_view(rtf).substr(0, length));
    RC_ASSERT(cut.ok());
    RC_ASSERT(text.string().starts_with(cut.value().string()));
    if (length == rtf.size()) RC_ASSERT(cut.value() == text);
}

}  // namespace
}  // namespace plume
