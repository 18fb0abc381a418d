// What happens in the form of a snippet's fields, apart from its drawing: values, ticks, fields that share a name, and
// numbers that follow from each other.
//
// Owned by the form; one thread at a time has it.
#pragma once

#include <cstddef>
#include <memory>
#include <optional>
#include <set>
#include <string>
#include <string_view>
#include <vector>

#include "Foundation/Result.h"
#include "app/DecimalNumbers.h"
#include "app/FormNumbers.h"
#include "app/FormText.h"
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

    using Problem = FormProblem;

    // Numbers are read and written as in the locale; empty: the user's for numbers.
    FormModel(const SnippetExpandedContent& content, const std::string& locale);

    const std::vector<Field>& fields() const { return fields_; }
    // Why the value is not what it seems to be.
    Problem problem(std::size_t index) const;
    // The user types this in place of what stands there, or picks that line. An optional field is ticked by it, fields
    // of the same name follow, and formulas are evaluated anew. The error says why the field does not take it.
    Result<void> fill(std::size_t index, const std::u16string& value);
    void setSelected(std::size_t index, bool selected) { fields_[index].selected = selected; }
    // What would be delivered now, without what scripts say; and how many characters that are, as a user counts them.
    std::u16string text() const;
    std::size_t length() const;
    // Scripts run once the form is accepted, and what they say comes on top of that.
    bool runsScripts() const;
    // A number between the locale's signs and those of programs, which write a point and no grouping; text that is no
    // number stays as it is.
    std::u16string plainNumber(const std::u16string& shown) const;
    std::u16string shownNumber(const std::u16string& plain) const;
    // Hands the values over to the content's fields. One that shows what it began with keeps its rich text.
    void accept() const;

  private:
    void collectNumbers();
    void shareValue(std::size_t index);
    void numberChanged(const Field& field);
    void showNumbers();
    std::optional<FormNumbers::Given> givenNumber(const std::u16string& text) const;
    const FormNumbers::Number* numberOf(const Field& field) const;
    std::u16string_view deliveredValue(const Field& field) const;

    bool isRich_;
    DecimalNumbers decimals_;
    FormText text_;
    std::vector<Field> fields_;
    FormNumbers numbers_;
    // Fields with a formula that nobody evaluates, as their names cannot stand in formulas.
    std::set<std::size_t> uncomputed_;
};

}  // namespace plume
