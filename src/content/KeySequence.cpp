#include "content/KeySequence.h"

#include <algorithm>

#include "content/SnippetParser.h"

namespace plume {

std::vector<DeliveryStep> deliverySteps(const std::vector<std::shared_ptr<SnippetKeyVariable>>& keys,
                                        std::size_t textLength) {
    std::vector<DeliveryStep> steps;
    steps.reserve(keys.size() + 1);
    std::size_t left = std::max(SnippetParser::MaximumLength, textLength);
    std::size_t position = 0;
    const auto addUpTo = [&](std::size_t end, std::shared_ptr<SnippetKeyVariable> key) {
        const std::size_t length = std::min(end > position ? end - position : 0, left);
        steps.push_back({{position, length}, std::move(key)});
        left -= length;
        position = end;
    };
    for (const auto& key : keys) addUpTo(std::min(key->location, textLength), key);
    addUpTo(textLength, nullptr);
    return steps;
}

bool isArrowKey(const SnippetKeyVariable& key) {
    return key.keyCode >= KeyCode::Left && key.keyCode <= KeyCode::Up;
}

bool isReturnOrTab(const SnippetKeyVariable& key) {
    return key.keyCode == KeyCode::Return || key.keyCode == KeyCode::Tab;
}

bool movesCaret(const SnippetKeyVariable& key) {
    return isReturnOrTab(key) || key.keyCode == KeyCode::KeypadEnter;
}

}  // namespace plume
