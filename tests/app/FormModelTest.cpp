#include "app/FormModel.h"

#include <gtest/gtest.h>

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

}  // namespace plume
