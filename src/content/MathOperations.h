// What the arithmetic language can compute: its functions and its operators.
#pragma once

#include <optional>
#include <string_view>

namespace plume {

using MathFunction = double (*)(double);

// Null when no function has the name. The table in MathOperations.cpp lists them.
MathFunction functionNamed(std::u16string_view name);

enum class Operation { Open, Call, Assign, Add, Subtract, Multiply, Divide, Remainder, Negate, Power };

// How tightly an operation holds its operands; what stands open until its parenthesis closes holds none.
int binding(Operation operation);

// Nothing for a sign that stands between no two values.
std::optional<Operation> binaryOperation(char16_t symbol);

// The value of a binary operation.
double applied(Operation operation, double left, double right);

}  // namespace plume
