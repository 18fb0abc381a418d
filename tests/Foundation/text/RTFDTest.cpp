#include "Foundation/text/RTFD.h"

#include <cmath>
#include <cstdint>
#include <string>
#include <utility>
#include <vector>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include "tests/Foundation/text/RTFTestSupport.h"

namespace plume {
namespace {

using testing::HasSubstr;

// ---- Writing ----

TEST(RTFWriter, WritesOnlyWhatDiffers) {
    AttributedString text(u"a{");
    text.append(attributed(u"b\u20AC", [](TextAttributes& attributes) {
        attributes.font = FontAttribute{u"Gill Sans", 13, true, false};
        attributes.foregroundColor = ColorAttribute{1, 0, 0, 1};
    }));
    text.append(attributed(u"\U0001F600\n", [](TextAttributes& attributes) {
        attributes.font = FontAttribute{u"Gill Sans", 13, false, false};
        attributes.foregroundColor = ColorAttribute{1, 0, 0, 1};
    }));
    EXPECT_EQ(rtfFromAttributedString(text),
              "{\\rtf1\\ansi\\ansicpg1252\\uc0\n"
              "{\\fonttbl{\\f0\\fnil\\fcharset0 Gill Sans;}}\n"
              "{\\colortbl;\\red255\\green0\\blue0;}\n"
              "a\\{\\f0\\fs26\\b\\cf1 b\\u8364\\b0\\u-10179\\u-8704\\par\n"
              "}");
}

TEST(RTFWriter, WritesMarkersOfListsForReadersWithoutLists) {
    const AttributedString text = attributed(u"\t\u2022\tOne", [](TextAttributes& attributes) {
        attributes.paragraphStyle.emplace().textLists = {{u"{disc}", 1}};
    });
    const std::string rtf = rtfFromAttributedString(text);
    EXPECT_THAT(rtf, HasSubstr("\\pard\\ls1\\ilvl0{\\listtext\\tab\\u8226\\tab}One"));
    EXPECT_THAT(rtf, HasSubstr("{\\*\\levelmarker\\{disc\\}}{\\leveltext\\'01\\u8226;}"));
    EXPECT_EQ(attributedStringFromRTF(rtf).value(), text);
}

TEST(RTFWriter, ValuesThatRTFCannotHoldAreBroughtBack) {
    const AttributedString text = attributed(u"a", [](TextAttributes& attributes) {
        attributes.font = FontAttribute{u" A;\n", std::nan(""), false, false};
        attributes.foregroundColor = ColorAttribute{-1, 7, std::nan(""), 1};
        attributes.baselineOffset = -1e300;
        ParagraphStyle& style = attributes.paragraphStyle.emplace();
        style.headIndent = 1e300;
        style.firstLineHeadIndent = -1e300;
        style.tabStops.assign(1000, 1);
        style.textLists.assign(100, {u"{disc}", std::int64_t{1} << 60});
    });
    const TextAttributes attributes = attributesAt(attributedStringFromRTF(rtfFromAttributedString(text)).value(), 0);
    EXPECT_EQ(attributes.font, (FontAttribute{u"A", 0.5, false, false}));
    EXPECT_EQ(attributes.foregroundColor, (ColorAttribute{0, 1, 0, 1}));
    EXPECT_EQ(attributes.baselineOffset, -10000);
    EXPECT_EQ(attributes.paragraphStyle->headIndent, 50000);
    EXPECT_EQ(attributes.paragraphStyle->tabStops.size(), 64u);
    EXPECT_EQ(attributes.paragraphStyle->textLists.size(), 9u);
}

// ---- The flat container ----

std::string number(std::uint32_t value) {
    std::string bytes;
    for (int i = 0; i < 4; ++i) bytes.push_back(static_cast<char>((value >> (8 * i)) & 0xFF));
    return bytes;
}

std::string named(std::string_view text) {
    return number(static_cast<std::uint32_t>(text.size())) + std::string(text);
}

std::string file(std::string_view contents) {
    return number(1) + named(contents);
}

std::string container(const std::vector<std::pair<std::string, std::string>>& entries) {
    std::string bytes = "rtfd" + number(0) + number(3) + number(static_cast<std::uint32_t>(entries.size()));
    for (const auto& [name, value] : entries) bytes += named(name);
    for (const auto& [name, value] : entries) bytes += number(static_cast<std::uint32_t>(value.size()));
    for (const auto& [name, value] : entries) bytes += value;
    return bytes;
}

TEST(RTFD, WritesTheContainerByteForByte) {
    const std::string rtf = "{\\rtf1\\ansi\\ansicpg1252\\uc0\na}";
    const std::string attributes = number(16) + number(0) + number(0644) + number(0) + number(0);
    EXPECT_EQ(rtfdFromAttributedString(AttributedString(u"a")),
              container({{"TXT.rtf", file(rtf)}, {".", file(number(1) + named("TXT.rtf") + attributes)}}));
}

TEST(RTFD, LargeFilesStartOnAPage) {
    const std::string contents(4096, '\x07');
    const std::string bytes = rtfdFromAttributedString(
        attributed(u"\uFFFC", [&](TextAttributes& attributes) { attributes.attachment = attachment(u"x", contents); }));
    EXPECT_EQ(bytes.find(contents) % 4096, 0u);
}

TEST(RTFD, ReadsAttachmentsWhereTheTextShowsThemAndNoFolders) {
    const std::string text = file("{\\rtf1 a{{\\NeXTGraphic my pic.png \\width640 \\height480 \n}\\'ac}b}");
    const AttributedString read =
        attributedStringFromRTFD(container({{"my pic.png", file("PNG")}, {"unused", file("x")}, {"TXT.rtf", text}}))
            .value();
    EXPECT_EQ(read.string(), u"a\uFFFCb");
    EXPECT_EQ(*attributesAt(read, 1).attachment, (TextAttachment{u"my pic.png", "PNG", {}}));
    EXPECT_FALSE(attributesAt(read, 2).attachment);
    EXPECT_EQ(attributedStringFromRTF(rtfFromAttributedString(read)).value().string(), u"ab");
    const std::string folder = container({{"x", file("y")}}).substr(8);
    const std::string withFolder = container({{"my pic.png", folder}, {"TXT.rtf", text}});
    EXPECT_EQ(attributedStringFromRTFD(withFolder).value().string(), u"ab");
    EXPECT_EQ(attributedStringFromRTFD("{\\rtf1 a}").value().string(), u"a");
}

TEST(RTFD, DamageIsToldWithItsPlace) {
    const std::string good = container({{"TXT.rtf", file("{\\rtf1 a}")}});
    for (std::size_t length = 4; length < good.size(); ++length) {
        const auto cut = attributedStringFromRTFD(good.substr(0, length));
        ASSERT_FALSE(cut) << length;
        EXPECT_THAT(cut.error().message, HasSubstr("damaged at byte ")) << length;
    }
    const std::string head = "rtfd" + number(0);
    for (const std::string& bytes : {
             head + number(7) + number(0),
             head + number(3) + number(0xFFFFFFFF),
             head + number(3) + number(1) + number(0xFFFFFFF0) + std::string(16, 'x'),
             container({{"TXT.rtf", number(1) + number(100) + "{\\rtf1"}}),
             container({{"TXT.rtf", number(1) + number(0x80000000) + number(4) + number(0xFFFFFFFF) + "{\\rtf1"}}),
             container({{"TXT.rtf", number(2) + "abcd"}}),
         }) {
        const auto text = attributedStringFromRTFD(bytes);
        ASSERT_FALSE(text) << bytes;
        EXPECT_THAT(text.error().message, HasSubstr("damaged at byte "));
    }
    EXPECT_THAT(attributedStringFromRTFD(container({{"a", file("b")}})).error().message, HasSubstr("TXT.rtf"));
    EXPECT_FALSE(attributedStringFromRTFD(""));
}

TEST(FlatContainer, HoldsOneAttachmentWithItsName) {
    const TextAttachment picture{u"\u00E9.png", std::string(10'000, '\x89'), {}};
    const std::string bytes = flatContainerFromAttachment(picture);
    EXPECT_EQ(attachmentFromFlatContainer(bytes).value(), picture);
    EXPECT_FALSE(attachmentFromFlatContainer(container({{"TXT.rtf", file("{\\rtf1}")}})));
}

}  // namespace
}  // namespace plume
