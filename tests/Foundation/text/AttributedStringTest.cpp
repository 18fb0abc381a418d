#include "Foundation/text/AttributedString.h"

#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

#include <algorithm>
#include <array>
#include <thread>
#include <utility>
#include <vector>

namespace plume {
namespace {

SharedAttributes underlined(std::int64_t style) {
    TextAttributes attributes;
    attributes.underlineStyle = style;
    return std::make_shared<const TextAttributes>(attributes);
}

const SharedAttributes Bold = underlined(1);
const SharedAttributes Thin = underlined(2);

// ---- Attributes ----

using Change = void (*)(TextAttributes&);

TEST(TextAttributesTest, EveryAttributeCountsInAComparison) {
    const Change changes[] = {
        [](TextAttributes& a) {
            a.font = FontAttribute{u"Mono", 12, false, true};
        },
        [](TextAttributes& a) {
            a.foregroundColor = ColorAttribute{1, 0, 0, 1};
        },
        [](TextAttributes& a) { a.backgroundColor = ColorAttribute{}; },
        [](TextAttributes& a) { a.underlineStyle = 1; },
        [](TextAttributes& a) { a.strikethroughStyle = 1; },
        [](TextAttributes& a) { a.superscript = -1; },
        [](TextAttributes& a) { a.baselineOffset = 0; },
        [](TextAttributes& a) { a.link = u"x:"; },
        [](TextAttributes& a) { a.toolTip = u""; },
        [](TextAttributes& a) { a.paragraphStyle = ParagraphStyle{}; },
        [](TextAttributes& a) { a.attachment = std::make_shared<const TextAttachment>(); },
    };
    for (const Change change : changes) {
        TextAttributes changed;
        change(changed);
        TextAttributes likewise;
        change(likewise);
        EXPECT_FALSE(changed == TextAttributes{}) << &change - &changes[0];
        EXPECT_TRUE(changed == likewise) << &change - &changes[0];
    }
}

TEST(TextAttributesTest, AttachmentsCompareByWhatTheyHold) {
    TextAttributes a;
    TextAttributes b;
    a.attachment = std::make_shared<const TextAttachment>(TextAttachment{u"a.png", "bytes", u""});
    b.attachment = std::make_shared<const TextAttachment>(TextAttachment{u"a.png", "bytes", u""});
    EXPECT_TRUE(a == b);
    b.attachment = std::make_shared<const TextAttachment>(TextAttachment{u"a.png", "other", u""});
    EXPECT_FALSE(a == b);
    b.attachment = nullptr;
    EXPECT_FALSE(a == b);
    EXPECT_FALSE(b == a);
}

TEST(TextAttributesTest, NullIsTheSameAsAttributesThatSayNothing) {
    EXPECT_TRUE(sameAttributes(nullptr, std::make_shared<const TextAttributes>()));
    EXPECT_TRUE(sameAttributes(underlined(1), underlined(1)));
    EXPECT_FALSE(sameAttributes(nullptr, Bold));
    EXPECT_FALSE(sameAttributes(Thin, Bold));
}

// ---- Edits ----

TEST(AttributedStringTest, JoinsNeighboursThatLookTheSame) {
    AttributedString text(u"ab", underlined(1));
    text.append(u"cd", underlined(1));
    EXPECT_EQ(text.runs().size(), 1U);
    text.insert(2, AttributedString(u"--", Thin));
    EXPECT_EQ(text.runs().size(), 3U);
    text.erase({2, 2});
    EXPECT_EQ(text.runs().size(), 1U);
    EXPECT_EQ(text, AttributedString(u"abcd", underlined(1)));
}

TEST(AttributedStringTest, AttributesThatSayNothingAreKeptAsNull) {
    const AttributedString text(u"ab", std::make_shared<const TextAttributes>());
    EXPECT_EQ(text.runs().front().attributes, nullptr);
    EXPECT_EQ(text, AttributedString(u"ab"));
}

struct ReplacementCase {
    Range range;
    SharedAttributes taken;
};

TEST(AttributedStringTest, ReplacingWithPlainTextTakesTheAttributesOfThePlace) {
    AttributedString text(u"ab", Bold);
    text.append(u"cd", Thin);
    const ReplacementCase cases[] = {
        {{0, 0}, nullptr}, {{1, 0}, Bold}, {{2, 0}, Bold}, {{3, 0}, Thin},  {{4, 0}, Thin},
        {{0, 1}, Bold},    {{1, 2}, Bold}, {{2, 1}, Thin}, {{0, 99}, Bold}, {{99, 99}, Thin},
    };
    for (const ReplacementCase& c : cases) {
        AttributedString changed = text;
        changed.replace(c.range, u"XYZ");
        const std::size_t place = changed.string().find(u"XYZ");
        ASSERT_NE(place, NotFound);
        for (std::size_t i = place; i < place + 3; ++i) {
            EXPECT_TRUE(sameAttributes(changed.attributesAt(i), c.taken)) << c.range.location << ' ' << c.range.length;
        }
    }
}

TEST(AttributedStringTest, UpperCasingKeepsAttributesWithTheirText) {
    AttributedString text(u"stra\u00DF", Bold);
    text.append(u"e\U00010428", Thin);
    AttributedString expected(u"STRASS", Bold);
    expected.append(u"E\U00010400", Thin);
    EXPECT_EQ(text.upperCaseAttributedString(), expected);
}

TEST(AttributedStringTest, AStringThatWasMovedFromIsEmpty) {
    AttributedString text(u"ab", Bold);
    const AttributedString taken = std::move(text);
    EXPECT_TRUE(text.isEmpty());  // NOLINT(bugprone-use-after-move): what is promised
    EXPECT_EQ(text.attributesAt(0), nullptr);
    text.append(u"c", Thin);
    EXPECT_EQ(text, AttributedString(u"c", Thin));
    EXPECT_EQ(taken, AttributedString(u"ab", Bold));
}

TEST(AttributedStringTest, TakesPartsOfItself) {
    AttributedString text(u"ab", Bold);
    text.append(u"c", Thin);
    AttributedString expected = text;
    expected.append(text.substring({0, 99}));
    text.append(text);
    EXPECT_EQ(text, expected);
    text.insert(1, text);
    EXPECT_EQ(text.string(), u"aabcabcbcabc");
    { const AttributedString copy = text; }
    text.append(std::u16string_view(text.string()).substr(0, 3), Thin);
    text.replace({0, 1}, std::u16string_view(text.string()).substr(1, 3));
    EXPECT_EQ(text.string(), u"abcabcabcbcabcaab");
}

TEST(AttributedStringTest, CopiesMayBeChangedOnDifferentThreads) {
    AttributedString text(u"ab", Bold);
    std::array<AttributedString, 4> copies;
    copies.fill(text);
    std::vector<std::thread> threads;
    for (AttributedString& copy : copies) {
        threads.emplace_back([&copy] {
            for (int i = 0; i < 100; ++i) {
                const AttributedString before = copy;
                copy.replace({copy.length() / 2, 0}, u"x");
            }
        });
    }
    for (int i = 0; i < 100; ++i) text.append(u"y", Thin);
    for (std::thread& thread : threads) thread.join();
    for (const AttributedString& copy : copies) EXPECT_EQ(copy.length(), 102U);
    EXPECT_EQ(text.string(), u"ab" + std::u16string(100, u'y'));
}

// ---- Against a model: every unit with the number of its attributes ----

const std::array<SharedAttributes, 4> Palette = {nullptr, underlined(1), underlined(2), underlined(3)};

using Model = std::vector<std::pair<char16_t, std::size_t>>;

Model arbitraryModel() {
    const auto unit = rc::gen::map(rc::gen::inRange<int>(u'a', u'e'), [](int c) { return static_cast<char16_t>(c); });
    return *rc::gen::scale(
        0.3, rc::gen::container<Model>(rc::gen::pair(unit, rc::gen::inRange<std::size_t>(0, Palette.size()))));
}

AttributedString stringOf(const Model& model) {
    AttributedString text;
    for (const auto& [unit, id] : model) {
        // A fresh object each time: joining must go by content.
        const auto attributes = Palette[id] ? std::make_shared<const TextAttributes>(*Palette[id]) : nullptr;
        text.append(std::u16string_view(&unit, 1), attributes);
    }
    return text;
}

void checkAgainst(const Model& model, const AttributedString& text) {
    RC_ASSERT(text.length() == model.size());
    for (std::size_t i = 0; i < model.size(); ++i) {
        RC_ASSERT(text.string()[i] == model[i].first);
        RC_ASSERT(sameAttributes(text.attributesAt(i), Palette[model[i].second]));
    }
    std::size_t total = 0;
    const auto& runs = text.runs();
    for (std::size_t i = 0; i < runs.size(); ++i) {
        RC_ASSERT(runs[i].length > 0U);
        total += runs[i].length;
        RC_ASSERT((i == 0 || !sameAttributes(runs[i - 1].attributes, runs[i].attributes)));
    }
    RC_ASSERT(total == model.size());
    RC_ASSERT(text == stringOf(model));
}

// One random edit, done to both.
void edit(Model& model, AttributedString& text) {
    const auto position = [](std::size_t i) { return static_cast<std::ptrdiff_t>(i); };
    const std::size_t start = *rc::gen::inRange<std::size_t>(0, model.size() + 3);
    const std::size_t count = *rc::gen::inRange<std::size_t>(0, 6);
    const auto first = model.begin() + position(std::min(start, model.size()));
    const auto last = model.begin() + position(std::min(start + count, model.size()));
    const Model other = arbitraryModel();
    const std::size_t id = *rc::gen::inRange<std::size_t>(0, Palette.size());
    switch (*rc::gen::inRange(0, 7)) {
        case 0:
            text.append(stringOf(other));
            model.insert(model.end(), other.begin(), other.end());
            break;
        case 1:
            text.insert(start, stringOf(other));
            model.insert(first, other.begin(), other.end());
            break;
        case 2:
            text.replace({start, count}, stringOf(other));
            model.insert(model.erase(first, last), other.begin(), other.end());
            break;
        case 3:
            text.erase({start, count});
            model.erase(first, last);
            break;
        case 4:
            text.setAttributes({start, count}, Palette[id]);
            std::for_each(first, last, [id](auto& unit) { unit.second = id; });
            break;
        case 5:
            text = text.substring({start, count});
            model = Model(first, last);
            break;
        default:
            text.append(u"zz", Palette[id]);
            model.insert(model.end(), 2, {u'z', id});
    }
}

RC_GTEST_PROP(AttributedStringProperty, EditsAreThoseOfUnitsWithAttributes, ()) {
    Model model = arbitraryModel();
    AttributedString text = stringOf(model);
    const int edits = *rc::gen::inRange(1, 8);
    for (int i = 0; i < edits; ++i) {
        edit(model, text);
        checkAgainst(model, text);
    }
}

RC_GTEST_PROP(AttributedStringProperty, CopiesAreIndependent, ()) {
    const Model model = arbitraryModel();
    AttributedString original = stringOf(model);
    AttributedString copy = original;
    Model copyModel = model;
    edit(copyModel, copy);
    checkAgainst(model, original);
    Model originalModel = model;
    edit(originalModel, original);
    checkAgainst(originalModel, original);
    checkAgainst(copyModel, copy);
}

RC_GTEST_PROP(AttributedStringProperty, EqualityIsThatOfEveryUnit, ()) {
    const Model a = arbitraryModel();
    Model b = *rc::gen::oneOf(rc::gen::just(a), rc::gen::exec(arbitraryModel));
    if (!b.empty() && *rc::gen::arbitrary<bool>()) b.back().second = *rc::gen::inRange<std::size_t>(0, Palette.size());
    RC_ASSERT((stringOf(a) == stringOf(b)) == (a == b));
}

TEST(AttributedStringTest, AppendingCopiesOnlyWhatIsAppended) {
    constexpr std::size_t Runs = 100'000;
    AttributedString text;
    std::size_t moves = 0;
    for (std::size_t i = 0; i < Runs; ++i) {
        const auto* units = text.string().data();
        const auto* runs = text.runs().data();
        text.append(AttributedString(u"ab", Palette[1 + i % 2]));
        if (text.string().data() != units || text.runs().data() != runs) ++moves;
    }
    EXPECT_EQ(text.runs().size(), Runs);
    EXPECT_LT(moves, 64U);  // a buffer that grows by a factor; one that is copied moves every time
    AttributedString reassembled;
    for (std::size_t i = 0; i < Runs; ++i) reassembled.append(text.substring({2 * i, 2}));
    EXPECT_EQ(reassembled, text);
}

}  // namespace
}  // namespace plume
