#include "app/FormText.h"

#include <algorithm>

#include "library/Snippet.h"

namespace plume {

FormText::FormText(const SnippetExpandedContent& content)
    : isScript_(content.originalSnippet && content.originalSnippet->isScript()) {
    if (!isScript_) read(content);
}

// Along the list, as fields are merged and scripts are cut out. What a script holds belongs to its source.
void FormText::read(const SnippetExpandedContent& content) {
    const std::u16string_view all = content.string();
    std::size_t position = 0;
    std::size_t scriptsEnd = 0;
    std::size_t lastInner = 0;  // up to here in the list, counted from 1, what is listed stands in a script
    std::size_t field = 0;
    const auto copyTo = [&](std::size_t location) {
        const std::size_t end = std::min(location, all.size());
        if (end > position) text_ += all.substr(position, end - position);
        position = std::max(position, end);
    };
    for (std::size_t index = 0; index < content.variables.size(); ++index) {
        const auto& variable = content.variables[index];
        const bool isInScript = index + 1 <= lastInner || variable->location < scriptsEnd;
        if (dynamic_cast<const SnippetFieldVariable*>(variable.get()) != nullptr) {
            if (!isInScript) {
                copyTo(variable->location);
                values_.push_back({text_.size(), field});
            }
            ++field;
        } else if (auto script = std::dynamic_pointer_cast<SnippetAbbreviationVariable>(variable)) {
            lastInner = std::max(lastInner, index + 1 + script->innerVariables);
            scriptsEnd = std::max(scriptsEnd, script->location + script->scriptLength);
            copyTo(script->location);
            position = std::max(position, std::min(scriptsEnd, all.size()));
            if (!isInScript) scripts_.push_back(std::move(script));
        }
    }
    copyTo(all.size());
}

std::u16string FormText::with(const std::function<std::u16string_view(std::size_t field)>& valueOf) const {
    std::u16string text;
    std::size_t position = 0;
    for (const Value& value : values_) {
        text.append(text_, position, value.location - position).append(valueOf(value.field));
        position = value.location;
    }
    return text.append(text_, position);
}

}  // namespace plume
