#include "Foundation/archive/TypedStream.h"

#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

#include <string>
#include <utility>

#include "tests/Foundation/archive/ArchiveTestSupport.h"

namespace plume {
namespace {

using namespace std::string_literals;

TextAttributes firstAttributes() {
    TextAttributes attributes;
    attributes.font = FontAttribute{u"Helvetica", 12.5, true};
    attributes.foregroundColor = ColorAttribute{1, 0.5, 0};
    attributes.underlineStyle = 1;
    attributes.paragraphStyle.emplace().alignment = TextAlignment::Center;
    return attributes;
}

TextAttributes secondAttributes() {
    TextAttributes attributes;
    attributes.font = FontAttribute{u"Times", 300};
    attributes.link = u"http://x.org";
    attributes.superscript = -1;
    attributes.attachment = std::make_shared<TextAttachment>(TextAttachment{u"a.png", "PNG!", {}});
    return attributes;
}

std::string shown(const Result<AttributedString>& text) {
    return text ? "text of " + std::to_string(text.value().length()) + " units" : text.error().message;
}

TEST(TypedStream, ReadsAttributedTextOfBothByteOrders) {
    const test::ScriptFolder folder("make_typed_streams.py");
    ASSERT_TRUE(folder.run("write"));
    AttributedString expected(u"\u00E9\U0001F600", std::make_shared<TextAttributes>(firstAttributes()));
    expected.append(std::u16string(300, u'x'), std::make_shared<TextAttributes>(secondAttributes()));
    expected.append(u"\uFFFC", std::make_shared<TextAttributes>(firstAttributes()));
    for (const std::string name : {"rich", "rich.big"}) {
        const auto text = attributedStringFromTypedStream(folder.read(name));
        ASSERT_TRUE(text) << text.error().message;
        EXPECT_EQ(text.value(), expected) << name;
    }
    EXPECT_EQ(attributedStringFromTypedStream(folder.read("plain")).value(), AttributedString(u"plain"));
    EXPECT_EQ(attributedStringFromTypedStream(folder.read("string")).value(), AttributedString(u"only text"));
    EXPECT_EQ(attributedStringFromTypedStream(folder.read("other")).error().message,
              "The typed stream holds no text: expected an NSAttributedString or NSString.");
}

TEST(TypedStream, KeepsTheTextThatStandsBeforeDamage) {
    const test::ScriptFolder folder("make_typed_streams.py");
    ASSERT_TRUE(folder.run("write"));
    const std::string whole = folder.read("rich");
    const std::size_t endOfText = whole.find("xxx") + 303;
    for (std::size_t length = 0; length < whole.size(); ++length) {
        const auto text = attributedStringFromTypedStream(whole.substr(0, length));
        EXPECT_EQ(text.ok(), length >= endOfText) << length << " " << shown(text);
        EXPECT_EQ(text.ok() ? text.value().length() : 304, 304u);
    }
}

// A stream that begins with the type "@" and a new object.
std::string stream(const std::string& rest) {
    return "\x04\x0Bstreamtyped\x81\xE8\x03\x84\x01@\x84"s + rest;
}
const std::string StringClass = "\x84\x84\x08NSString\x01\x85"s;

TEST(TypedStream, RefusesDamage) {
    const std::pair<std::string, std::string> cases[] = {
        {"", "byte 0: expected more bytes"},
        {"\x03\x0Bstreamtyped\x81\xE8\x03"s, "the version 4"},
        {"\x04\x0Bstreamtypes\x81\xE8\x03"s, "the signature"},
        {stream(StringClass), "more bytes"},
        {stream("\x93"s), "a reference to what was there before"},
        {stream("\x87" + std::string(7, '\xFF') + "\x7F"), "a reference to what was there before"},
        {stream("\x92"s), "a reference to a class"},
        {stream("\x84\x84\x7FNSString"s), "as many bytes as the length before says"},
        {stream(StringClass + "\x84\x01+\x82\xFF\xFF\xFF\xFF"s), "as many bytes as the length before says"},
        {stream(StringClass + "\x84\x01?"s), "a type that is known"},
        {stream(StringClass + "\x84\x01i\x85"s), "a number before this byte"},
        {stream(StringClass + "\x84\x03[9i"s), "as many values as the array's type says"},
        {stream(StringClass + "\x84\x02{="s), "the end of a structure's type"},
        {stream(StringClass + "\x84\x08[4[0i]]x\x96\x96\x96\x96\x96\x96"s), "expected"},
        {stream(StringClass + "\x86"s), "holds no text"},
    };
    for (const auto& [bytes, message] : cases) {
        const auto text = attributedStringFromTypedStream(bytes);
        ASSERT_FALSE(text) << message;
        EXPECT_NE(text.error().message.find(message), std::string::npos) << message << ": " << text.error().message;
    }
    std::string deep;
    for (int i = 0; i < 200; ++i) deep += i == 0 ? StringClass + "\x84\x01@\x84" : "\x93\x92\x84"s;
    EXPECT_NE(shown(attributedStringFromTypedStream(stream(deep))).find("fewer objects inside"), std::string::npos);
}

}  // namespace
}  // namespace plume
