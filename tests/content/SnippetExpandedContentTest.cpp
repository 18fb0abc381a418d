#include "content/SnippetExpandedContent.h"

#include <gmock/gmock.h>
#include <rapidcheck/gtest.h>

#include <algorithm>

#include "Foundation/Strings.h"
#include "content/PLOutput.h"
#include "tests/content/world/ContentWorld.h"

namespace plume {
namespace {

std::shared_ptr<SnippetVariable> caret(std::size_t location) {
    auto variable = std::make_shared<SnippetContentCaret>();
    variable->location = location;
    return variable;
}

std::shared_ptr<SnippetVariable> key(KeyCode code, std::size_t location, std::uint64_t count = 1) {
    auto variable = std::make_shared<SnippetKeyVariable>(u"k", code);
    variable->location = location;
    variable->count = count;
    return variable;
}

// "a|key36|b": the pieces in order.
std::string describe(const std::vector<PLOutput::Fragment>& fragments) {
    std::string text;
    for (const auto& fragment : fragments) {
        if (!text.empty()) text += "|";
        if (const auto* plain = std::get_if<std::u16string>(&fragment)) {
            text += toUtf8(*plain);
        } else if (const auto* richText = std::get_if<AttributedString>(&fragment)) {
            text += notation(*richText);
        } else {
            text += "key" + std::to_string(numberOf(std::get<2>(fragment)->keyCode));
        }
    }
    return text;
}

TEST(SnippetExpandedContent, CaretArithmeticCopyStringAndFragments) {
    const struct {
        const char* text;
        std::vector<std::shared_ptr<SnippetVariable>> variables;
        std::int64_t caretLocation;
        std::int64_t distance;
        std::int64_t distanceIgnoringKeys;
        const char* copyString;
        const char* fragments;
    } cases[] = {
        {"abc", {}, -1, 0, 0, "abc", "abc"},
        {"", {}, -1, 0, 0, "", ""},
        {"ab", {key(KeyCode::Return, 1), caret(2)}, 3, 0, 0, "a b", "a|key36|b"},
        {"abc", {caret(1), key(KeyCode::Tab, 3, 2)}, 2, 4, 2, "abc ", "abc|key48"},
        {"abc", {caret(1), caret(2)}, 2, 1, 1, "abc", "abc"},
        {"abc", {key(KeyCode::Return, 0)}, 0, 0, 0, " abc", "key36|abc"},
        {"abc",
         {caret(0), key(KeyCode::KeypadEnter, 1, 3), key(KeyCode::Escape, 2)},
         0,
         6,
         3,
         "abc",
         "a|key76|b|key53|c"},
        {"abc", {key(KeyCode::Return, 1), key(KeyCode::Tab, 1)}, 1, 0, 0, "a  bc", "a|key36|key48|bc"},
        {"abcd", {key(KeyCode::Tab, 3), key(KeyCode::Right, 2)}, 0, 0, 0, "abc cd", "abc|key48|key124|cd"},
        {"ab", {key(KeyCode::Right, 3)}, -1, 0, 0, "ab", "ab|key124"},
        {"ab", {caret(5)}, 5, -3, -3, "ab", "ab"},
    };
    for (const auto& example : cases) {
        SCOPED_TRACE(std::string(example.text) + ": " + example.fragments);
        for (const bool isRich : {false, true}) {
            SnippetExpandedContent content(fromUtf8(example.text));
            if (isRich) content.setContent(AttributedString(fromUtf8(example.text)));
            content.variables = example.variables;
            EXPECT_EQ(content.caretLocation(), example.caretLocation);
            EXPECT_EQ(content.caretDistanceFromEnding(), example.distance);
            EXPECT_EQ(content.caretDistanceFromEndingIgnoreKeys(), example.distanceIgnoringKeys);
            EXPECT_EQ(toUtf8(content.copyString()), example.copyString);
            PLOutput output;
            output.snippetExpandedContent = std::make_shared<SnippetExpandedContent>(content);
            output.refreshFragments();
            EXPECT_EQ(describe(output.fragments), example.fragments);
        }
    }
}

TEST(SnippetExpandedContent, SaysWhatItHolds) {
    const auto delayed = std::make_shared<SnippetKeyVariable>(u"k", KeyCode::Escape);
    delayed->delay = 0.1;
    const struct {
        std::vector<std::shared_ptr<SnippetVariable>> variables;
        // hasCaret, hasCaretLocationOrKeys, hasCaretLocationOrArrowKeys, hasCaretOrFields, hasDelayedKey
        std::vector<bool> answers;
    } cases[] = {
        {{}, {false, false, false, false, false}},
        {{caret(0)}, {true, true, true, true, false}},
        {{std::make_shared<SnippetFieldVariable>()}, {false, false, false, true, false}},
        {{key(KeyCode::F1, 0)}, {false, true, false, false, false}},
        {{key(KeyCode::Left, 0)}, {false, true, true, false, false}},
        {{key(KeyCode::Up, 0)}, {false, true, true, false, false}},
        {{key(KeyCode{127}, 0)}, {false, true, false, false, false}},
        {{delayed}, {false, true, false, false, true}},
    };
    for (const auto& [variables, answers] : cases) {
        SnippetExpandedContent content;
        content.variables = variables;
        EXPECT_EQ((std::vector<bool>{content.hasCaret(), content.hasCaretLocationOrKeys(),
                                     content.hasCaretLocationOrArrowKeys(), content.hasCaretOrFields(),
                                     content.hasDelayedKey()}),
                  answers)
            << describe(variables);
    }
}

TEST(SnippetExpandedContent, AppendsItsSuffixUnstyled) {
    for (const char* suffix : {"", "."}) {
        SnippetExpandedContent plain(u"ab");
        SnippetExpandedContent styled(rich("*ab*"));
        plain.variables = {caret(2)};
        for (SnippetExpandedContent* content : {&plain, &styled}) {
            content->suffix = fromUtf8(suffix);
            content->applySuffix();
        }
        EXPECT_EQ(notation(plain), std::string("ab") + suffix);
        EXPECT_EQ(notation(styled), std::string("*ab*") + suffix);
        EXPECT_EQ(plain.variables[0]->location, 2u);
    }
}

TEST(PLOutput, CutsRichContentWithItsLook) {
    SnippetExpandedContent content(rich("a*bc*d"));
    content.variables = {key(KeyCode::Return, 2)};
    EXPECT_EQ(describe(PLOutput::fragmentsForRichTextSnippet(content)), "a*b*|key36|*c*d");
}

TEST(PLOutput, WithoutContentHasNoFragments) {
    PLOutput output;
    output.fragments.emplace_back(u"old");
    output.refreshFragments();
    EXPECT_TRUE(output.fragments.empty());
}

TEST(PLOutput, WhatIsSentAgainHasAnEnd) {
    constexpr std::size_t Most = std::size_t{16} * 1024 * 1024;
    SnippetExpandedContent content(std::u16string(1'000'000, u'x'));
    for (int count = 0; count < 1'000; ++count) {
        content.variables.push_back(key(KeyCode::Return, 1'000'000));
        content.variables.push_back(key(KeyCode::Right, 0));
    }
    EXPECT_EQ(content.copyString().size(), Most + 1'000);
    const auto fragments = PLOutput::fragmentsForPlainTextSnippet(content);
    EXPECT_EQ(std::count_if(fragments.begin(), fragments.end(), [](const auto& f) { return f.index() == 2; }), 2'000);
}

// Keys in the order of the text take nothing from it.
RC_GTEST_PROP(PLOutput, FragmentsJoinedAgainAreTheContent, ()) {
    const auto text = *rc::gen::container<std::u16string>(rc::gen::inRange<char16_t>(u'a', u'z'));
    auto locations = *rc::gen::container<std::vector<std::size_t>>(rc::gen::inRange<std::size_t>(0, text.size() + 1));
    std::sort(locations.begin(), locations.end());
    SnippetExpandedContent content(text);
    for (const std::size_t location : locations) content.variables.push_back(key(KeyCode::Escape, location));

    std::u16string joined;
    std::size_t keys = 0;
    for (const auto& fragment : PLOutput::fragmentsForPlainTextSnippet(content)) {
        if (const auto* piece = std::get_if<std::u16string>(&fragment)) {
            RC_ASSERT(!piece->empty() || locations.empty());
            joined += *piece;
        } else {
            RC_ASSERT(locations[keys] == joined.size());
            ++keys;
        }
    }
    RC_ASSERT(joined == text);
    RC_ASSERT(keys == locations.size());
    RC_ASSERT(content.copyString() == text);
}

}  // namespace
}  // namespace plume
