// The small arithmetic language of number fields.
//
// Binding, from loosest to tightest: "=" (right-associative); "+" and "-"; "*", "/" and "%"; unary "-"; "^"
// (right-associative, so -2^2 is -4 and 2^-1 is 0.5). Names are letters, digits and "_" and do not start with a digit.
#pragma once

#include <map>
#include <stdexcept>
#include <string>
#include <string_view>

namespace plume {

// Thrown for an expression that cannot be read. `name` is "Error in expression", what() "error = parse error" or
// "error = parser stack overflow".
class MathExpressionError : public std::runtime_error {
  public:
    explicit MathExpressionError(const char* problem);
    static constexpr const char* name = "Error in expression";
};

class MathExpressionParser {
  public:
    // A fresh parser's value of the text.
    static double evaluateExpression(std::u16string_view expression);
    // Yes when the name is not empty, is not "_" alone, and holds letters, digits and "_" only.
    static bool isValidMathVariableName(std::u16string_view name);

    MathExpressionParser();

    // The value of the last complete expression of the text, 0 when there is none. Throws MathExpressionError.
    double evaluate(std::u16string_view expression);
    void setSymbolValue(double value, std::u16string_view key);
    double symbolValueForKey(std::u16string_view key) const;
    const std::u16string& expression() const { return expression_; }
    void setResult(double value) { result_ = value; }

  private:
    std::map<std::u16string, double, std::less<>> variables_;
    std::u16string expression_;
    double result_ = 0;
};

}  // namespace plume
