#include "app/preferences/OwnApplicationRows.h"

#include <gtest/gtest.h>

#include "tests/app/preferences/PreferencesSupport.h"

namespace plume {
namespace {

using Rows = OwnApplicationRows;

Rows read(std::string_view own) {
    return Rows::read(test::builtInRows(), own).value();
}

TEST(OwnApplicationRows, BeginAsThoseThatPlumeComesWith) {
    Rows rows = read("");
    EXPECT_EQ(rows.add("LibreOffice-Writer"), "LibreOffice-Writer");
    EXPECT_EQ(rows.add("libreoffice-writer"), "LibreOffice-Writer") << "letter case makes no difference";
    rows.add("libreoffice-draw");
    rows.add("mychat");
    EXPECT_EQ(rows.text(),
              R"({"LibreOffice-Writer":{"family":"office"},"libreoffice-draw":{"family":"office"},"mychat":{}})");
    EXPECT_EQ(rows.seconds("libreoffice-draw", Rows::AfterErasing), 0.04);
}

TEST(OwnApplicationRows, ChoicesKeepWhatElseARowSays) {
    Rows rows = read(R"({"a": {"family": "terminal", "blockLength": 5}})");
    EXPECT_EQ(rows.insertion("a"), Rows::Insertion::Automatic);
    rows.setInsertion("a", Rows::Insertion::Pasted);
    EXPECT_EQ(rows.text(),
              R"({"a":{"family":"terminal","blockLength":5,"flags":["useClipboardIfHasNewLine","useClipboard"]}})");
    rows.setInsertion("a", Rows::Insertion::Typed);
    EXPECT_EQ(rows.insertion("a"), Rows::Insertion::Typed);
    rows.setInsertion("a", Rows::Insertion::Automatic);
    rows.setPasteKeys("a", "Control+R Control+O +");
    rows.setSeconds("a", Rows::BeforePasting, 0.2);
    EXPECT_EQ(rows.pasteKeys("a"), "Control+R Control+O +");
    EXPECT_NE(rows.text().find("delayPasting"), std::string::npos);
    rows.setSeconds("a", Rows::BeforePasting, 0);
    rows.setPasteKeys("a", "");
    EXPECT_EQ(rows.text(), R"({"a":{"family":"terminal","blockLength":5}})");
}

TEST(OwnApplicationRows, WhatCannotBeReadIsAnError) {
    for (const char* own : {"[", "[]", R"({"a": 1})", "7"}) EXPECT_FALSE(Rows::read(test::builtInRows(), own)) << own;
    EXPECT_TRUE(Rows::read("", R"({"a": {"family": 3, "flags": 1, "pasteKeys": [1], "pastingDelay": "x"}})"));
}

}  // namespace
}  // namespace plume
