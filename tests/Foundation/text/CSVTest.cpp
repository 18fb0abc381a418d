#include <gmock/gmock.h>
#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

#include <filesystem>
#include <fstream>
#include <sstream>
#include <stdexcept>
#include <string>
#include <vector>

#include "Foundation/Strings.h"
#include "Foundation/text/CSV.h"

namespace plume {
namespace {

using testing::ElementsAre;
using testing::StartsWith;

using Names = std::vector<std::u16string>;
using Rows = std::vector<CSVParser::Row>;

const Names ImportNames = {u"Name", u"Value", u"Label"};

// Rows as a table of cases writes them: "Name=a;Value=b|Name=c", or "nothing".
std::string shown(const std::optional<Rows>& rows) {
    if (!rows) return "nothing";
    std::string text;
    for (const CSVParser::Row& row : *rows) {
        if (!text.empty()) text += "|";
        std::string fields;
        for (const auto& [name, value] : row) {
            if (!fields.empty()) fields += ";";
            fields += toUtf8(name) + "=" + toUtf8(value);
        }
        text += fields;
    }
    return text;
}

struct Reading {
    const char16_t* text;
    const char* expected;
    const char16_t* separator = u",";
    bool hasHeader = false;
};

TEST(CSVParser, ReadsTheDialect) {
    const Reading cases[] = {
        {u"a,b\nc,d", "Name=a;Value=b|Name=c;Value=d"},
        {u"a", "Name=a"},
        {u"a\r\nb\r\n\r\n\nc", "Name=a|Name=b|Name=c"},
        {u"a\u2028b\u2029c\u0085d\vf\fg", "Name=a|Name=b|Name=c|Name=d|Name=f|Name=g"},
        {u"", "nothing"},
        {u"\na,b", "nothing"},
        {u"a,,c", "Label=c;Name=a;Value="},
        {u",", "Name=;Value="},
        {u" a , b ", "Name= a ;Value= b "},
        {u"\"a,b\nc\"\"d\",e", "Name=a,b\nc\"d;Value=e"},
        {u"\"\",\"\"\"\"", "Name=;Value=\""},
        {u"a,\"b\"\nc", "Name=a;Value=b|Name=c"},
        // What breaks the rules ends the parse.
        {u"a,x\"y,b\nc", "Name=a;Value=x"},
        {u"a,\"x\"y,b\nc", "Name=a;Value=x"},
        {u"a,\"x\"\"y,b\nc", "Name=a"},
        {u"\"x", "nothing"},
        {u"a\n\"x\ny\nz", "Name=a"},
        // Long separators.
        {u"a:b::c:", "Name=a:b;Value=c:", u"::"},
        {u"a:::b", "Name=a;Value=:b", u"::"},
        {u"::", "Name=;Value=", u"::"},
        {u":", "Name=:", u"::"},
        {u"\"a::b\"::c", "Name=a::b;Value=c", u"::"},
        // Names from a header.
        {u"x,y\r\n\r\na,b,c", "FIELD_3=c;x=a;y=b", u",", true},
        {u"\"x,\",y\na,b", "x,=a;y=b", u",", true},
        {u"x,x\na,b", "x=b", u",", true},
        {u"x,y", "nothing", u",", true},
        {u"x,y\n", "nothing", u",", true},
        {u"\nx,y\na,b", "nothing", u",", true},
        {u"x,\"y\na,b", "nothing", u",", true},
    };
    for (const Reading& c : cases) {
        CSVParser parser(c.text, c.separator, std::nullopt, c.hasHeader, ImportNames);
        EXPECT_EQ(shown(parser.arrayOfParsedRows()), c.expected) << toUtf8(c.text);
    }
}

TEST(CSVParser, TakesLineSeparatorsAndNamesFromTheCaller) {
    CSVParser parser(u"a\nb;c\rd,e", u",", CharacterSet::withCharacters(u";\r"), false, {u"Name"});
    EXPECT_EQ(shown(parser.arrayOfParsedRows()), "Name=a\nb|Name=c|FIELD_2=e;Name=d");
    EXPECT_THAT(parser.fieldNames(), ElementsAre(u"Name", u"FIELD_2"));
}

TEST(CSVParser, RefusesSeparatorsThatCannotSeparate) {
    const auto complaint = [](std::u16string separator,
                              std::optional<CharacterSet> lines = std::nullopt) -> std::string {
        try {
            const CSVParser parser(u"a", std::move(separator), std::move(lines), false, {});
            return "";
        } catch (const std::invalid_argument& error) {
            return error.what();
        }
    };
    for (const char16_t* separator : {u"", u"\"", u",\"", u"\n", u",\u2028"}) {
        EXPECT_EQ(complaint(separator),
                  "CSV separator string must not be empty and must not contain the double quote character or newline "
                  "characters.");
    }
    EXPECT_NE(complaint(u";", CharacterSet::withCharacters(u";")), "");
    EXPECT_EQ(complaint(u"\t"), "");
    EXPECT_EQ(complaint(u"\n", CharacterSet::withCharacters(u";")), "");
}

TEST(CSVParser, HandsRowsOverOneByOne) {
    Rows rows;
    CSVParser parser(u"a,b\nc\n\"", u",", std::nullopt, false, ImportNames);
    EXPECT_TRUE(parser.parseRowsForReceiver([&](CSVParser::Row row) { rows.push_back(std::move(row)); }));
    EXPECT_EQ(shown(rows), "Name=a;Value=b|Name=c");
    CSVParser empty(u"\n", u",", std::nullopt, false, ImportNames);
    EXPECT_FALSE(empty.parseRowsForReceiver([](const CSVParser::Row&) { FAIL(); }));
}

TEST(CSVParser, ReadsLargeTexts) {
    std::u16string text = u"\"";
    for (int i = 0; i < 1'000'000; ++i) text += u"ab\"\"\n";
    text += u"\"";
    for (int i = 0; i < 200'000; ++i) text += u"\nshort,\"a long content\",label";
    std::size_t count = 0;
    std::size_t longest = 0;
    CSVParser parser(std::move(text), u",", std::nullopt, false, ImportNames);
    parser.parseRowsForReceiver([&](const CSVParser::Row& row) {
        ++count;
        longest = std::max(longest, row.at(u"Name").size());
    });
    EXPECT_EQ(count, 200'001U);
    EXPECT_EQ(longest, 4'000'000U);
}

TEST(CSVParser, ARecordWithTooManyFieldsIsTheLast) {
    constexpr std::size_t Limit = CSVParser::MaxFieldsPerRecord;
    std::vector<std::size_t> fields;
    CSVParser parser(std::u16string(Limit - 1, u',') + u"\na\n" + std::u16string(Limit, u',') + u"\nb", u",",
                     std::nullopt, false, ImportNames);
    parser.parseRowsForReceiver([&](const CSVParser::Row& row) { fields.push_back(row.size()); });
    EXPECT_THAT(fields, ElementsAre(Limit, 1U, Limit));
}

std::string written(const std::vector<std::vector<CsvWriter::Field>>& lines, char16_t delimiter = u',') {
    std::ostringstream stream;
    CsvWriter writer(stream, CsvEncoding::Utf8, delimiter);
    for (const auto& line : lines) writer.writeLineOfFields(line);
    return stream.str();
}

TEST(CsvWriter, QuotesOnlyWhatNeedsIt) {
    const std::pair<const char16_t*, std::string> cases[] = {
        {u" plain\tb;c'd ", " plain\tb;c'd "},
        {u"", ""},
        {u"a,b", "\"a,b\""},
        {u"a\rb\n", "\"a\rb\n\""},
        {u"a\u2028b", "\"a\u2028b\""},
        {u"say \"hi\"", "\"say \"\"hi\"\"\""},
        {u"ü\U0001F600", "ü\U0001F600"},
    };
    for (const auto& [field, expected] : cases) EXPECT_EQ(written({{field}}), expected + "\n") << toUtf8(field);
    EXPECT_EQ(written({{u"a,b", u"c;d"}}, u';'), "a,b;\"c;d\"\n");
}

TEST(CsvWriter, WritesLinesAndCommentsAndFinishesAStartedLineBefore) {
    EXPECT_EQ(written({{u"a", std::nullopt, u"b"}, {}, {std::nullopt}, {u"c"}}), "a,,b\n\n\nc\n");
    std::ostringstream stream;
    CsvWriter writer(stream, CsvEncoding::Utf8, u',');
    writer.writeField(u"a");
    writer.writeField(u"");
    writer.writeLineOfFields({u"b"});
    writer.writeField(u"c");
    writer.writeComment(u"one\r\ntwo\n\nthree");
    writer.writeComment(u"");
    writer.writeField(u"d");
    writer.finishLine();
    EXPECT_EQ(stream.str(), "a,\nb\nc\n#one\n#two\n#\n#three\n#\nd\n");
}

TEST(CsvWriter, WritesTheByteOrderMarkOfUtf16Once) {
    std::ostringstream stream;
    CsvWriter writer(stream, CsvEncoding::Utf16, u',');
    writer.writeLineOfFields({u"a", u"ü"});
    EXPECT_EQ(stream.str(), std::string("\xff\xfe"
                                        "a\0,\0\xfc\0\n\0",
                                        10));
}

TEST(CsvWriter, ReplacesTheFileThatWasThere) {
    const auto path = std::filesystem::path(testing::TempDir()) / "plume-csv-test.csv";
    std::ofstream(path) << "a much longer text than the new one";
    auto writer = CsvWriter::makeForWritingToCSVFile(path);
    ASSERT_TRUE(writer);
    CsvWriter moved = std::move(writer).value();
    moved.writeLineOfFields({u"ä", u"b"});
    EXPECT_TRUE(moved.closeStream());
    std::ostringstream text;
    text << std::ifstream(path).rdbuf();
    EXPECT_EQ(text.str(), "ä,b\n");
    std::filesystem::remove(path);
}

TEST(CsvWriter, ReportsWhatCannotBeWritten) {
    const auto unopened = CsvWriter::makeForWritingToCSVFile("/plume-missing/export.csv");
    ASSERT_FALSE(unopened);
    EXPECT_THAT(unopened.error().message, StartsWith("The file /plume-missing/export.csv"));
    std::ostringstream stream;
    CsvWriter writer(stream, CsvEncoding::Utf8, u',');
    stream.setstate(std::ios::badbit);
    writer.writeLineOfFields({u"a"});
    EXPECT_FALSE(writer.closeStream());
}

// A line of one empty field is an empty line, which readers skip.
RC_GTEST_PROP(CSV, WhatIsWrittenReadsBackTheSame, ()) {
    const auto text = rc::gen::scale(0.2, rc::gen::container<std::u16string>(rc::gen::element(
                                              u'a', u'"', u',', u'\n', u'\r', u'#', u' ', u'\u2028', u'ß', u'\0')));
    const auto lines =
        *rc::gen::nonEmpty(rc::gen::container<std::vector<std::vector<std::u16string>>>(rc::gen::suchThat(
            rc::gen::scale(0.2, rc::gen::container<std::vector<std::u16string>>(text)),
            [](const auto& line) { return line.size() > 1 || (line.size() == 1 && !line.front().empty()); })));
    std::ostringstream stream;
    CsvWriter writer(stream, CsvEncoding::Utf8, u',');
    for (const auto& line : lines) writer.writeLineOfFields({line.begin(), line.end()});
    CSVParser parser(fromUtf8(stream.str()), u",", std::nullopt, false, {});
    const auto rows = parser.arrayOfParsedRows();
    RC_ASSERT(rows.has_value());
    RC_ASSERT(rows->size() == lines.size());
    for (std::size_t i = 0; i < lines.size(); ++i) {
        RC_ASSERT((*rows)[i].size() == lines[i].size());
        for (std::size_t j = 0; j < lines[i].size(); ++j) {
            RC_ASSERT((*rows)[i].at(u"FIELD_" + fromUtf8(std::to_string(j + 1))) == lines[i][j]);
        }
    }
}

}  // namespace
}  // namespace plume
