// One delivery order from the engine to the input service.
#pragma once

#include <cstdint>
#include <memory>
#include <string>
#include <variant>
#include <vector>

#include "content/SnippetExpandedContent.h"

namespace plume {

struct ContextInputSetting;

// Why an output is made: a set of bits.
namespace SnippetTrigger {
inline constexpr std::uint32_t Direct = 1;
inline constexpr std::uint32_t Typed = 2;
inline constexpr std::uint32_t Suggestion = 4;
inline constexpr std::uint32_t Digit = 8;
inline constexpr std::uint32_t FromSeveralMatches = 16;
inline constexpr std::uint32_t ScriptResult = 32;
inline constexpr std::uint32_t HotKey = 64;
}  // namespace SnippetTrigger

class PLOutput {
  public:
    // A piece of the delivery: text, or a key to press.
    using Fragment = std::variant<std::u16string, AttributedString, std::shared_ptr<SnippetKeyVariable>>;

    std::shared_ptr<const ContextInputSetting> contextInputSetting;
    std::uint32_t trigger = 0;
    bool cancelTrigger = false;  // the triggering key is not passed on
    std::uint64_t backspaceCount = 0;
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
