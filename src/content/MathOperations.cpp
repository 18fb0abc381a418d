#include "content/MathOperations.h"

#include <array>
#include <cmath>
#include <numbers>

namespace plume {
namespace {

double degreesToRadians(double x) {
    return x / 180 * std::numbers::pi;
}
double radiansToDegrees(double x) {
    return x / std::numbers::pi * 180;
}

struct NamedFunction {
    std::u16string_view name;
    MathFunction function;
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

}  // namespace

MathFunction functionNamed(std::u16string_view name) {
    for (const NamedFunction& entry : Functions) {
        if (entry.name == name) return entry.function;
    }
    return nullptr;
}

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

}  // namespace plume
