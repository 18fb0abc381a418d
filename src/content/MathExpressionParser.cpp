#include "content/MathExpressionParser.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <cmath>
#include <cstdint>
#include <numbers>
#include <optional>
#include <string>
#include <vector>

#include "Foundation/CharacterSet.h"

namespace plume {

namespace {

constexpr std::size_t MaximumStackDepth = 10'000;

double degreesToRadians(double x) {
    return x / 180 * std::numbers::pi;
}
double radiansToDegrees(double x) {
    return x / std::numbers::pi * 180;
}

using Function = double (*)(double);

struct NamedFunction {
    std::u16string_view name;
    Function function;
};

constexpr std::array<NamedFunction, 26> Functions{{
    {u"sin", std::sin},          {u"cos", std::cos},          {u"tan", std::tan},   {u"log", std::log10},
    {u"log2", std::log2},        {u"ln", std::log},           {u"exp", std::exp},   {u"abs", std::fabs},
    {u"sqrt", std::sqrt},        {u"asin", std::asin},        {u"acos", std::acos}, {u"atan", std::atan},
    {u"sinh", std::sinh},        {u"cosh", std::cosh},        {u"tanh", std::tanh}, {u"asinh", std::asinh},
    {u"acosh", std::acosh},      {u"atanh", std::atanh},      {u"ceil", std::ceil}, {u"floor", std::floor},
    {u"round", std::round},      {u"trunc", std::trunc},      {u"rint", std::rint}, {u"near", std::nearbyint},
    {u"dtor", degreesToRadians}, {u"rtod", radiansToDegrees},
}};

Function functionNamed(std::u16string_view name) {
    for (const NamedFunction& entry : Functions) {
        if (entry.name == name) return entry.function;
    }
    return nullptr;
}

[[noreturn]] void failParsing() {
    throw MathExpressionError("parse error");
}

bool isDigit(char16_t unit) {
    return unit >= u'0' && unit <= u'9';
}

// How many units the character at `index` takes when it may stand in a name, else 0.
std::size_t nameCharacterLength(std::u16string_view text, std::size_t index) {
    const char16_t unit = text[index];
    if (unit == u'_') return 1;
    const bool isPair = unit >= 0xD800 && unit < 0xDC00 && index + 1 < text.size() && text[index + 1] >= 0xDC00 &&
                        text[index + 1] < 0xE000;
    char32_t codePoint = unit;
    if (isPair) codePoint = 0x10000 + ((char32_t{unit} - 0xD800) << 10) + (char32_t{text[index + 1]} - 0xDC00);
    const bool belongs =
        CharacterSet::letters().contains(codePoint) || CharacterSet::decimalDigits().contains(codePoint);
    if (!belongs) return 0;
    return isPair ? 2 : 1;
}

// ---- Tokens ----

enum class TokenKind { Number, Name, Operator, Separator, End };

struct Token {
    TokenKind kind = TokenKind::End;
    double number = 0;
    std::u16string_view name;
    char16_t symbol = 0;
};

class Tokens {
  public:
    explicit Tokens(std::u16string_view text) : text_(text) {}

    Token next();
    // Whether the next token is this operator; it is taken when it is.
    bool take(char16_t symbol);

  private:
    void skipBlanks() {
        while (at_ < text_.size() && (text_[at_] == u' ' || text_[at_] == u'\t')) ++at_;
    }
    void skipDigits() {
        while (at_ < text_.size() && isDigit(text_[at_])) ++at_;
    }
    void skipExponent();
    double number();
    std::u16string_view name();

    std::u16string_view text_;
    std::size_t at_ = 0;
};

Token Tokens::next() {
    skipBlanks();
    if (at_ == text_.size()) return {};
    const char16_t unit = text_[at_];
    if (isDigit(unit) || unit == u'.') return {TokenKind::Number, number(), {}, 0};
    if (const auto found = name(); !found.empty()) return {TokenKind::Name, 0, found, 0};
    ++at_;
    if (unit == u';' || CharacterSet::newlines().contains(unit)) return {TokenKind::Separator, 0, {}, 0};
    return {TokenKind::Operator, 0, {}, unit};
}

bool Tokens::take(char16_t symbol) {
    skipBlanks();
    if (at_ == text_.size() || text_[at_] != symbol) return false;
    ++at_;
    return true;
}

std::u16string_view Tokens::name() {
    const std::size_t start = at_;
    while (at_ < text_.size()) {
        const std::size_t length = nameCharacterLength(text_, at_);
        if (length == 0) break;
        at_ += length;
    }
    return text_.substr(start, at_ - start);
}

// An exponent counts only when it has digits: in "2e" the number ends before the letter.
void Tokens::skipExponent() {
    const std::size_t start = at_;
    if (at_ == text_.size() || (text_[at_] != u'e' && text_[at_] != u'E')) return;
    ++at_;
    if (at_ < text_.size() && (text_[at_] == u'+' || text_[at_] == u'-')) ++at_;
    const std::size_t digits = at_;
    skipDigits();
    if (at_ == digits) at_ = start;
}

// What a number beyond the range of doubles stands for: infinity when it is too large, 0 when it is too small. The
// place of its first digit other than 0, moved by the exponent, tells which.
double outOfRangeValue(std::string_view digits) {
    constexpr std::int64_t FarAway = 1'000'000'000'000;
    const std::size_t mantissaEnd = std::min(digits.find_first_of("eE"), digits.size());
    const std::string_view mantissa = digits.substr(0, mantissaEnd);
    const std::size_t point = std::min(mantissa.find('.'), mantissa.size());
    const std::size_t first = mantissa.find_first_not_of("0.");
    const auto place = static_cast<std::int64_t>(point) - static_cast<std::int64_t>(first);
    std::int64_t exponent = 0;
    if (mantissaEnd < digits.size()) {
        const bool negative = digits[mantissaEnd + 1] == '-';
        const bool hasSign = negative || digits[mantissaEnd + 1] == '+';
        const char* const start = digits.data() + mantissaEnd + (hasSign ? 2 : 1);
        const auto [end, error] = std::from_chars(start, digits.data() + digits.size(), exponent);
        if (error != std::errc() || exponent > FarAway) exponent = FarAway;
        if (negative) exponent = -exponent;
    }
    return place + exponent > 0 ? HUGE_VAL : 0;
}

double Tokens::number() {
    const std::size_t start = at_;
    skipDigits();
    if (at_ < text_.size() && text_[at_] == u'.') ++at_;
    skipDigits();
    if (at_ - start == 1 && text_[start] == u'.') failParsing();
    skipExponent();
    std::string digits;
    digits.reserve(at_ - start);
    for (const char16_t unit : text_.substr(start, at_ - start)) digits.push_back(static_cast<char>(unit));
    double value = 0;
    const auto [end, error] = std::from_chars(digits.data(), digits.data() + digits.size(), value);
    if (error == std::errc::result_out_of_range) return outOfRangeValue(digits);
    return value;
}

// ---- Operators ----

enum class Operation { Open, Call, Assign, Add, Subtract, Multiply, Divide, Remainder, Negate, Power };

// How tightly an operation holds its operands; what stands open until its parenthesis closes holds none.
int binding(Operation operation) {
    switch (operation) {
        case Operation::Open:
        case Operation::Call:
            return 0;
        case Operation::Assign:
            return 1;
        case Operation::Add:
        case Operation::Subtract:
            return 2;
        case Operation::Multiply:
        case Operation::Divide:
        case Operation::Remainder:
            return 3;
        case Operation::Negate:
            return 4;
        case Operation::Power:
            return 5;
    }
    return 0;
}

std::optional<Operation> binaryOperation(char16_t symbol) {
    switch (symbol) {
        case u'+':
            return Operation::Add;
        case u'-':
            return Operation::Subtract;
        case u'*':
            return Operation::Multiply;
        case u'/':
            return Operation::Divide;
        case u'%':
            return Operation::Remainder;
        case u'^':
            return Operation::Power;
        default:
            return std::nullopt;
    }
}

double applied(Operation operation, double left, double right) {
    switch (operation) {
        case Operation::Add:
            return left + right;
        case Operation::Subtract:
            return left - right;
        case Operation::Multiply:
            return left * right;
        case Operation::Divide:
            return left / right;
        case Operation::Remainder:
            return std::fmod(left, right);
        default:
            return std::pow(left, right);
    }
}

// ---- Evaluation ----

using Variables = std::map<std::u16string, double, std::less<>>;

void assign(Variables& variables, std::u16string_view name, double value) {
    const auto found = variables.find(name);
    if (found != variables.end()) {
        found->second = value;
    } else {
        variables.emplace(name, value);
    }
}

double valueOf(const Variables& variables, std::u16string_view name) {
    const auto found = variables.find(name);
    return found == variables.end() ? 0 : found->second;
}

// Evaluates expressions from left to right with a stack of values and one of operations that wait for their right
// side. The stacks are on the heap, so that nesting costs no call depth.
class Evaluation {
  public:
    Evaluation(std::u16string_view text, Variables& variables) : tokens_(text), variables_(variables) {}

    // The value of the last expression that is not empty.
    std::optional<double> run();

  private:
    struct Pending {
        Operation operation = Operation::Open;
        std::u16string_view variable;  // of an assignment
        Function function = nullptr;   // of a call
    };

    void readOperand(const Token& token);
    void readName(std::u16string_view name);
    void readOperator(const Token& token);
    void finishExpression();
    void push(Pending pending);
    void push(double value);
    void checkDepth() const;
    // Carries out what holds its operands at least as tightly as `limit`.
    void reduce(int limit);
    void close();
    double popValue();

    Tokens tokens_;
    Variables& variables_;
    std::vector<double> values_;
    std::vector<Pending> pending_;
    bool expectsOperand_ = true;
    std::optional<double> last_;
};

std::optional<double> Evaluation::run() {
    for (Token token = tokens_.next();; token = tokens_.next()) {
        if (token.kind == TokenKind::End || token.kind == TokenKind::Separator) {
            finishExpression();
            if (token.kind == TokenKind::End) return last_;
        } else if (expectsOperand_) {
            readOperand(token);
        } else {
            readOperator(token);
        }
    }
}

void Evaluation::readOperand(const Token& token) {
    if (token.kind == TokenKind::Number) {
        push(token.number);
    } else if (token.kind == TokenKind::Name) {
        readName(token.name);
    } else if (token.symbol == u'-') {
        push({Operation::Negate, {}, nullptr});
    } else if (token.symbol == u'(') {
        push({Operation::Open, {}, nullptr});
    } else {
        failParsing();
    }
}

// "=" can only follow a variable, so an assignment is known as soon as its name is read: it waits for its right side
// as a sign does.
void Evaluation::readName(std::u16string_view name) {
    if (const Function function = functionNamed(name)) {
        if (!tokens_.take(u'(')) failParsing();
        push({Operation::Call, {}, function});
    } else if (tokens_.take(u'=')) {
        push({Operation::Assign, name, nullptr});
    } else {
        push(valueOf(variables_, name));
    }
}

void Evaluation::readOperator(const Token& token) {
    if (token.kind != TokenKind::Operator) failParsing();
    if (token.symbol == u')') return close();
    const auto operation = binaryOperation(token.symbol);
    if (!operation) failParsing();
    // Powers group from the right: an earlier one waits for a later one.
    reduce(binding(*operation) + (*operation == Operation::Power ? 1 : 0));
    push({*operation, {}, nullptr});
    expectsOperand_ = true;
}

void Evaluation::finishExpression() {
    if (expectsOperand_) {
        if (!pending_.empty()) failParsing();
        return;
    }
    reduce(binding(Operation::Assign));
    if (!pending_.empty()) failParsing();
    last_ = popValue();
    expectsOperand_ = true;
}

void Evaluation::push(Pending pending) {
    pending_.push_back(pending);
    checkDepth();
}

void Evaluation::push(double value) {
    values_.push_back(value);
    expectsOperand_ = false;
    checkDepth();
}

void Evaluation::checkDepth() const {
    if (pending_.size() + values_.size() > MaximumStackDepth) throw MathExpressionError("parser stack overflow");
}

void Evaluation::reduce(int limit) {
    while (!pending_.empty() && binding(pending_.back().operation) >= limit) {
        const Pending top = pending_.back();
        pending_.pop_back();
        const double right = popValue();
        if (top.operation == Operation::Assign) {
            assign(variables_, top.variable, right);
            values_.push_back(right);
        } else if (top.operation == Operation::Negate) {
            values_.push_back(-right);
        } else {
            values_.push_back(applied(top.operation, popValue(), right));
        }
    }
}

void Evaluation::close() {
    reduce(binding(Operation::Assign));
    if (pending_.empty()) failParsing();
    const Pending open = pending_.back();
    pending_.pop_back();
    if (open.operation == Operation::Call) values_.back() = open.function(values_.back());
}

double Evaluation::popValue() {
    const double value = values_.back();
    values_.pop_back();
    return value;
}

}  // namespace

MathExpressionError::MathExpressionError(const char* problem) : std::runtime_error(std::string("error = ") + problem) {}

MathExpressionParser::MathExpressionParser() {
    setSymbolValue(std::numbers::pi, u"pi");
}

double MathExpressionParser::evaluateExpression(std::u16string_view expression) {
    return MathExpressionParser().evaluate(expression);
}

bool MathExpressionParser::isValidMathVariableName(std::u16string_view name) {
    if (name.empty() || name == u"_") return false;
    for (std::size_t index = 0; index < name.size();) {
        const std::size_t length = nameCharacterLength(name, index);
        if (length == 0) return false;
        index += length;
    }
    return true;
}

double MathExpressionParser::evaluate(std::u16string_view expression) {
    expression_ = expression;
    result_ = 0;
    if (const auto value = Evaluation(expression_, variables_).run()) setResult(*value);
    return result_;
}

void MathExpressionParser::setSymbolValue(double value, std::u16string_view key) {
    assign(variables_, key, value);
}

double MathExpressionParser::symbolValueForKey(std::u16string_view key) const {
    return valueOf(variables_, key);
}

}  // namespace plume
