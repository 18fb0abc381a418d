#include "content/MathExpressionParser.h"

#include <cstddef>
#include <numbers>
#include <optional>
#include <string>
#include <vector>

#include "content/MathOperations.h"
#include "content/MathTokens.h"

namespace plume {

namespace {

constexpr std::size_t MaximumStackDepth = 10'000;

[[noreturn]] void failParsing() {
    throw MathExpressionError("parse error");
}

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
        std::u16string_view variable;     // of an assignment
        MathFunction function = nullptr;  // of a call
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
    if (const MathFunction function = functionNamed(name)) {
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
