#include "app/editing/RowsAsText.h"

#include <gtest/gtest.h>

#include "tests/library/LibraryMachine.h"

namespace plume {
namespace {

// "abbreviation=content (label)" for each.
std::vector<std::string> rows(const std::u16string& text) {
    std::vector<std::string> lines;
    for (const auto& snippet : rowsFromText(text)) {
        std::string line = toUtf8(snippet->abbreviation().value_or(u"")) + "=" + toUtf8(*snippet->plainTextContent());
        if (snippet->label()) line += " (" + toUtf8(*snippet->label()) + ")";
        lines.push_back(line);
    }
    return lines;
}

TEST(RowsAsTextTest, ReadsWhatOtherProgramsCopy) {
    struct Case {
        std::u16string text;
        std::vector<std::string> rows;
    };
    const std::vector<Case> cases{
        {u"btw\tby the way\r\nafaik\tas far as I know\tChat\r\n", {"btw=by the way", "afaik=as far as I know (Chat)"}},
        {u"sig\t\"two\nlines, \"\"quoted\"\"\"\nb\tc", {"sig=two\nlines, \"quoted\"", "b=c"}},
        {u"5\"\t5 inches\n\"open\tnever closed\n", {"5\"=5 inches", "\"open=never closed"}},
        {u"\tno abbreviation\nempty\t\nalone\n", {"=no abbreviation"}},
        {u"Hello, world\nsecond line", {"=Hello, world\nsecond line"}},
        {u" \n", {}},
        {u"", {}},
    };
    for (const auto& [text, expected] : cases) EXPECT_EQ(rows(text), expected) << toUtf8(text);
}

TEST(RowsAsTextTest, ReadsWhatItHasWritten) {
    const std::u16string content = u"a\tb\n\"c\", 【date:short】 \U0001F600";
    auto first = std::make_shared<Snippet>(u"one", content);
    first->setLabel(u"A label");
    const std::u16string text = textFromRows({first, std::make_shared<Snippet>(std::nullopt, u"plain")});
    EXPECT_EQ(rows(text), (std::vector<std::string>{"one=" + toUtf8(content) + " (A label)", "=plain"}));
}

}  // namespace
}  // namespace plume
