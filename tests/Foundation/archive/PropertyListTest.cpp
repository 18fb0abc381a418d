#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

#include <cstdint>
#include <limits>
#include <string>
#include <utility>

#include "Foundation/Strings.h"
#include "Foundation/archive/PropertyListReader.h"
#include "Foundation/archive/PropertyListWriter.h"
#include "tests/Foundation/archive/ArchiveTestSupport.h"

namespace plume {
namespace {

using namespace std::chrono_literals;
using namespace std::string_literals;
using Array = PropertyList::Array;
using Dictionary = PropertyList::Dictionary;

// What was read, or the error.
std::string shown(const Result<PropertyList>& list) {
    return list ? xmlPropertyList(list.value()) : list.error().message;
}

void expectReads(const std::string& bytes, const PropertyList& expected) {
    const auto list = readPropertyList(bytes);
    EXPECT_TRUE(list && list.value() == expected) << bytes.substr(0, 200) << "\n" << shown(list);
}

void expectRefuses(const std::string& bytes, const std::string& message) {
    const auto list = readPropertyList(bytes);
    ASSERT_FALSE(list) << bytes.substr(0, 200);
    EXPECT_NE(list.error().message.find(message), std::string::npos) << list.error().message;
}

std::string plist(const std::string& body) {
    return "<?xml version=\"1.0\" encoding=\"UTF-8\"?>\n<!DOCTYPE plist PUBLIC \"-//Apple//DTD PLIST 1.0//EN\" "
           "\"http://www.apple.com/DTDs/PropertyList-1.0.dtd\">\n<plist version=\"1.0\">" +
           body + "</plist>";
}

TEST(PropertyList, AgreesWithAnotherProgram) {
    const test::ScriptFolder folder("property_lists.py");
    ASSERT_TRUE(folder.run("write"));
    const auto list = readPropertyList(folder.read("sample.binary"));
    ASSERT_TRUE(list) << list.error().message;
    EXPECT_EQ(*list.value().find<Date>("date"), std::chrono::sys_days(2024y / 2 / 29) + 12h + 30min + 59s);
    EXPECT_EQ(*list.value().find<std::u16string>("text"), u"plain & <b> \"quoted\"\n");
    expectReads(folder.read("sample.xml"), list.value());
    expectReads(folder.read("sample.utf16"), list.value());
    folder.write("ours.binary", binaryPropertyList(list.value()));
    folder.write("ours.xml", xmlPropertyList(list.value()));
    EXPECT_TRUE(folder.run("check"));
}

TEST(PropertyList, ReadsXml) {
    const Dictionary one{{"k", std::u16string(u"v")}};
    expectReads(plist("<dict><key>k</key><string>v</string></dict>"), one);
    expectReads("\xEF\xBB\xBF" + plist("<dict><key>k</key><string>v</string></dict>"), one);
    expectReads("\n <dict><key>k</key>\n<string>v</string></dict>", one);
    expectReads(plist("<integer> -0x10 </integer>"), std::int64_t{-16});
    expectReads(plist("<integer>18446744073709551615</integer>"), 18446744073709551615.0);
    expectReads(plist("<real>+1.5e1</real>"), 15.0);
    expectReads(plist("<data>\n\tAAEC\n\t/w==\n</data>"), ArchivedData{"\0\1\2\xFF"s});
    expectReads(plist("<string>a<![CDATA[<]]>&#x1F600;&amp;</string>"), std::u16string(u"a<\U0001F600&"));
    expectReads(plist("<dict><key>CF$UID</key><integer>7</integer></dict>"), PropertyList::Uid{7});
    expectReads("<?xml version=\"1.0\" encoding=\"ISO-8859-1\"?><plist><string>\xE9</string></plist>",
                std::u16string(u"\u00E9"));
    const std::string deep = plist("<array><array/></array>");
    expectReads(deep, Array(1, PropertyList(Array())));
}

TEST(PropertyList, RefusesWrongXml) {
    const std::pair<std::string, std::string> cases[] = {
        {plist(""), "a value inside of \"plist\""},
        {plist("<dict><string>v</string></dict>"), "line 3: expected a key before the value"},
        {plist("<dict><key>k</key></dict>"), "a value behind the last key"},
        {plist("<dict><key>a</key><key>b</key></dict>"), "a value behind the key"},
        {plist("<array><key>k</key></array>"), "no key outside"},
        {plist("<key>k</key>"), "a value instead of a key"},
        {plist("<true/><true/>"), "a single value"},
        {plist("<array>text</array>"), "no text outside of values"},
        {plist("<string><b/></string>"), "no element inside of \"string\""},
        {plist("<blob/>"), "an element of a property list"},
        {plist("<integer>7x</integer>"), "a value that \"integer\" can hold"},
        {plist("<date>2024-02-30T00:00:00Z</date>"), "a value that \"date\" can hold"},
        {plist("<data>*</data>"), "a value that \"data\" can hold"},
        {plist("<array>"), "well-formed XML"},
        {plist("<string>&other;</string>"), "no entities but XML's own"},
        {"<!DOCTYPE plist [<!ENTITY a \"aa\"><!ENTITY b \"&a;&a;\">]><plist><string>&b;</string></plist>",
         "no declarations of entities"},
    };
    for (const auto& [bytes, message] : cases) expectRefuses(bytes, message);
    std::string deep;
    for (int i = 0; i < 200; ++i) deep += "<array>";
    expectRefuses(deep, "fewer values inside of each other");
}

TEST(PropertyList, ReadsTheOldForm) {
    const Dictionary list{{"a", Array{std::u16string(u"1"), std::u16string(u"x y\n\"\u00E9\u20AC"), Array{}}},
                          {"b c", Dictionary{}},
                          {"data", ArchivedData{"\x0F\xBD"s}}};
    expectReads("// settings\n{ a = (1, \"x y\\n\\\"\\351\\U20ac\", ()); 'b c' = {}; /* raw */ data = <0f BD>; }",
                list);
    expectReads("\xFF\xFE{\0a\0=\0b\0;\0}\0"s, Dictionary{{"a", std::u16string(u"b")}});
    expectReads("\"key\" = \"value\";\nsame;",
                Dictionary{{"key", std::u16string(u"value")}, {"same", std::u16string(u"same")}});
    expectReads("<0fbd>", ArchivedData{"\x0F\xBD"s});
    expectReads("(a, b,)", Array{std::u16string(u"a"), std::u16string(u"b")});
    const std::pair<std::string, std::string> cases[] = {
        {"", "line 1: expected a property list"},
        {"{a = 1;\nb 2; }", "line 2: expected \"=\" or \";\""},
        {"(1 2)", "\",\" or \")\""},
        {"<0>", "an even number"},
        {"<xy>", "hexadecimal digits"},
        {"\"open", "the quote"},
        {"{a = ;}", "a value"},
        {"a b", "nothing behind the list"},
        {"/* open", "the end of a comment"},
        {std::string(200, '('), "fewer values inside of each other"},
    };
    for (const auto& [bytes, message] : cases) expectRefuses(bytes, message);
}

// ---- Binary ----

// A binary list of these objects, each at most 255 bytes in all before the table.
std::string binary(const std::vector<std::string>& objects, char root = 0) {
    std::string bytes = "bplist00";
    std::string offsets;
    for (const std::string& object : objects) {
        offsets.push_back(static_cast<char>(bytes.size()));
        bytes += object;
    }
    const auto table = static_cast<char>(bytes.size());
    const auto count = static_cast<char>(objects.size());
    return bytes + offsets + "\0\0\0\0\0\0\1\1"s + "\0\0\0\0\0\0\0"s + count + "\0\0\0\0\0\0\0"s + root +
           "\0\0\0\0\0\0\0"s + table;
}

TEST(PropertyList, ReadsBinaryFormsThatItDoesNotWrite) {
    expectReads(binary({"\x22\x3F\x00\x00\x00"s}), 0.5);
    expectReads(binary({"\x14" + std::string(16, '\xFF')}), std::int64_t{-1});
    expectReads(binary({"\x14\0\0\0\0\0\0\0\0\xFF\xFF\xFF\xFF\xFF\xFF\xFF\xFF"s}), 18446744073709551615.0);
    expectReads(binary({"\xC1\1"s, "\x51\xE9"s}), Array{std::u16string(u"\u00E9")});
    expectReads(binary({"\x81\1\2"s}), PropertyList::Uid{258});
}

TEST(PropertyList, RefusesDamagedBinary) {
    const std::pair<std::string, std::string> cases[] = {
        {"bplist00", "byte 0"},
        {binary({}), "a trailer whose table"},
        {binary({"\x09"s}, 1), "a trailer whose table"},
        {binary({"\x09"s}).replace(16, 1, "\xFF"s), "a trailer whose table"},
        {binary({"\x5F\x10\x20"s}), "as many bytes as the count says"},
        {binary({"\x5F\x13\x7F\xFF\xFF\xFF\xFF\xFF\xFF\xFF"s}), "as many bytes as the count says"},
        {binary({"\x5F\x09"s}), "a count"},
        {binary({"\x70"s}), "a known kind of object"},
        {binary({"\x15"s}), "a smaller number"},
        {binary({"\x21\0\0"s}), "a real number of 4 or 8 bytes"},
        {binary({"\x33\x7F\xF8\0\0\0\0\0\0"s}), "a date"},
        {binary({"\xA1\5"s}), "references to objects that there are"},
        {binary({"\xA1\0"s}), "a value that does not hold itself"},
        {binary({"\xA1\1"s, "\xD1\2\0"s, "\x51k"s}), "a value that does not hold itself"},
        {binary({"\xD1\1\1"s, "\x09"s}), "a string as the key"},
        {binary({"\x00"s}), "expected a value"},
    };
    for (const auto& [bytes, message] : cases) expectRefuses(bytes, message);
}

TEST(PropertyList, ASmallFileNeverBecomesALargeOneInMemory) {
    std::vector<std::string> levels;
    for (char next = 1; next < 60; ++next) levels.push_back("\xA2"s + next + next);
    levels.emplace_back("\x09");
    expectRefuses(binary(levels), "refer less often");
    PropertyList deep = Array{};
    for (int i = 0; i < 200; ++i) deep = Array{std::move(deep)};
    expectRefuses(binaryPropertyList(deep), "fewer values inside of each other");
}

TEST(PropertyList, WritesEqualValuesOnce) {
    const PropertyList text = std::u16string(1000, u'\u20AC');
    const Array twice{text, text, Dictionary{{"k", text}}, Dictionary{{"k", text}}};
    EXPECT_LT(binaryPropertyList(twice).size(), 2100u);
    expectReads(binaryPropertyList(twice), twice);
}

PropertyList randomList(int depth) {
    switch (*rc::gen::inRange(0, depth > 0 ? 9 : 7)) {
        case 0:
            return *rc::gen::arbitrary<bool>();
        case 1:
            return *rc::gen::arbitrary<std::int64_t>();
        case 2:
            return *rc::gen::arbitrary<double>();
        case 3:
            return *rc::gen::container<std::u16string>(rc::gen::arbitrary<char16_t>());
        case 4:
            return Date(
                std::chrono::microseconds(*rc::gen::inRange<std::int64_t>(-1'000'000'000'000, 4'000'000'000'000'000)));
        case 5:
            return ArchivedData{*rc::gen::arbitrary<std::string>()};
        case 6:
            return PropertyList::Uid{*rc::gen::arbitrary<std::uint64_t>()};
        case 7: {
            Array array(static_cast<std::size_t>(*rc::gen::inRange(0, 20)));
            for (PropertyList& element : array) element = randomList(depth - 1);
            return array;
        }
        default: {
            Dictionary dictionary;
            const int count = *rc::gen::inRange(0, 20);
            for (int i = 0; i < count; ++i) {
                dictionary["\u00E9 " + std::to_string(*rc::gen::inRange(0, 100))] = randomList(depth - 1);
            }
            return dictionary;
        }
    }
}

RC_GTEST_PROP(PropertyListProperty, BinaryComesBackTheSame, ()) {
    const PropertyList list = randomList(3);
    const auto back = readPropertyList(binaryPropertyList(list));
    RC_ASSERT(back.ok());
    RC_ASSERT(back.value() == list);
}

RC_GTEST_PROP(PropertyListProperty, XmlComesBackTheSameWhereXmlCanSayIt, ()) {
    const PropertyList list = randomList(3);
    const auto once = readPropertyList(xmlPropertyList(list));
    RC_ASSERT(once.ok());
    const auto twice = readPropertyList(xmlPropertyList(once.value()));
    RC_ASSERT(twice.ok());
    RC_ASSERT(xmlPropertyList(twice.value()) == xmlPropertyList(list));
}

}  // namespace
}  // namespace plume
