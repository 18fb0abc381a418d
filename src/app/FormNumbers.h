// The numbers of a form that formulas refer to by name, and what follows from them.
//
// Owned by the form; one thread at a time has it. Time is linear in the formulas, however they need each other.
#pragma once

#include <cstddef>
#include <cstdint>
#include <map>
#include <optional>
#include <string>
#include <vector>

#include "content/MathExpressionParser.h"

namespace plume {

// Why a field's value is not what it seems to be.
enum class FormProblem : std::uint8_t {
    None,
    NoNumber,           // of a number field: what was typed cannot be read
    UnreadableFormula,  // it cannot be computed as it is written
    CircularFormula,    // it depends on itself
    MissingNumber,      // what it is computed from has no value
};

class FormNumbers {
  public:
    struct Number {
        std::u16string name;
        std::optional<double> value;
        // As it was given, not what the expression gives.
        bool isGiven = true;
        std::u16string shown;  // of a given number with a value, by whom it is given
        std::u16string expression;
        FormProblem problem = FormProblem::None;  // of the expression

        // By their places in the list.
        std::vector<std::size_t> needs;
        std::vector<std::size_t> followers;
        bool isInCircle = false;
    };

    struct Given {
        double value;
        std::u16string shown;
    };

    // Names are those that formulas can refer to. The last one of a name counts. Both may be empty.
    void add(const std::u16string& name, std::optional<Given> given, const std::u16string& expression);
    // Once all are there.
    void evaluateAll();

    // Null when there is none of that name.
    const Number* find(const std::u16string& name) const;
    // The user says that it has this value, or none. What follows from it is evaluated anew.
    void setValue(const std::u16string& name, std::optional<Given> given);

  private:
    static void give(Number& number, std::optional<Given> given);
    void findNeeds(std::size_t index);
    std::vector<std::size_t> neededFirst() const;
    void findCircles();
    std::vector<std::size_t> followersOf(std::size_t index) const;
    void evaluate(const std::vector<std::size_t>& pending);
    void compute(Number& number);

    std::vector<Number> numbers_;
    std::map<std::u16string, std::size_t> places_;
    MathExpressionParser parser_;
};

}  // namespace plume
