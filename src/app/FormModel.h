// What happens in the form of a snippet's fields, apart from its drawing: values, ticks, fields that share a name, and
// numbers that follow from each other.
//
// Owned by the form; one thread at a time has it.
#pragma once

#include <cstddef>
#include <map>
#include <memory>
#include <optional>
#include <set>
#include <string>
#include <vector>

#include "Foundation/Result.h"
#include "content/MathExpressionParser.h"
#include "content/SnippetExpandedContent.h"

namespace plume {

class FormModel {
  public:
    // One field as the form shows it.
    struct Field {
        std::shared_ptr<SnippetFieldVariable> variable;
        std::u16string value;                 // of a pop-up menu: the line that it shows
        std::vector<std::u16string> choices;  // the lines of a pop-up menu
        bool selected = false;

        bool isReadonly() const { return variable->isReadonly && variable->canSetReadonly(); }
        bool hasControl() const;
    };

    // Numbers are read and written as in the locale; empty: the user's for numbers.
    FormModel(const SnippetExpandedContent& content, std::string locale);

    const std::vector<Field>& fields() const { return fields_; }
    // The user types this in place of what stands there, or picks that line. An optional field is ticked by it, fields
    // of the same name follow, and formulas are evaluated anew. The error says why the field does not take it.
    Result<void> fill(std::size_t index, const std::u16string& value);
    void setSelected(std::size_t index, bool selected) { fields_[index].selected = selected; }
    // Hands the values over to the content's fields. One that shows what it began with keeps its rich text.
    void accept() const;

  private:
    // A number that other fields can refer to by its field's name.
    struct Number {
        std::optional<double> value;
        std::u16string expression;
        std::set<std::u16string> dependedVariableNames;
    };

    void collectNumbers();
    void findDependencies();
    void evaluate(std::set<std::u16string> pending);
    void numberChanged(const Field& field);
    void showNumbers();

    std::optional<double> numberIn(const std::u16string& text) const;
    std::u16string textOf(double number) const;

    std::string locale_;
    std::vector<Field> fields_;
    std::map<std::u16string, Number> numbers_;
    MathExpressionParser parser_;
};

}  // namespace plume
