#include "app/form/FormWords.h"

#include <gtest/gtest.h>

#include <QLocale>
#include <set>

#include "library/Snippet.h"
#include "tests/support/Language.h"

namespace plume {
namespace {

SnippetExpandedContent contentOfLength(std::size_t length, bool hasScript = false) {
    SnippetExpandedContent content(std::u16string(length, u'x'));
    if (hasScript) content.variables.push_back(std::make_shared<SnippetAbbreviationVariable>());
    return content;
}

std::string lengthOf(const SnippetExpandedContent& content) {
    return lengthLine(FormModel(content, "en_US")).toStdString();
}

std::string hintFor(FieldType type, bool isOptional) {
    const auto field = std::make_shared<SnippetFieldVariable>();
    field->type = type;
    field->isOptional = isOptional;
    SnippetExpandedContent content;
    content.variables.push_back(field);
    return hintLine(FormModel(content, "en_US")).toStdString();
}

class DigitsOf {
  public:
    explicit DigitsOf(const QLocale& locale) { QLocale::setDefault(locale); }
    ~DigitsOf() { QLocale::setDefault(usual_); }
    DigitsOf(const DigitsOf&) = delete;
    DigitsOf& operator=(const DigitsOf&) = delete;

  private:
    const QLocale usual_;
};

}  // namespace

TEST(FormWords, SayHowLongTheTextIs) {
    const DigitsOf digits(QLocale(QLocale::English, QLocale::UnitedStates));
    EXPECT_EQ(lengthOf(contentOfLength(0)), "0 characters");
    EXPECT_EQ(lengthOf(contentOfLength(1)), "1 character");
    EXPECT_EQ(lengthOf(contentOfLength(1, true)), "1 character, and what the script adds");
    EXPECT_EQ(lengthOf(contentOfLength(1234567)), "1,234,567 characters");
    EXPECT_EQ(lengthOf(contentOfLength(2, true)), "2 characters, and what the script adds");
}

TEST(FormWords, CountInTheUsersLanguage) {
    const struct {
        const char* language;
        QLocale locale;
        std::vector<std::string> lines;  // of 0, 1, 2, and 1,234 characters
    } cases[] = {
        {"de", QLocale(QLocale::German), {"0 Zeichen", "1 Zeichen", "2 Zeichen", "1.234 Zeichen"}},
        {"fr", QLocale(QLocale::French), {"0 caractère", "1 caractère", "2 caractères", "1\u202f234 caractères"}},
    };
    for (const auto& c : cases) {
        const test::SpokenLanguage language(QString::fromUtf8(c.language));
        const DigitsOf digits(c.locale);
        std::vector<std::string> lines;
        for (const std::size_t length : {0u, 1u, 2u, 1234u}) lines.push_back(lengthOf(contentOfLength(length)));
        EXPECT_EQ(lines, c.lines);
    }
    const DigitsOf digits(QLocale(QLocale::Arabic, QLocale::Egypt));
    EXPECT_EQ(lengthOf(contentOfLength(12)), "\u0661\u0662 characters");
}

TEST(FormWords, SayWhichKeysDoSomethingHere) {
    const std::string letters = "Alt+letter";
    EXPECT_EQ(hintFor(FieldType::Singleline, false), "Return inserts, Ctrl+Return inserts from anywhere, Esc cancels");
    EXPECT_NE(hintFor(FieldType::Singleline, true).find(letters), std::string::npos);
    EXPECT_EQ(hintFor(FieldType::PopupMenu, true).find(letters), std::string::npos) << "an empty menu has no box";
}

TEST(FormWords, TellProblemsApart) {
    using Problem = FormModel::Problem;
    EXPECT_TRUE(wordsFor(Problem::None).isEmpty());
    for (const char* language : {"en", "de", "fr"}) {
        const test::SpokenLanguage spoken(QString::fromUtf8(language));
        std::set<QString> words;
        for (const Problem problem :
             {Problem::NoNumber, Problem::UnreadableFormula, Problem::CircularFormula, Problem::MissingNumber}) {
            words.insert(wordsFor(problem));
        }
        EXPECT_EQ(words.size(), 4u) << language;
        EXPECT_FALSE(words.contains(QString()));
    }
}

}  // namespace plume
