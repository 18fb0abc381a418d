#include "Foundation/text/AttributedString.h"

#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

#include <algorithm>
#include <array>
#include <functional>
#include <thread>
#include <utility>
#include <vector>

#include "tests/Foundation/text/RTFTestSupport.h"

namespace plume {
namespace {

SharedAttributes underlined(std::int64_t style) {
    return attributed(u"a", [&](TextAttributes& a) { a.underlineStyle = style; }).attributesAt(0);
}

const SharedAttributes Bold = underlined(1);
const SharedAttributes Thin = underlined(2);

// ---- Attributes ----

// Texts that differ in one attribute each.
std::vector<AttributedString> differentLooks() {
    const auto file = [](const char* contents) {
        return [contents](TextAttributes& a) { a.attachment = attachment(u"a.png", contents); };
    };
    const std::function<void(TextAttributes&)> changes[] = {
        [](TextAttributes&) {},
        [](TextAttributes& a) { a.font.emplace().italic = true; },
        [](TextAttributes& a) { a.foregroundColor.emplace().red = 1; },
        [](TextAttributes& a) { a.backgroundColor.emplace(); },
        [](TextAttributes& a) { a.underlineStyle = 1; },
        [](TextAttributes& a) { a.strikethroughStyle = 1; },
        [](TextAttributes& a) { a.superscript = -1; },
        [](TextAttributes& a) { a.baselineOffset = 0; },
        [](TextAttributes& a) { a.link = u"x:"; },
        [](TextAttributes& a) { a.toolTip = u""; },
        [](TextAttributes& a) { a.paragraphStyle.emplace(); },
        file(""),
        file("bytes"),
    };
    std::vector<AttributedString> looks;
    for (const auto& change : changes) looks.push_back(attributed(u"a", change));
    return looks;
}

TEST(TextAttributesTest, EveryAttributeCountsByWhatItHolds) {
    const auto looks = differentLooks();
    const auto again = differentLooks();
    for (std::size_t i = 0; i < looks.size(); ++i) {
        for (std::size_t j = 0; j < looks.size(); ++j) EXPECT_EQ(looks[i] == again[j], i == j) << i << " and " << j;
    }
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
        // A fresh object each time, also for attributes that say nothing: joining must go by content.
        const TextAttributes attributes = Palette[id] ? *Palette[id] : TextAttributes{};
        text.append(std::u16string_view(&unit, 1), std::make_shared<const TextAttributes>(attributes));
    }
    return text;
}

void checkAgainst(const Model& model, const AttributedString& text) {
    RC_ASSERT(text.length() == model.size());
    for (std::size_t i = 0; i < model.size(); ++i) {
        RC_ASSERT(text.string()[i] == model[i].first);
        RC_ASSERT(sameAttributes(text.attributesAt(i), Palette[model[i].second]));
        RC_ASSERT((text.attributesAt(i) == nullptr) == (model[i].second == 0));
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
    // What plain text takes: the attributes of the first unit replaced, else of the one before.
    const auto taken = first != last ? first : first - (first == model.begin() ? 0 : 1);
    const std::size_t idTaken = first == last && taken == first ? 0 : taken->second;
    switch (*rc::gen::inRange(0, 11)) {
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
        case 6:
            text.replace({start, count}, u"xy");
            model.insert(model.erase(first, last), {{u'x', idTaken}, {u'y', idTaken}});
            break;
        case 7: {
            const Model own = model;
            text.insert(start, text);
            model.insert(first, own.begin(), own.end());
            break;
        }
        case 8: {
            {
                const AttributedString copy = text;
            }  // leaves a storage that nobody changes any more
            const Model part(first, last);
            text.append(std::u16string_view(text.string()).substr(std::min(start, text.length()), count), Palette[id]);
            for (const auto& [unit, ignored] : part) model.emplace_back(unit, id);
            break;
        }
        case 9: {
            const AttributedString whole = std::move(text);
            // NOLINTBEGIN(bugprone-use-after-move): a string that was moved from is promised to be empty
            RC_ASSERT(text == AttributedString());
            text.append(whole);
            // NOLINTEND(bugprone-use-after-move)
            break;
        }
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
