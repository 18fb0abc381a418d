// A placeholder of the content language, at a place in the expanded content.
//
// One base, and one class and header for each kind (PlaceholderKinds.cpp lists them). Made from a placeholder's
// parameters and written back by toString, both without the markers around the body. Shared by std::shared_ptr between
// the content and the form. Belongs to the thread that sends.
#pragma once

#include <cstddef>
#include <optional>
#include <string>

#include "Foundation/text/AttributedString.h"
#include "content/PlaceholderBody.h"

namespace plume {

class SnippetVariable {
  public:
    using Text = std::optional<std::u16string>;

    SnippetVariable() = default;
    explicit SnippetVariable(const VariableParams& params);
    virtual ~SnippetVariable() = default;

    // The body that makes this placeholder again, as far as the kind allows it.
    virtual std::u16string toString() const;
    virtual bool canSetReadonly() const { return true; }

    std::size_t location = 0;  // index into the expanded content
    bool isOptional = false;
    bool isSelected = false;
    bool isReadonly = false;
    SharedAttributes attributes;  // in rich text: those of the opening marker
};

// The place where the text cursor is to stand after delivery.
class SnippetContentCaret final : public SnippetVariable {
  public:
    std::u16string toString() const override;
};

}  // namespace plume
