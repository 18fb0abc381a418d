#include "Foundation/archive/KeyedArchive.h"

#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

#include <functional>
#include <limits>
#include <memory>
#include <string>
#include <utility>
#include <vector>

#include "Foundation/Strings.h"
#include "Foundation/archive/PropertyListReader.h"
#include "Foundation/archive/PropertyListWriter.h"
#include "tests/Foundation/archive/ArchiveTestSupport.h"

namespace plume {
namespace {

using namespace std::chrono_literals;
using Array = PropertyList::Array;
using Dictionary = PropertyList::Dictionary;
using Strings = std::vector<std::u16string>;

constexpr Date ReferenceDate = std::chrono::sys_days(2001y / 1 / 1);

std::string fixture(const std::string& name) {
    return test::bytesOfFile("tests/Foundation/archive/data/" + name);
}

void expectReads(std::string_view bytes, const std::function<void(const KeyedDecoder&)>& check) {
    int calls = 0;
    const auto read = readKeyedArchive(bytes, [&](const KeyedDecoder& root) {
        ++calls;
        check(root);
    });
    EXPECT_TRUE(read.ok()) << read.error().message;
    EXPECT_EQ(calls, 1);
}

template <typename Value>
Value valueOf(const std::optional<Value>& value) {
    return value.value_or(Value());
}

// A record that writes what it is told to.
struct Record final : KeyedCodable {
    explicit Record(std::function<void(KeyedEncoder&)> aWrite = [](KeyedEncoder&) {}) : write(std::move(aWrite)) {}
    std::string_view archiveClassName() const override { return "Snippet"; }
    void encodeWithCoder(KeyedEncoder& coder) const override { write(coder); }
    std::function<void(KeyedEncoder&)> write;
};

AttributedString text(std::u16string content, const TextAttributes& attributes) {
    return AttributedString(std::move(content), std::make_shared<TextAttributes>(attributes));
}

// ---- Archives from elsewhere ----

void checkValues(const KeyedDecoder& root) {
    EXPECT_EQ(valueOf(root.decodeDate("date")), ReferenceDate + 1000250ms);
    EXPECT_EQ(root.decodeInteger("integer"), -5);
    EXPECT_EQ(root.decodeInteger("large"), std::int64_t{1} << 40);
    EXPECT_EQ(root.decodeInteger("number"), 7);
    EXPECT_EQ(root.decodeInteger("real"), 1);
    EXPECT_TRUE(root.decodeBool("yes"));
    for (const auto& [key, expected] :
         {std::pair(u"text", "string"), {u"mut", "mutableString"}, {u"\u00E9", "bytes"}}) {
        EXPECT_EQ(valueOf(root.decodeString(expected)), key);
    }
    EXPECT_EQ(valueOf(root.decodeString("uuid")), u"00010203-0405-0607-0809-0A0B0C0D0E0F");
    EXPECT_EQ(std::get<ArchivedData>(root.decodeContent("data")).bytes, "ab");
    EXPECT_EQ(std::get<ArchivedData>(root.decodeContent("mutableData")).bytes, "cd");
    EXPECT_EQ(std::get<std::u16string>(root.decodeContent("mutableString")), u"mut");
    EXPECT_EQ(valueOf(root.decodeStrings("strings")), (Strings{u"a", u"b"}));
    EXPECT_EQ(valueOf(root.decodeStrings("set")), (Strings{u"s"}));
    EXPECT_EQ(valueOf(root.decodeStrings("numbered")), (Strings{u"n0", u"n1"}));
    EXPECT_EQ(
        root.decodePropertyList("dictionary"),
        PropertyList(Dictionary{{"k", Array{std::int64_t{1}, 2.5, Dictionary{{"in", false}}}}, {"d", ReferenceDate}}));
    EXPECT_EQ(root.decodePropertyList("url"), PropertyList(std::u16string(u"http://x.org/a/b/c")));
}

void checkCharacterSets(const KeyedDecoder& root) {
    const auto set = [&](std::string_view key) { return valueOf(root.decodeCharacterSet(key)); };
    EXPECT_EQ(set("members"), CharacterSet::withCharacters(u"xyz"));
    EXPECT_EQ(set("mutableMembers"), CharacterSet::withCharacters(u"xyz"));
    EXPECT_EQ(set("builtin"), CharacterSet::decimalDigits());
    EXPECT_EQ(set("range"), CharacterSet::withRange(u'a', u'z'));
    EXPECT_EQ(set("bitmap"), CharacterSet::withCharacters(u"x5\U0001F600"));
    EXPECT_EQ(set("inverted").characters(), u"\U0010FFFE\U0010FFFF");
    EXPECT_EQ(set("stringObject"), CharacterSet::withCharacters(u"qr"));
    EXPECT_TRUE(set("symbols").contains(u'+'));
    EXPECT_FALSE(set("symbols").contains(u'a'));
}

void checkTexts(const KeyedDecoder& root) {
    const auto rich = std::get<AttributedString>(root.decodeContent("rich"));
    ASSERT_EQ(rich.length(), 312u);
    TextAttributes first;
    first.font = FontAttribute{u"Helvetica", 12};
    first.underlineStyle = 1;
    first.paragraphStyle = ParagraphStyle{TextAlignment::Center, 0, 36, 0, 0, 0, 0, 0, {28, 56}, {{u"{disc}", 1}}};
    EXPECT_EQ(*rich.attributesAt(0), first);
    TextAttributes second;
    second.font = FontAttribute{u"Helvetica", 14, true};
    second.foregroundColor = ColorAttribute{1, 0, 0.5, 0.25};
    second.backgroundColor = ColorAttribute{0.25, 0.25, 0.25};
    second.link = u"http://x.org/a/b/c";
    EXPECT_EQ(*rich.attributesAt(8), second);
    EXPECT_EQ(rich.attributesAt(9)->superscript, -1);
    EXPECT_EQ(rich.attributesAt(9)->strikethroughStyle, 1);
    EXPECT_EQ(rich.attributesAt(9)->toolTip, u"tip");
    EXPECT_EQ(rich.attributesAt(9)->baselineOffset, 1.5);
    EXPECT_EQ(*rich.attributesAt(11)->attachment, (TextAttachment{u"a.png", "PNG!", {}}));
    EXPECT_EQ(rich.attributesAt(311)->link, u"mailto:a");
    EXPECT_EQ(rich.attributesAt(311)->foregroundColor, (ColorAttribute{0.5, 0, 0}));
    EXPECT_EQ(std::get<AttributedString>(root.decodeContent("plain")), AttributedString(u"plain"));
    EXPECT_EQ(std::get<AttributedString>(root.decodeContent("empty")), AttributedString());
}

TEST(KeyedArchive, ReadsWhatThePlatformWrites) {
    const std::string binary = fixture("kinds.archive");
    for (const std::string& bytes : {binary, xmlPropertyList(readPropertyList(binary).value())}) {
        expectReads(bytes, [](const KeyedDecoder& root) {
            checkValues(root);
            checkCharacterSets(root);
            checkTexts(root);
        });
    }
}

TEST(KeyedArchive, GivesRecordsInOrderAndRemembersWhatWasMadeOfThem) {
    expectReads(fixture("kinds.archive"), [](const KeyedDecoder& root) {
        Strings abbreviations;
        EXPECT_TRUE(root.decodeObjects("records", [&](KeyedDecoder& record) {
            std::any& made = record.decodedObject();
            const int number = made.has_value() ? std::any_cast<int>(made) : static_cast<int>(abbreviations.size());
            made = number;
            abbreviations.push_back(*record.decodeString("Abbreviation") + char16_t(u'0' + number));
        }));
        EXPECT_EQ(abbreviations, (Strings{u"a0", u"b1", u"a0"}));
        EXPECT_FALSE(root.decodeObjects("string", [](KeyedDecoder&) { ADD_FAILURE(); }));
    });
}

TEST(KeyedArchive, WhatIsMissingOrOfAnotherKindReadsAsNothing) {
    expectReads(fixture("kinds.archive"), [](const KeyedDecoder& root) {
        for (const std::string_view key : {"missing", "rich", "records", "members"}) {
            EXPECT_EQ(root.decodeInteger(key), 0);
            EXPECT_FALSE(root.decodeBool(key));
            EXPECT_EQ(root.decodeString(key), std::nullopt);
            EXPECT_EQ(root.decodeDate(key), std::nullopt);
        }
        EXPECT_EQ(root.decodeCharacterSet("rich"), std::nullopt);
        EXPECT_EQ(root.decodeStrings("string"), std::nullopt);
        EXPECT_TRUE(std::holds_alternative<std::monostate>(root.decodeContent("date")));
        EXPECT_EQ(root.decodePropertyList("rich"), std::nullopt);
        EXPECT_TRUE(root.containsValueForKey("null"));
        EXPECT_FALSE(root.containsValueForKey("missing"));
    });
}

TEST(KeyedArchive, ReadsTextsAndPicturesThatAreTheRoot) {
    const auto text = contentFromKeyedArchive(fixture("text.archive"));
    const auto& rich = std::get<ArchivedRichText>(text.value());
    EXPECT_EQ(rich.text, u"ab");
    ASSERT_EQ(rich.runs.size(), 2u);
    EXPECT_EQ(rich.runs[0].attributes->font->family, u"Helvetica");
    EXPECT_EQ(rich.runs[1].others, (std::map<std::u16string, PropertyList>{{u"Custom", std::int64_t{3}}}));
    EXPECT_EQ(std::get<ArchivedImage>(contentFromKeyedArchive(fixture("image.archive")).value()).bytes,
              std::string("II*\0tiff", 8));
    EXPECT_TRUE(std::holds_alternative<std::monostate>(contentFromKeyedArchive(fixture("kinds.archive")).value()));
    EXPECT_FALSE(readKeyedArchive(fixture("text.archive"), [](const KeyedDecoder&) { ADD_FAILURE(); }));
}

// ---- What is written ----

void writeEverything(KeyedEncoder& root, const Record& record) {
    root.encodeString("string", u"\U0001F600 text");
    root.encodeInteger("integer", -3);
    root.encodeBool("bool", true);
    root.encodeDate("date", ReferenceDate + 1us);
    root.encodeString("nil", std::nullopt);
    root.encodeCharacterSet("few", CharacterSet::withCharacters(u"a\r\U0001F600"));
    root.encodeCharacterSet("many", CharacterSet::letters());
    root.encodeCharacterSet("surrogates", CharacterSet::withCharacters(u"\xDC00x\xD800"));
    root.encodeStrings("strings", Strings{u"b", u"b", u""});
    root.encodeContent("data", ArchivedData{std::string("\0\1", 2)});
    root.encodeContent("nothing", std::monostate());
    root.encodeObjects("records", {&record, &record});
    root.encodePropertyList("list",
                            Dictionary{{"a", Array{true, 0.5, std::u16string(u"b"), ReferenceDate, Dictionary()}}});
}

void checkEverything(const KeyedDecoder& root) {
    EXPECT_EQ(valueOf(root.decodeString("string")), u"\U0001F600 text");
    EXPECT_EQ(root.decodeInteger("integer"), -3);
    EXPECT_TRUE(root.decodeBool("bool"));
    EXPECT_EQ(valueOf(root.decodeDate("date")), ReferenceDate + 1us);
    EXPECT_FALSE(root.containsValueForKey("nil"));
    EXPECT_FALSE(root.containsValueForKey("nothing"));
    EXPECT_EQ(root.decodeCharacterSet("few"), CharacterSet::withCharacters(u"a\r\U0001F600"));
    EXPECT_EQ(root.decodeCharacterSet("many"), CharacterSet::letters());
    EXPECT_EQ(root.decodeCharacterSet("surrogates"), CharacterSet::withCharacters(u"\xDC00x\xD800"));
    EXPECT_EQ(valueOf(root.decodeStrings("strings")), (Strings{u"b", u"b", u""}));
    EXPECT_EQ(std::get<ArchivedData>(root.decodeContent("data")).bytes, std::string("\0\1", 2));
    EXPECT_EQ(root.decodePropertyList("list"),
              PropertyList(Dictionary{{"a", Array{true, 0.5, std::u16string(u"b"), ReferenceDate, Dictionary()}}}));
}

// Every attribute with something in it, in several runs.
AttributedString fullText() {
    TextAttributes all;
    all.font = FontAttribute{u"Times New Roman", 12.5, true, true};
    all.foregroundColor = ColorAttribute{0.1, 1.0 / 3, 0, 1};
    all.backgroundColor = ColorAttribute{1, 1, 1, 0.5};
    all.underlineStyle = 9;
    all.strikethroughStyle = 1;
    all.superscript = -1;
    all.baselineOffset = -0.25;
    all.link = u"https://example.org/a?b=%20#c";
    all.toolTip = u"tip";
    all.paragraphStyle =
        ParagraphStyle{TextAlignment::Right, 1, 2, -3, 4, 1.5, 6, 7, {28.5, 56}, {{u"{decimal}.", 3}, {u"{disc}", 1}}};
    all.attachment = std::make_shared<TextAttachment>(TextAttachment{u"\u00E9.png", std::string(5000, 'x'), {}});
    AttributedString content = text(u"\uFFFC", all);
    content.append(u" plain ");
    for (const char16_t* family : {u"Helvetica", u"My Font", u"Odd-Bold", u"Odd"}) {
        TextAttributes attributes;
        attributes.font = FontAttribute{family, 10, family[0] == u'H', false};
        attributes.link = family;  // no address
        content.append(text(family, attributes));
    }
    content.append(text(u"again", all));
    return content;
}

TEST(KeyedArchive, WritesThePlatformsLayoutAndReadsItBack) {
    TextAttributes left;
    left.paragraphStyle.emplace().alignment = TextAlignment::Left;
    const Record record([&](KeyedEncoder& coder) {
        coder.encodeString("Abbreviation", u"same");
        coder.encodeString("Label", u"same");
        coder.encodeInteger("ContentType", 1);
        coder.encodeContent("Content", text(u"left", left));
    });
    const Record other([](KeyedEncoder& coder) { coder.encodeContent("Content", fullText()); });
    const std::string bytes = keyedArchive([&](KeyedEncoder& root) {
        writeEverything(root, record);
        root.encodeContent("rich", fullText());
        root.encodeContent("none", AttributedString());
        root.encodeContent("plain", AttributedString(u"plain"));
        root.encodeObjects("others", {&other});
    });
    expectReads(bytes, [&](const KeyedDecoder& root) {
        checkEverything(root);
        EXPECT_EQ(std::get<AttributedString>(root.decodeContent("rich")), fullText());
        EXPECT_EQ(std::get<AttributedString>(root.decodeContent("plain")), AttributedString(u"plain"));
        EXPECT_EQ(std::get<AttributedString>(root.decodeContent("none")), AttributedString());
        int count = 0;
        root.decodeObjects("records", [&](KeyedDecoder& decoder) {
            ++count;
            EXPECT_EQ(valueOf(decoder.decodeString("Label")), u"same");
            EXPECT_EQ(std::get<AttributedString>(decoder.decodeContent("Content")), text(u"left", left));
        });
        EXPECT_EQ(count, 2);
    });
    const test::ScriptFolder folder("archives.py");
    folder.write("ours.archive", bytes);
    EXPECT_TRUE(folder.run("check"));
}

TEST(KeyedArchive, WritesWhatTextsShareOnce) {
    const auto sizeOf = [](int count) {
        const Record record([](KeyedEncoder& coder) { coder.encodeContent("Content", fullText()); });
        return keyedArchive([&](KeyedEncoder& root) {
                   for (int i = 0; i < count; ++i) {
                       root.encodeContent("text" + std::to_string(i),
                                          text(u"x" + fromUtf8(std::to_string(i)), *fullText().attributesAt(0)));
                   }
               })
            .size();
    };
    EXPECT_LT(sizeOf(10) - sizeOf(1), 800u);
}

// ---- Hostile bytes ----

// An archive with these objects behind "$null"; references are {Uid}.
std::string archiveOf(std::vector<PropertyList> objects, std::uint64_t root = 1) {
    objects.insert(objects.begin(), PropertyList(std::u16string(u"$null")));
    return binaryPropertyList(Dictionary{{"$archiver", std::u16string(u"NSKeyedArchiver")},
                                         {"$version", std::int64_t{100000}},
                                         {"$top", Dictionary{{"root", PropertyList::Uid{root}}}},
                                         {"$objects", Array(objects.begin(), objects.end())}});
}

PropertyList uid(std::uint64_t number) {
    return PropertyList::Uid{number};
}
PropertyList className(const char16_t* name) {
    return Dictionary{{"$classname", std::u16string(name)}, {"$classes", Array{std::u16string(name)}}};
}
// With "k" for its only key, the string at 3; its class at 2.
PropertyList rootWith(std::uint64_t value) {
    return Dictionary{{"$class", uid(2)}, {"NS.keys", Array{uid(3)}}, {"NS.objects", Array{uid(value)}}};
}
const PropertyList DictionaryClass = className(u"NSDictionary");
const PropertyList Key = std::u16string(u"k");

void decodeAll(const KeyedDecoder& root, int depth = 0) {
    root.decodeString("k");
    root.decodeStrings("k");
    root.decodeDate("k");
    root.decodeCharacterSet("k");
    root.decodeContent("k");
    root.decodePropertyList("k");
    if (depth < 200) root.decodeObjects("k", [&](KeyedDecoder& inner) { decodeAll(inner, depth + 1); });
}

TEST(KeyedArchive, RefusesDamagedArchives) {
    const std::pair<std::string, std::string> cases[] = {
        {"", "property list"},
        {binaryPropertyList(Dictionary()), "expected a dictionary with $objects and $top"},
        {binaryPropertyList(Array()), "expected a dictionary with $objects and $top"},
        {archiveOf({}, 0), "an object that $top refers to"},
        {archiveOf({}, 7), "a reference to one of 1 objects, not to 7"},
        {archiveOf({Key}), "a dictionary as its root"},
        {archiveOf({rootWith(99), DictionaryClass, Key}), "a reference to one of 4 objects, not to 99"},
    };
    for (const auto& [bytes, message] : cases) {
        const auto read = readKeyedArchive(bytes, [](const KeyedDecoder& root) { decodeAll(root); });
        ASSERT_FALSE(read);
        EXPECT_NE(read.error().message.find(message), std::string::npos) << read.error().message;
    }
}

TEST(KeyedArchive, CirclesReadAsNothing) {
    const PropertyList array = Dictionary{{"$class", uid(5)}, {"NS.objects", Array{uid(4)}}};
    const PropertyList circles[] = {rootWith(4), array, Dictionary{{"$class", uid(6)}, {"NS.base", uid(4)}},
                                    Dictionary{{"$class", uid(4)}}};
    for (const PropertyList& circle : circles) {
        const std::string bytes =
            archiveOf({rootWith(4), DictionaryClass, Key, circle, className(u"NSArray"), className(u"NSURL")});
        expectReads(bytes, [](const KeyedDecoder& root) { decodeAll(root); });
    }
}

TEST(KeyedArchive, ASmallArchiveNeverBecomesALargeOneInMemory) {
    const PropertyList big = std::u16string(100'000, u'x');
    const PropertyList list = Dictionary{{"$class", uid(5)}, {"NS.objects", Array(10'000, uid(6))}};
    const PropertyList record = Dictionary{{"$class", uid(7)}, {"k", uid(8)}};
    const std::string bytes =
        archiveOf({rootWith(4), DictionaryClass, Key, list, className(u"NSArray"), record, className(u"Snippet"), big});
    const auto read = readKeyedArchive(bytes, [](const KeyedDecoder& root) { decodeAll(root); });
    ASSERT_FALSE(read);
    EXPECT_NE(read.error().message.find("refer less often"), std::string::npos) << read.error().message;
}

// ---- Properties ----

std::u16string randomText(int most = 12) {
    static constexpr char16_t Units[] = {u'a',   u'B',   u'\n',  u' ', u'\u00E9', u'\u65E5',
                                         0xD83D, 0xDE00, 0xD800, 0,    u'\uFFFC'};
    std::u16string result(static_cast<std::size_t>(*rc::gen::inRange(0, most)), u'\0');
    for (char16_t& unit : result) unit = Units[*rc::gen::inRange(0, 11)];
    return result;
}

double randomReal() {
    return *rc::gen::inRange(-1000, 1000) / 3.0;
}

TextAttributes randomAttributes() {
    const auto chance = [] { return *rc::gen::inRange(0, 3) == 0; };
    const auto color = [] {
        const auto part = [] { return *rc::gen::inRange(0, 256) / 255.0; };
        return ColorAttribute{part(), part(), part(), part()};
    };
    TextAttributes attributes;
    if (chance()) attributes.font = FontAttribute{randomText(), randomReal(), chance(), chance()};
    if (chance()) attributes.foregroundColor = color();
    if (chance()) attributes.backgroundColor = color();
    attributes.underlineStyle = *rc::gen::inRange(0, 3);
    attributes.superscript = *rc::gen::inRange(-1, 2);
    if (chance()) attributes.baselineOffset = randomReal();
    if (chance()) attributes.link = randomText();
    if (chance()) attributes.toolTip = randomText();
    if (chance()) {
        ParagraphStyle& style = attributes.paragraphStyle.emplace();
        style.alignment = static_cast<TextAlignment>(*rc::gen::inRange(0, 5));
        style.firstLineHeadIndent = randomReal();
        style.tailIndent = randomReal();
        style.tabStops = *rc::gen::container<std::vector<double>>(
            rc::gen::map(rc::gen::inRange(0, 99), [](int n) { return n / 2.0; }));
        if (chance()) style.textLists = {{randomText(), *rc::gen::inRange(-3, 3)}};
    }
    if (chance())
        attributes.attachment = std::make_shared<TextAttachment>(TextAttachment{u"f", toUtf8(randomText()), {}});
    return attributes;
}

RC_GTEST_PROP(KeyedArchiveProperty, TextsComeBackTheSame, ()) {
    AttributedString written;
    for (int i = *rc::gen::inRange(0, 6); i > 0; --i) written.append(text(randomText(200), randomAttributes()));
    const std::string bytes = keyedArchive([&](KeyedEncoder& root) { root.encodeContent("k", written); });
    AttributedString back;
    const auto read = readKeyedArchive(
        bytes, [&](const KeyedDecoder& root) { back = std::get<AttributedString>(root.decodeContent("k")); });
    RC_ASSERT(read.ok());
    RC_ASSERT(back == written);
}

RC_GTEST_PROP(KeyedArchiveProperty, NoDamageDoesHarm, ()) {
    static const std::string whole = keyedArchive([](KeyedEncoder& root) { writeEverything(root, Record()); });
    std::string bytes = whole;
    for (int i = *rc::gen::inRange(1, 4); i > 0; --i) {
        bytes[*rc::gen::inRange<std::size_t>(0, bytes.size())] = *rc::gen::arbitrary<char>();
    }
    static_cast<void>(readKeyedArchive(bytes, [](const KeyedDecoder& root) { decodeAll(root); }).ok());
    static_cast<void>(contentFromKeyedArchive(bytes).ok());
}

}  // namespace
}  // namespace plume
