#include "app/editing/ChipBody.h"

#include <gtest/gtest.h>

#include "Foundation/Strings.h"
#include "content/PlaceholderBody.h"
#include "content/SnippetDateTimeVariable.h"
#include "content/SnippetFieldVariable.h"

namespace plume {
namespace {

// What is read again from the written body is what was read from the first one, and what its kind does not know is
// still there.
TEST(ChipBodyTest, KeepsEveryParameter) {
    for (const char16_t* body : {
             u"date:short",
             u"date:\"d MMM 'at' H:mm\" year:-1 month:2 day:30 locale:fr_FR optional:1",
             u"date:full valueType:1 weekday:5 colour:red",
             u"time:\"HH:mm\" hour:1 minute:-90 second:7 locale:de_DE optional:0 \"odd name\":\"a \"\"b\"\"\"",
             u"clipboard find:\"a b\" replacement: flags:13 optional:1 readonly",
             u"snippet:sig uuid:7B0F4C0E-0000-4000-8000-000000000001 optional:1 locale:xx",
             u"field:\"Last name\" type:1 value:\"one\ntwo: 3\" optional:1 readonly width:40 height:7 flags:3",
             u"field:Choice type:2 value:a\nb\nc defaultIndex:2 bare",
             u"key:K code:40 modifiers:1179648 count:3 delay:0.5 locale:de",
         }) {
        SCOPED_TRACE(toUtf8(body));
        const auto variable = editablePlaceholder(body);
        ASSERT_TRUE(variable);
        VariableParams written = parseParams(editedBody(body, *variable));
        VariableParams expected = parseParams(body);
        // The kind writes these for others to read.
        if (written[u"type"] == u"2") expected.try_emplace(u"width", u"2");
        std::erase_if(written, [&](const auto& each) { return each.second.empty() && !expected.contains(each.first); });
        EXPECT_EQ(written, expected);
    }
}

TEST(ChipBodyTest, WhatWasTakenAwayDoesNotComeBack) {
    const char16_t* dated = u"date:short year:1 day:2 locale:de optional:1 colour:red";
    const auto date = std::dynamic_pointer_cast<SnippetDateVariable>(editablePlaceholder(dated));
    date->year = 0;
    date->locale.reset();
    date->isOptional = false;
    EXPECT_EQ(editedBody(dated, *date), u"date:short day:2 colour:red");

    const char16_t* sized = u"field:A type:1 width:40 height:7 defaultIndex:1 readonly";
    const auto field = std::dynamic_pointer_cast<SnippetFieldVariable>(editablePlaceholder(sized));
    field->setWidth(0);
    field->isReadonly = false;
    EXPECT_EQ(editedBody(sized, *field), u"field:A type:1 height:7");
}

TEST(ChipBodyTest, AnArrowIsItsKeyAndTheCaretHasNothingToChange) {
    const auto arrow = editablePlaceholder(u"▶");
    ASSERT_TRUE(arrow);
    EXPECT_EQ(editedBody(u"▶", *arrow), u"key:▶ code:124");
    for (const char16_t* body : {u"|", u"", u"unknown", u"Date:short", u"▶▶"}) EXPECT_FALSE(editablePlaceholder(body));
}

}  // namespace
}  // namespace plume
