// The words of the arithmetic language: numbers, names, operators and what separates expressions.
#pragma once

#include <cstddef>
#include <string_view>

namespace plume {

enum class TokenKind { Number, Name, Operator, Separator, End };

struct Token {
    TokenKind kind = TokenKind::End;
    double number = 0;
    std::u16string_view name;
    char16_t symbol = 0;
};

// Reads a text from its start to its end.
class Tokens {
  public:
    explicit Tokens(std::u16string_view text) : text_(text) {}

    // Throws MathExpressionError for a point without digits.
    Token next();
    // Whether the next token is this operator; it is taken when it is.
    bool take(char16_t symbol);

  private:
    void skipBlanks();
    void skipDigits();
    void skipExponent();
    double number();
    std::u16string_view name();

    std::u16string_view text_;
    std::size_t at_ = 0;
};

// How many units the character at `index` takes when it may stand in a name, else 0.
std::size_t nameCharacterLength(std::u16string_view text, std::size_t index);

}  // namespace plume
