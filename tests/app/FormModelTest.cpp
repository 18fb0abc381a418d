#include "app/FormModel.h"

#include <gtest/gtest.h>
#include <rapidcheck/gtest.h>

#include <algorithm>

#include "content/FieldMerging.h"
#include "content/NestedScripts.h"
#include "content/PLScript.h"
#include "input/delivery/StepCounts.h"
#include "library/Snippet.h"
#include "tests/content/world/ContentWorld.h"

namespace plume {

namespace {

std::shared_ptr<SnippetFieldVariable> field(std::u16string name, FieldType type, std::u16string value) {
    auto variable = std::make_shared<SnippetFieldVariable>();
    variable->name = std::move(name);
    variable->type = type;
    variable->value = std::move(value);
    return variable;
}

SnippetExpandedContent contentWith(std::vector<std::shared_ptr<SnippetFieldVariable>> fields) {
    SnippetExpandedContent content;
    content.variables.assign(fields.begin(), fields.end());
    return content;
}

std::vector<std::u16string> valuesOf(const FormModel& model) {
    std::vector<std::u16string> values;
    for (const FormModel::Field& f : model.fields()) values.push_back(f.value);
    return values;
}

using Values = std::vector<std::u16string>;
using Problem = FormModel::Problem;

// A form of number fields, given as pairs of name and value.
struct NumberForm {
    explicit NumberForm(const std::vector<std::pair<std::u16string, std::u16string>>& numbers,
                        const std::string& locale = "en_US")
        : content(contentOf(numbers)), model(content, locale) {}

    static SnippetExpandedContent contentOf(const std::vector<std::pair<std::u16string, std::u16string>>& numbers) {
        std::vector<std::shared_ptr<SnippetFieldVariable>> fields;
        for (const auto& [name, value] : numbers) fields.push_back(field(name, FieldType::Number, value));
        return contentWith(fields);
    }
    std::vector<Problem> problems() const {
        std::vector<Problem> all;
        for (std::size_t i = 0; i < model.fields().size(); ++i) all.push_back(model.problem(i));
        return all;
    }

    SnippetExpandedContent content;
    FormModel model;
};

using Problems = std::vector<Problem>;

}  // namespace

TEST(FormModel, EvaluatesFormulasInTheOrderOfTheirNeeds) {
    const auto content =
        contentWith({field(u"total", FieldType::Number, u"net * 2"), field(u"net", FieldType::Number, u"price - 1"),
                     field(u"price", FieldType::Number, u"1234.5")});
    FormModel model(content, "en_US");
    EXPECT_EQ(valuesOf(model), (Values{u"2467", u"1233.5", u"1234.5"}));
    ASSERT_TRUE(model.fill(2, u"3").ok());
    EXPECT_EQ(valuesOf(model), (Values{u"4", u"2", u"3"}));
}

TEST(FormModel, ReadsAndWritesNumbersAsTheLocaleDoes) {
    const auto content =
        contentWith({field(u"a", FieldType::Number, u"2,5"), field(u"b", FieldType::Number, u"a + 1")});
    EXPECT_EQ(valuesOf(FormModel(content, "de_DE")), (Values{u"2,5", u"3,5"}));
}

TEST(FormModel, LeavesFormulasInACircleAndUnreadableOnesEmpty) {
    const auto content =
        contentWith({field(u"a", FieldType::Number, u"b + 1"), field(u"b", FieldType::Number, u"a + 1"),
                     field(u"c", FieldType::Number, u"1 +"), field(u"d", FieldType::Number, u"c")});
    EXPECT_EQ(valuesOf(FormModel(content, "en_US")), (Values{u"", u"", u"", u""}));
}

TEST(FormModel, FillsFieldsOfOneNameTogether) {
    const auto readonly = field(u"Name", FieldType::Singleline, u"x");
    readonly->isReadonly = true;
    const auto content =
        contentWith({field(u"Name", FieldType::Singleline, u""), readonly, field(u"Name", FieldType::Multiline, u""),
                     field(u"", FieldType::Singleline, u"own")});
    FormModel model(content, "");
    EXPECT_FALSE(model.fill(1, u"no").ok());
    ASSERT_TRUE(model.fill(2, u"Ada").ok());
    EXPECT_EQ(valuesOf(model), (Values{u"Ada", u"Ada", u"Ada", u"own"}));
}

TEST(FormModel, HandsOverWhatItShows) {
    const auto menu = field(u"Colour", FieldType::PopupMenu, u"Red\nGreen");
    menu->defaultIndex = 7;
    const auto emptyMenu = field(u"Empty", FieldType::PopupMenu, u"");
    const auto optional = field(u"More", FieldType::Singleline, u"m");
    optional->isOptional = true;
    const auto content = contentWith({menu, emptyMenu, optional});
    FormModel model(content, "");
    EXPECT_FALSE(model.fill(0, u"Blue").ok());
    EXPECT_FALSE(model.fill(1, u"x").ok());
    ASSERT_TRUE(model.fill(2, u"n").ok());
    model.accept();
    EXPECT_EQ(menu->value, u"Green") << "an index past the end shows the last line";
    EXPECT_EQ(emptyMenu->value, u"");
    EXPECT_EQ(optional->value, u"n");
    EXPECT_TRUE(optional->isSelected);
}

TEST(FormModel, SaysWhyANumberHasNoValue) {
    const NumberForm form({{u"a", u"b + 1"},
                           {u"b", u"a + 1"},
                           {u"behind", u"a"},
                           {u"self", u"self + 1"},
                           {u"bad", u"1 +"},
                           {u"endless", u"1 / 0"},
                           {u"fine", u"2"},
                           {u"empty", u""},
                           {u"needy", u"empty + fine"},
                           {u"no name", u"fine"}});
    EXPECT_EQ(form.problems(),
              (Problems{Problem::CircularFormula, Problem::CircularFormula, Problem::MissingNumber,
                        Problem::CircularFormula, Problem::UnreadableFormula, Problem::UnreadableFormula, Problem::None,
                        Problem::None, Problem::MissingNumber, Problem::UnreadableFormula}));
    EXPECT_EQ(valuesOf(form.model), (Values{u"", u"", u"", u"", u"", u"", u"2", u"", u"", u""}));
}

TEST(FormModel, TakesTheValueFromWhatFollowsFromUnreadableText) {
    NumberForm form({{u"price", u"3"}, {u"total", u"price * 2"}, {u"more", u"total + 1"}});
    ASSERT_TRUE(form.model.fill(0, u"3x").ok());
    EXPECT_EQ(valuesOf(form.model), (Values{u"3x", u"", u""}));
    EXPECT_EQ(form.problems(), (Problems{Problem::NoNumber, Problem::MissingNumber, Problem::MissingNumber}));
    ASSERT_TRUE(form.model.fill(0, u"").ok());
    EXPECT_EQ(form.problems(), (Problems{Problem::None, Problem::MissingNumber, Problem::MissingNumber}));
    ASSERT_TRUE(form.model.fill(0, u"4").ok());
    EXPECT_EQ(valuesOf(form.model), (Values{u"4", u"8", u"9"}));
    EXPECT_EQ(form.problems(), (Problems{Problem::None, Problem::None, Problem::None}));
}

TEST(FormModel, ComputesCirclesFromWhatTheUserPutsIntoThem) {
    NumberForm form(
        {{u"a", u"b + 1"}, {u"b", u"a + 1"}, {u"own", u"own = a * 2; own + 1"}, {u"grow", u"grow = grow + a"}});
    ASSERT_TRUE(form.model.fill(0, u"5").ok());
    EXPECT_EQ(valuesOf(form.model), (Values{u"5", u"6", u"11", u"5"}));
    ASSERT_TRUE(form.model.fill(1, u"1").ok());
    EXPECT_EQ(valuesOf(form.model), (Values{u"2", u"1", u"5", u"2"}))
        << "what a formula says does not grow with each turn";
}

TEST(FormModel, ReadsNamesInFormulasAsTheyAreEvaluated) {
    const NumberForm form({{u"1", u""},
                           {u"round", u""},
                           {u"\U0001d465", u"7"},
                           {u"sum", u"1 + round(2.4) + \U0001d465"},
                           {u"sets", u"sum = 100; sum"},
                           {u"after", u"sets - sets + sum"}});
    EXPECT_EQ(valuesOf(form.model), (Values{u"", u"", u"7", u"10", u"100", u"10"}));
}

TEST(FormModel, SharesNumbersOfOneName) {
    const auto text = field(u"n", FieldType::Singleline, u"");
    const auto content = contentWith({field(u"n", FieldType::Number, u"5"), field(u"n", FieldType::Number, u""), text,
                                      field(u"twice", FieldType::Number, u"n * 2"),
                                      field(u"my n", FieldType::Number, u"5"), field(u"my n", FieldType::Number, u"")});
    FormModel model(content, "en_US");
    EXPECT_EQ(valuesOf(model), (Values{u"5", u"5", u"5", u"10", u"5", u""}));
    ASSERT_TRUE(model.fill(2, u"6").ok()) << "a line of text of that name";
    EXPECT_EQ(valuesOf(model), (Values{u"6", u"6", u"6", u"12", u"5", u""}));
    ASSERT_TRUE(model.fill(5, u"7x").ok());
    EXPECT_EQ(valuesOf(model), (Values{u"6", u"6", u"6", u"12", u"7x", u"7x"}));
    EXPECT_EQ(model.problem(4), Problem::NoNumber);
    EXPECT_EQ(model.problem(2), Problem::None);
}

TEST(FormModel, MovesMenusOfOneNameTogether) {
    const auto repeated = field(u"Title", FieldType::Singleline, u"");
    repeated->isReadonly = true;
    const auto content =
        contentWith({field(u"Title", FieldType::PopupMenu, u"Mr\nMs"), repeated,
                     field(u"Title", FieldType::PopupMenu, u"Dr\nMs"), field(u"Title", FieldType::PopupMenu, u"")});
    FormModel model(content, "");
    ASSERT_TRUE(model.fill(0, u"Ms").ok());
    EXPECT_EQ(valuesOf(model), (Values{u"Ms", u"Ms", u"Ms", u""}));
    ASSERT_TRUE(model.fill(2, u"Dr").ok());
    EXPECT_EQ(valuesOf(model), (Values{u"Ms", u"Dr", u"Dr", u""})) << "a menu stays where it lacks the line";
}

TEST(FormModel, KnowsNumbersOfLocalesAndOfPrograms) {
    struct Case {
        const char* locale;
        std::u16string shown;
        std::u16string plain;
        std::u16string shownAgain;
    };
    const std::u16string huge = u"1" + std::u16string(308, u'0');
    const Case cases[] = {
        {"en_US", u"1234.5", u"1234.5", u"1234.5"},
        {"en_US", u" -0.50 ", u"-0.5", u"-0.5"},
        {"de_DE", u"1234,5", u"1234.5", u"1234,5"},
        {"de_DE", u"-0,00001", u"-0.00001", u"-0,00001"},
        {"fr_FR", u"3,14159", u"3.14159", u"3,14159"},
        {"ar_EG", u"\u0661\u0662\u066b\u0665", u"12.5", u"\u0661\u0662\u066b\u0665"},
        {"en_US", u"12345678901234567890", u"12345678901234567890", u"12345678901234567890"},
        {"en_US", u"1E3", u"1000", u"1000"},
        {"en_US", huge, huge, huge},
        {"en_US", u"", u"", u""},
        {"en_US", u"abc", u"abc", u"abc"},
        {"en_US", u"1 2", u"1 2", u"1 2"},
        {"en_US", u"1E999", u"1E999", u"1E999"},
        {"en_US", huge + u"0", huge + u"0", huge + u"0"},
        {"en_US", u"\u221e", u"\u221e", u"\u221e"},
        {"en_US", u"NaN", u"NaN", u"NaN"},
        {"en_US", std::u16string(100'000, u'1'), std::u16string(100'000, u'1'), std::u16string(100'000, u'1')},
        {"de_DE", u"1.234,5", u"1.234,5", u"1.234,5"},
        {"en_US", u"1,234.5", u"1,234.5", u"1,234.5"},
    };
    for (const Case& c : cases) {
        const FormModel model(SnippetExpandedContent(), c.locale);
        EXPECT_EQ(model.plainNumber(c.shown), c.plain);
        EXPECT_EQ(model.shownNumber(c.plain), c.shownAgain);
    }
}

TEST(FormModel, KeepsAllDigitsThatWereTyped) {
    NumberForm form({{u"n", u"0.00012345"}, {u"third", u"n / 3"}, {u"minus", u"0 - n"}, {u"big", u"10 ^ 300"}});
    EXPECT_EQ(valuesOf(form.model), (Values{u"0.00012345", u"0", u"0", u"1" + std::u16string(300, u'0')}));
    ASSERT_TRUE(form.model.fill(0, u"12345678901234567890").ok());
    EXPECT_EQ(form.model.fields()[0].value, u"12345678901234567890");
    ASSERT_TRUE(form.model.fill(0, u"1").ok());
    EXPECT_EQ(form.model.fields()[1].value, u"0.333");
    ASSERT_TRUE(form.model.fill(0, u"1e999").ok());
    EXPECT_EQ(form.problems()[0], Problem::NoNumber);
}

TEST(FormModel, EvaluatesLongChainsAtOnce) {
    constexpr std::size_t Count = 5000;
    std::vector<std::pair<std::u16string, std::u16string>> numbers = {{u"n0", u"1"}};
    const auto nameOf = [](std::size_t index) { return u"n" + fromUtf8(std::to_string(index)); };
    for (std::size_t i = 1; i < Count; ++i) numbers.emplace_back(nameOf(i), nameOf(i - 1) + u" + 1");
    NumberForm form(numbers);
    EXPECT_EQ(form.model.fields().back().value, u"5000");
    ASSERT_TRUE(form.model.fill(0, u"2").ok());
    EXPECT_EQ(form.model.fields().back().value, u"5001");
}

// Whatever the snippet is made of and the user does.
RC_GTEST_PROP(FormModel, CountsTheCharactersThatAreDelivered, ()) {
    ContentWorld world;
    world.pasteboard.plainText = "copied";
    world.add("run", "printf 【field:arg value:two】", ContentType::ShellScript);
    world.add("outer", "echo 【snippet:run】 【field:arg】", ContentType::ShellScript);
    world.add("nested", "nested text");
    const std::vector<std::string> pieces = {"text",
                                             "e",
                                             "\u0301",
                                             "\U0001f468\u200d\U0001f469",
                                             "\r",
                                             "\n",
                                             "\u4e2d\ud55c",
                                             "*bold*",
                                             "【field:a value:one】",
                                             "【field:a type:1 optional】",
                                             "【field:m type:2 value:Red】",
                                             "【field:empty type:2】",
                                             "【field:n type:3 value:2】",
                                             "【clipboard optional】",
                                             "【snippet:nested optional】",
                                             "【snippet:run】",
                                             "【snippet:run optional】",
                                             "【snippet:outer】",
                                             "【snippet:outer optional】",
                                             "【|】"};
    std::string snippet;
    for (const auto& piece : *rc::gen::container<std::vector<std::string>>(rc::gen::elementOf(pieces))) {
        snippet += piece;
    }
    const auto type = *rc::gen::element(ContentType::PlainText, ContentType::RichText);
    const auto content = world.expand(snippet, type);
    RC_ASSERT(content != nullptr);
    FormModel model(*content, "en_US");
    for (std::size_t i = 0; i < model.fields().size(); ++i) {
        if (*rc::gen::arbitrary<bool>()) model.setSelected(i, *rc::gen::arbitrary<bool>());
        const auto value = *rc::gen::element<std::u16string>(u"", u"\u0301x", u"\nlonger", u"Red", u"\U0001f469");
        if (*rc::gen::arbitrary<bool>()) (void)model.fill(i, value).ok();
    }
    const std::size_t length = model.length();
    const bool runsScripts = model.runsScripts();
    model.accept();
    mergeFields(*content);
    processScripts(*content);
    RC_ASSERT(length == leftArrowsFor(content->string()));
    RC_ASSERT(runsScripts == std::any_of(content->scripts.begin(), content->scripts.end(), [](const auto& script) {
                  return !script->snippetVariable->isOptional || script->snippetVariable->isSelected;
              }));
}

TEST(FormModel, SaysThatAScriptIsAllThereIs) {
    SnippetExpandedContent content(u"printf hello");
    content.originalSnippet = std::make_shared<Snippet>();
    content.originalSnippet->setContentType(ContentType::ShellScript);
    content.variables.push_back(field(u"in it", FieldType::Singleline, u"value"));
    const FormModel model(content, "");
    EXPECT_TRUE(model.runsScripts());
    EXPECT_EQ(model.length(), 0u);
    EXPECT_FALSE(FormModel(SnippetExpandedContent(u"hello"), "").runsScripts());
}

}  // namespace plume
