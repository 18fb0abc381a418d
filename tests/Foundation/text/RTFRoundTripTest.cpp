// Text with any attributes comes back from RTF and RTFD as it went in.
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

template <typename Value>
rc::Gen<std::optional<Value>> maybe(rc::Gen<Value> gen) {
    return rc::gen::oneOf(rc::gen::just(std::optional<Value>()),
                          rc::gen::map(gen, [](Value value) { return std::optional<Value>(std::move(value)); }));
}

rc::Gen<std::u16string> arbitraryText() {
    const auto unit = rc::gen::oneOf(
        rc::gen::inRange<int>(0, 0x80), rc::gen::inRange<int>(0x80, 0x10000),
        rc::gen::elementOf(std::vector<int>{' ', '\\', '{', '}', '\t', 'a', '-', '7', '"', ';', '\r', 0x2028, 0xFFFC}));
    const auto inParagraph =
        rc::gen::map(unit, [](int value) { return value == '\n' ? u'a' : static_cast<char16_t>(value); });
    return rc::gen::nonEmpty(rc::gen::container<std::u16string>(inParagraph));
}

rc::Gen<double> multiplesOf(double step, int from, int to) {
    return rc::gen::map(rc::gen::inRange(from, to), [step](int count) { return count / step; });
}

rc::Gen<ColorAttribute> colorOf(const rc::Gen<double>& component, const rc::Gen<double>& alpha) {
    return rc::gen::apply(
        [](double red, double green, double blue, double a) {
            return ColorAttribute{red, green, blue, a};
        },
        component, component, component, alpha);
}

// Colours of bytes, and finer ones with transparency.
rc::Gen<ColorAttribute> arbitraryColor() {
    const auto fine = multiplesOf(100'000, 0, 100'001);
    return rc::gen::oneOf(colorOf(multiplesOf(255, 0, 256), rc::gen::just(1.0)), colorOf(fine, fine));
}

rc::Gen<FontAttribute> arbitraryFont() {
    const auto family = rc::gen::elementOf(
        std::vector<std::u16string>{u"Helvetica", u"Gill Sans", u"\u30D2\u30E9\u30AE\u30CE", u"7{}\\", u"-"});
    return rc::gen::apply(
        [](std::u16string name, double size, bool bold, bool italic) {
            return FontAttribute{name, size, bold, italic};
        },
        family, multiplesOf(2, 1, 200), rc::gen::arbitrary<bool>(), rc::gen::arbitrary<bool>());
}

// Attachments of one name stand for different files.
rc::Gen<std::shared_ptr<const TextAttachment>> arbitraryAttachment() {
    return rc::gen::elementOf(std::vector<std::shared_ptr<const TextAttachment>>{
        nullptr, attachment(u"a b.png", "one"), attachment(u"a b.png", std::string(5000, '\x80')),
        attachment(u"\u00E9\U0001F600{}\\.txt", ""), attachment(u"TXT.rtf", "{\\rtf1 not the text}")});
}

rc::Gen<TextAttributes> arbitraryCharacterAttributes() {
    const auto link = rc::gen::map(arbitraryText(), [](std::u16string text) { return u"x" + text; });
    const auto lineStyle = rc::gen::element<std::int64_t>(0, 0, 1, 9);
    return rc::gen::apply(
        [](auto font, auto foreground, auto background, auto underline, auto strike, auto super, auto baseline,
           auto aLink, auto toolTip, auto file) {
            TextAttributes attributes;
            attributes.font = font;
            attributes.foregroundColor = foreground;
            attributes.backgroundColor = background;
            attributes.underlineStyle = underline;
            attributes.strikethroughStyle = strike;
            attributes.superscript = super;
            if (baseline != 0) attributes.baselineOffset = baseline;
            attributes.link = aLink;
            if (aLink) attributes.toolTip = toolTip;
            attributes.attachment = file;
            return attributes;
        },
        maybe(arbitraryFont()), maybe(arbitraryColor()), maybe(arbitraryColor()), lineStyle, lineStyle,
        rc::gen::inRange<std::int64_t>(-1, 2), multiplesOf(2, -20, 20), maybe(link), maybe(arbitraryText()),
        arbitraryAttachment());
}

rc::Gen<std::optional<ParagraphStyle>> arbitraryParagraphStyle() {
    const auto list = rc::gen::apply(
        [](std::u16string marker, std::int64_t start) {
            return TextList{marker, start};
        },
        rc::gen::elementOf(
            std::vector<std::u16string>{u"{disc}", u"({lower-alpha})", u"{decimal}.", u"\u2013", u"\\{x;"}),
        rc::gen::inRange<std::int64_t>(-3, 100));
    const auto distances = rc::gen::container<std::vector<double>>(6, multiplesOf(20, -4000, 4000));
    return rc::gen::apply(
        [](int alignment, std::vector<double> distance, double multiple, std::vector<double> tabStops,
           std::vector<TextList> lists) -> std::optional<ParagraphStyle> {
            ParagraphStyle style;
            style.alignment = static_cast<TextAlignment>(alignment);
            style.firstLineHeadIndent = distance[0];
            style.headIndent = distance[1];
            style.tailIndent = distance[2] > 0 ? 0 : distance[2];
            style.lineSpacing = distance[3];
            style.paragraphSpacing = distance[4];
            style.paragraphSpacingBefore = distance[5];
            style.lineHeightMultiple = multiple;
            if (tabStops.size() > 64) tabStops.resize(64);
            style.tabStops = std::move(tabStops);
            if (lists.size() > 9) lists.resize(9);
            style.textLists = std::move(lists);
            return style == ParagraphStyle{} ? std::nullopt : std::optional(style);
        },
        rc::gen::inRange(0, 5), distances, multiplesOf(240, 0, 1000),
        rc::gen::container<std::vector<double>>(multiplesOf(20, 0, 10000)),
        rc::gen::container<std::vector<TextList>>(list));
}

// Paragraphs of a few runs each, all in the style of their paragraph. An attachment stands on its character only.
AttributedString arbitraryDocument(bool withAttachments) {
    AttributedString text;
    const int paragraphs = *rc::gen::inRange(0, 4);
    for (int i = 0; i < paragraphs; ++i) {
        const auto style = *maybe(arbitraryParagraphStyle());
        const int runs = *rc::gen::inRange(1, 4);
        for (int j = 0; j < runs; ++j) {
            TextAttributes attributes = *arbitraryCharacterAttributes();
            attributes.paragraphStyle = style.value_or(std::nullopt);
            std::u16string piece = *arbitraryText();
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
