// One delivery order from the engine to the input service.
#pragma once

#include <cstdint>
#include <memory>
#include <optional>
#include <string>
#include <variant>
#include <vector>

#include "content/SnippetExpandedContent.h"
#include "content/SnippetTrigger.h"

namespace plume {

struct ContextInputSetting;

class PLOutput {
  public:
    // A piece of the delivery: text, or a key to press.
    using Fragment = std::variant<std::u16string, AttributedString, std::shared_ptr<SnippetKeyVariable>>;

    std::shared_ptr<const ContextInputSetting> contextInputSetting;
    SnippetTriggers trigger;
    bool cancelTrigger = false;  // the triggering key is not passed on
    std::uint64_t backspaceCount = 0;
    // What the backspaces erase, where that is known: then the program's way of counting says how many are sent.
    std::optional<std::u16string> erasedText;
    std::uint64_t leftArrowCount = 0;
    std::shared_ptr<SnippetExpandedContent> snippetExpandedContent;  // null: only erase
    std::vector<Fragment> fragments;
    std::uint64_t order = 0;

    // Cuts the content into `fragments` anew.
    void refreshFragments();
    static std::vector<Fragment> fragmentsForPlainTextSnippet(const SnippetExpandedContent& content);
    static std::vector<Fragment> fragmentsForRichTextSnippet(const SnippetExpandedContent& content);
};

}  // namespace plume
