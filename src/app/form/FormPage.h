// A form as a page of HTML: the snippet's text with one control for each field, where the field stands.
//
// Pure; from any thread. UTF-8. Nothing that a snippet says is markup here, or runs.
#pragma once

#include <cstddef>
#include <memory>
#include <string>
#include <vector>

#include "app/FormModel.h"
#include "content/SnippetExpandedContent.h"

namespace plume {

class FormPage {
  public:
    using Variables = std::vector<std::shared_ptr<SnippetVariable>>;

    // What goes behind the first "<div>" of the page's template.
    static std::string generateHtml(const SnippetExpandedContent& content, const FormModel& model);
    // The text has colours of its own, which were chosen for black on white.
    static bool needsPaper(const SnippetExpandedContent& content);

    static std::string generateHtmlWithAttributedString(const AttributedString& text, const Variables& variables,
                                                        const std::vector<FormModel::Field>& fields);
    static std::string generateHtmlWithString(const std::u16string& text, const Variables& variables,
                                              const std::vector<FormModel::Field>& fields);
    // The control of one field.
    static std::string generateHtmlTextInput(const FormModel::Field& field, std::size_t fieldIndex);
};

}  // namespace plume
