#include "input/delivery/OutputFragments.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

#include <numeric>

namespace plume {
namespace {

using ::testing::ElementsAre;
using ::testing::IsEmpty;

ContextInputSetting withBlock(std::uint64_t length) {
    ContextInputSetting setting;
    setting.blockLength = length;
    return setting;
}

TEST(OutputFragments, CutsTextIntoTypedChunks) {
    struct Case {
        std::u16string text;
        std::uint64_t block;
        std::vector<std::u16string> chunks;
    };
    const Case cases[] = {
        {u"", 0, {}},
        {u"abc", 0, {u"abc"}},
        {u"ab\ncd", 0, {u"ab\ncd"}},  // only the first unit of a chunk counts
        {u"\nabc", 0, {u"\n", u"abc"}},
        {u"\t\n\u2028x", 0, {u"\t", u"\n", u"\u2028", u"x"}},
        {u"abcdefg", 3, {u"abc", u"def", u"g"}},
        {u"abc\ndef", 3, {u"abc", u"\n", u"def"}},
        {u"123456789012345678901", 0, {u"12345678901234567890", u"1"}},
    };
    for (const Case& c : cases) EXPECT_EQ(fragmentsForPlainText(c.text, withBlock(c.block)), c.chunks);
}

RC_GTEST_PROP(OutputFragments, ChunksGiveBackTheText, (const std::vector<std::uint8_t>& picks)) {
    std::u16string text;
    for (const auto pick : picks) text += u"abc \t\n\u2029x"[pick % 8];
    const auto chunks = fragmentsForPlainText(text, withBlock(*rc::gen::inRange<std::uint64_t>(0, 7)));
    RC_ASSERT(std::accumulate(chunks.begin(), chunks.end(), std::u16string()) == text);
}

std::shared_ptr<SnippetKeyVariable> key(std::size_t location, std::uint64_t count) {
    auto variable = std::make_shared<SnippetKeyVariable>(u"\u21e5", KeyCode::Tab);
    variable->location = location;
    variable->count = count;
    return variable;
}

TEST(OutputFragments, CountsWhatTypingTakes) {
    PLOutput output;
    output.backspaceCount = 3;
    output.snippetExpandedContent = std::make_shared<SnippetExpandedContent>(std::u16string(45, u'x'));
    output.snippetExpandedContent->variables = {key(5, 4), std::make_shared<SnippetContentCaret>()};
    output.snippetExpandedContent->variables[1]->location = 43;
    refreshFragmentsForOuput(output, {});
    EXPECT_EQ(output.leftArrowCount, 2U);
    // 5 units, the key, 40 units in two chunks.
    EXPECT_EQ(output.fragments.size(), 4U);
    EXPECT_EQ(eventCountForOutput(output), 3U + 2U + 3U + 4U);
}

TEST(OutputFragments, WhatIsPastedStaysWhole) {
    PLOutput output;
    output.snippetExpandedContent = std::make_shared<SnippetExpandedContent>(std::u16string(45, u'x'));
    ContextInputSetting pasting;
    pasting.flags |= InputFlag::UseClipboard;
    refreshFragmentsForOuput(output, pasting);
    EXPECT_EQ(output.fragments.size(), 1U);

    output.snippetExpandedContent =
        std::make_shared<SnippetExpandedContent>(AttributedString(std::u16string(45, u'x')));
    refreshFragmentsForOuput(output, {});
    EXPECT_EQ(output.fragments.size(), 1U);
    EXPECT_EQ(eventCountForOutput(output), 0U) << "rich text is no typing event";

    output.snippetExpandedContent = nullptr;
    refreshFragmentsForOuput(output, {});
    EXPECT_THAT(output.fragments, IsEmpty());
}

}  // namespace
}  // namespace plume
