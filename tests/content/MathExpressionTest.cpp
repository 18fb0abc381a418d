#include <gmock/gmock.h>
#include <rapidcheck/gtest.h>

#include <cmath>
#include <limits>
#include <map>
#include <numbers>

#include "Foundation/Strings.h"
#include "content/MathExpressionParser.h"

namespace plume {
namespace {

constexpr double Infinity = std::numeric_limits<double>::infinity();

void expectValues(std::initializer_list<std::pair<const char16_t*, double>> cases) {
    for (const auto& [expression, expected] : cases) {
        double value = 0;
        EXPECT_NO_THROW(value = MathExpressionParser::evaluateExpression(expression)) << toUtf8(expression);
        EXPECT_DOUBLE_EQ(value, expected) << toUtf8(expression);
    }
}

std::string problemOf(std::u16string_view expression) {
    try {
        MathExpressionParser::evaluateExpression(expression);
    } catch (const MathExpressionError& error) {
        return std::string(MathExpressionError::Name) + ": " + error.what();
    }
    return "none";
}

TEST(MathExpression, ReadsNumbers) {
    expectValues({{u".5", 0.5},
                  {u"1.", 1},
                  {u"1.25e2", 125},
                  {u"1E-2", 0.01},
                  {u"2e+1", 20},
                  {u"1e99999999999999999999999", Infinity},
                  {u"1e-99999999999999999999999", 0},
                  {u"0.0001e-330", 0},
                  {u"0e99999", 0},
                  {u"1000e306", Infinity},
                  {u"0.001e311", 1e308},
                  {u" 1\t+ 2 ", 3}});
}

TEST(MathExpression, CallsFunctions) {
    expectValues({{u"sin(pi/2)", 1},      {u"cos(0)", 1},
                  {u"tan(pi/4)", 1},      {u"log(1000)", 3},
                  {u"log2(8)", 3},        {u"ln(exp(2))", 2},
                  {u"exp(0)", 1},         {u"abs(-3)", 3},
                  {u"sqrt(16)", 4},       {u"asin(1)*2", 3.141592653589793},
                  {u"acos(1)", 0},        {u"atan(1)*4", 3.141592653589793},
                  {u"sinh(0)", 0},        {u"cosh(0)", 1},
                  {u"tanh(0)", 0},        {u"asinh(sinh(1))", 1},
                  {u"acosh(cosh(1))", 1}, {u"atanh(tanh(1))", 1},
                  {u"ceil(1.2)", 2},      {u"floor(-1.2)", -2},
                  {u"round(2.5)", 3},     {u"round(-2.5)", -3},
                  {u"trunc(-1.9)", -1},   {u"rint(2.5)", 2},
                  {u"near(3.5)", 4},      {u"dtor(180)", std::numbers::pi},
                  {u"rtod(pi)", 180},     {u"sqrt (9) + 1", 4},
                  {u"-sqrt(4)^2", -4},    {u"sqrt(abs(-16))", 4}});
}

TEST(MathExpression, AssignsAndReadsVariables) {
    expectValues({{u"a=b=2; a+b", 4},
                  {u"2*x=1+2", 6},
                  {u"(x=2)*3+x", 8},
                  {u"x+(x=3)", 3},
                  {u"unknown+1", 1},
                  {u"pi=3; pi", 3},
                  {u"x_1=2; x_1^2", 4},
                  {u"_=4;_", 4},
                  {u"größe=5; größe+1", 6},
                  {u"\U0001D465=5; \U0001D465", 5},
                  {u"Sin=2; Sin", 2},
                  {u"x = 1; X", 0}});
}

TEST(MathExpression, AnswersTheLastOfSeveralExpressions) {
    expectValues(
        {{u"", 0}, {u"   ", 0}, {u";;\n;", 0}, {u"1;2;3", 3}, {u"1\r\n2\r\n", 2}, {u"4;\n\n;", 4}, {u";5", 5}});
}

TEST(MathExpression, RefusesWhatItCannotRead) {
    for (const char16_t* expression :
         {u"2+",   u"+2",    u"*2",    u"2 3",       u"2x",    u"(2",     u"2)", u"()",  u"(2;3)", u"(2\n)",
          u"sin",  u"sin 2", u"sin()", u"sin=2",     u"sin(2", u"sin)2(", u"=2", u"2=3", u"x=",    u"(x)=2",
          u"x==2", u".",     u"1..2",  u"1.2.3",     u"2e",    u"0x10",   u"2$", u"2,5", u"a b",   u"\xD835",
          u"1;2+", u"2**3",  u"x(2)",  u"2\u00A0+3", u"--",    u"2^",     u"%"}) {
        EXPECT_EQ(problemOf(expression), "Error in expression: error = parse error") << toUtf8(expression);
    }
}

TEST(MathExpression, RefusesWhatIsNestedTooDeeply) {
    const std::string overflow = "Error in expression: error = parser stack overflow";
    const auto nested = [](std::size_t depth) {
        return std::u16string(depth, u'(') + u"7" + std::u16string(depth, u')');
    };
    EXPECT_EQ(MathExpressionParser::evaluateExpression(nested(9'999)), 7);
    EXPECT_EQ(problemOf(nested(10'000)), overflow);
    EXPECT_EQ(problemOf(nested(1'000'000)), overflow);
    EXPECT_EQ(problemOf(std::u16string(1'000'000, u'-') + u"1"), overflow);
    std::u16string powers = u"1";
    std::u16string assignments;
    std::u16string calls;
    for (int i = 0; i < 20'000; ++i) {
        powers += u"^1";
        assignments += u"a=";
        calls += u"abs(";
    }
    EXPECT_EQ(problemOf(powers), overflow);
    EXPECT_EQ(problemOf(assignments), overflow);
    EXPECT_EQ(problemOf(calls), overflow);
}

TEST(MathExpression, ReadsLongTexts) {
    std::u16string sum = u"0";
    while (sum.size() < 1'000'000) sum += u"+1";
    EXPECT_EQ(MathExpressionParser::evaluateExpression(sum), static_cast<double>(sum.size() - 1) / 2);
    EXPECT_EQ(MathExpressionParser::evaluateExpression(u"0." + std::u16string(1'000'000, u'0') + u"1"), 0);
    EXPECT_EQ(MathExpressionParser::evaluateExpression(std::u16string(1'000'000, u'9')), Infinity);
    const std::u16string name(300'000, u'n');
    EXPECT_EQ(MathExpressionParser::evaluateExpression(name + u"=2;" + name), 2);
}

TEST(MathExpressionParser, KeepsVariablesFromTextToText) {
    MathExpressionParser parser;
    EXPECT_EQ(parser.symbolValueForKey(u"x"), 0);
    EXPECT_EQ(parser.symbolValueForKey(u"pi"), std::numbers::pi);
    EXPECT_EQ(parser.evaluate(u"x=3"), 3);
    EXPECT_EQ(parser.symbolValueForKey(u"x"), 3);
    parser.setSymbolValue(4, u"x");
    EXPECT_EQ(parser.evaluate(u"x*2"), 8);
    EXPECT_EQ(parser.expression(), u"x*2");
    EXPECT_EQ(parser.evaluate(u""), 0);
    EXPECT_THROW(parser.evaluate(u"x=9; y=2+"), MathExpressionError);
    EXPECT_EQ(parser.symbolValueForKey(u"x"), 9);
    EXPECT_EQ(parser.symbolValueForKey(u"y"), 0);
    EXPECT_EQ(parser.evaluate(u"x"), 9);
}

TEST(MathExpressionParser, KnowsVariableNames) {
    for (const char16_t* name : {u"a_1", u"x", u"__", u"_a", u"1a", u"Größe", u"数", u"\U0001D465"}) {
        EXPECT_TRUE(MathExpressionParser::isValidMathVariableName(name)) << toUtf8(name);
    }
    for (const char16_t* name : {u"", u"_", u"a-b", u"a b", u"a.b", u"½", u"\xD835", u"a\n"}) {
        EXPECT_FALSE(MathExpressionParser::isValidMathVariableName(name)) << toUtf8(name);
    }
}

// An expression with no parentheses but those that the binding asks for, and its value.
struct Expression {
    std::u16string text;
    double value = 0;
    int level = 5;  // how tightly it is bound: a number or a call most of all

    std::u16string wrapped(bool wrap) const { return wrap ? u"(" + text + u")" : text; }
};

Expression sign(const Expression& right) {
    return {u"-" + right.wrapped(right.level < 3), -right.value, 3};
}

Expression call(const Expression& right) {
    return {u"abs(" + right.text + u")", std::fabs(right.value)};
}

Expression binary(char16_t operation, const Expression& left, const Expression& right) {
    const int level = operation == u'^' ? 4 : std::u16string_view(u"+-").find(operation) < 2 ? 1 : 2;
    const bool isPower = level == 4;
    const bool wrapLeft = isPower ? left.level <= level : left.level < level;
    // A sign may stand at the right of any operator, because nothing else can begin there.
    const bool wrapRight = right.level != 3 && (isPower ? right.level < level : right.level <= level);
    const double a = left.value;
    const double b = right.value;
    const std::map<char16_t, double> values = {{u'+', a + b}, {u'-', a - b},           {u'*', a * b},
                                               {u'/', a / b}, {u'%', std::fmod(a, b)}, {u'^', std::pow(a, b)}};
    return {left.wrapped(wrapLeft) + operation + right.wrapped(wrapRight), values.at(operation), level};
}

rc::Gen<Expression> expressions(int depth) {
    const auto number = rc::gen::map(rc::gen::inRange(0, 10), [](int value) {
        return Expression{fromUtf8(std::to_string(value)), static_cast<double>(value)};
    });
    if (depth == 0) return number;
    const auto compound = rc::gen::mapcat(rc::gen::elementOf(std::u16string(u"+-*/%^nf")), [depth](char16_t operation) {
        return rc::gen::apply(
            [operation](const Expression& left, const Expression& right) {
                return operation == u'n'   ? sign(right)
                       : operation == u'f' ? call(right)
                                           : binary(operation, left, right);
            },
            expressions(depth - 1), expressions(depth - 1));
    });
    return rc::gen::weightedOneOf<Expression>({{1, number}, {3, compound}});
}

RC_GTEST_PROP(MathExpressionProperty, ComputesWhatTheOperatorsCompute, ()) {
    const Expression expression = *rc::gen::noShrink(expressions(5));
    RC_LOG() << toUtf8(expression.text);
    const double value = MathExpressionParser::evaluateExpression(expression.text);
    RC_ASSERT(value == expression.value || (std::isnan(value) && std::isnan(expression.value)));
}

RC_GTEST_PROP(MathExpressionProperty, EitherComputesOrRefusesAnyText, ()) {
    const auto text = *rc::gen::container<std::u16string>(
        rc::gen::elementOf(std::u16string(u"0123456789.eE+-*/^%()=;\n \tabsinx_é$")));
    try {
        MathExpressionParser::evaluateExpression(text);
    } catch (const MathExpressionError& error) {
        RC_ASSERT(std::string(error.what()) == "error = parse error");
    }
}

}  // namespace
}  // namespace plume
