// The text that a form delivers, without what scripts say: as long as it would be with the values of now.
//
// Owned by the form, and independent of the content once made; one thread at a time has it.
#pragma once

#include <cstddef>
#include <functional>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

#include "content/SnippetExpandedContent.h"

namespace plume {

class FormText {
  public:
    using Scripts = std::vector<std::shared_ptr<SnippetAbbreviationVariable>>;

    explicit FormText(const SnippetExpandedContent& content);

    // `valueOf` says what the field with this index delivers.
    std::u16string with(const std::function<std::u16string_view(std::size_t field)>& valueOf) const;
    // All of it is a script.
    bool isScript() const { return isScript_; }
    // Those that lie in no other.
    const Scripts& scripts() const { return scripts_; }

  private:
    struct Value {
        std::size_t location;  // in `text_`
        std::size_t field;
    };

    void read(const SnippetExpandedContent& content);

    std::u16string text_;  // without the fields' values and the scripts' sources
    std::vector<Value> values_;
    Scripts scripts_;
    bool isScript_ = false;
};

}  // namespace plume
