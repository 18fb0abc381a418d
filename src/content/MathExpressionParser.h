// The small arithmetic language of number fields: "2 * (price - discount)", "total = a + b; round(total)".
//
// Expressions are separated by ";" or line breaks, and empty ones are skipped. Binding, from loosest to tightest: "="
// (right-associative); "+" and "-"; "*", "/" and "%"; unary "-"; "^" (right-associative, so -2^2 is -4 and 2^-1 is
// 0.5). An assignment may stand wherever a value may and reaches as far to the right as it can: 2*x=1+2 is 6. Names are
// letters, digits and "_" and do not start with one of the digits 0 to 9; a variable that nobody has set is 0. A
// function needs its parentheses and cannot be assigned to.
//
// Time and memory are linear in the text, and call depth is constant. Used by one thread at a time.
#pragma once

#include <map>
#include <stdexcept>
#include <string>
#include <string_view>

namespace plume {

// Thrown for an expression that cannot be read. `Name` is "Error in expression", what() "error = parse error" or
// "error = parser stack overflow".
class MathExpressionError : public std::runtime_error {
  public:
    explicit MathExpressionError(const char* problem);
    static constexpr const char* Name = "Error in expression";
};

class MathExpressionParser {
  public:
    // A fresh parser's value of the text.
    static double evaluateExpression(std::u16string_view expression);
    // Yes when the name is not empty, is not "_" alone, and holds letters, digits and "_" only.
    static bool isValidMathVariableName(std::u16string_view name);

    MathExpressionParser();

    // The value of the last expression of the text, 0 when there is none. Throws MathExpressionError; what the
    // expressions before the faulty one assigned stays.
    double evaluate(std::u16string_view expression);
    void setSymbolValue(double value, std::u16string_view key);
    // 0 for a variable that nobody has set.
    double symbolValueForKey(std::u16string_view key) const;
    const std::u16string& expression() const { return expression_; }
    void setResult(double value) { result_ = value; }

  private:
    std::map<std::u16string, double, std::less<>> variables_;
    std::u16string expression_;
    double result_ = 0;
};

}  // namespace plume
