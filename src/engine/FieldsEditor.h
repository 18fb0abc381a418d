// The form in which the user fills in the fields of a snippet before it is delivered, as the engine drives it.
//
// Made and owned by the sender, one for each expansion with fields; several may be open. Everything here runs on the
// thread that delivers the key events: a form whose window lives elsewhere hands over to it.
#pragma once

#include <functional>
#include <memory>

#include "content/SnippetExpandedContent.h"

namespace plume {

class FieldsEditor {
  public:
    // Who waits for the form. A form that the user confirms calls both, in either order; one that is closed in another
    // way calls the first alone. The form lives until the call of fieldsEditorWillClose has returned to the run loop.
    class Target {
      public:
        virtual void fieldsEditorWillClose(FieldsEditor& editor) = 0;
        // The fields of the content hold what the user wants.
        virtual void fieldsEditorAction(FieldsEditor& editor) = 0;

      protected:
        ~Target() = default;
    };

    // Makes a form that is not shown yet; never null, never makes null. The target outlives it.
    using Factory =
        std::function<std::unique_ptr<FieldsEditor>(std::shared_ptr<SnippetExpandedContent> content, Target& target)>;

    virtual ~FieldsEditor() = default;

    // Called once, and not from inside the key callback.
    virtual void show() = 0;
    // What is being filled in; never null.
    virtual const std::shared_ptr<SnippetExpandedContent>& content() const = 0;
};

}  // namespace plume
