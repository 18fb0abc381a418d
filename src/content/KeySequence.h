// In which order the text of a content and the keys in it are delivered.
#pragma once

#include <cstddef>
#include <memory>
#include <vector>

#include "Foundation/Strings.h"
#include "content/SnippetVariable.h"

namespace plume {

// A stretch of the text, which may be empty, and the key behind it; null behind the last one.
struct DeliveryStep {
    Range text;
    std::shared_ptr<SnippetKeyVariable> key;
};

// A key located before its predecessor brings the text back to its place, so that what follows is delivered again.
// What is delivered again has an end: beyond SnippetParser::MaximumLength units in all, keys come without text.
std::vector<DeliveryStep> deliverySteps(const std::vector<std::shared_ptr<SnippetKeyVariable>>& keys,
                                        std::size_t textLength);

bool isArrowKey(const SnippetKeyVariable& key);
bool isReturnOrTab(const SnippetKeyVariable& key);
// Return, Tab and the keypad's Enter: one press is one place for the caret.
bool movesCaret(const SnippetKeyVariable& key);

}  // namespace plume
