// The clipboard's content, after find-and-replace (ClipboardReplacement.h).
#pragma once

#include <cstdint>

#include "content/SnippetVariable.h"

namespace plume {

class SnippetClipboardVariable final : public SnippetVariable {
  public:
    enum class MatchingOption : std::int32_t { Anywhere = 0, WordStart = 1, WholeWord = 2, WordEnd = 3 };

    SnippetClipboardVariable() = default;
    explicit SnippetClipboardVariable(const VariableParams& params);
    std::u16string toString() const override;

    Text find;
    Text replacement;
    bool regularExpressions = false;
    MatchingOption matchingOption = MatchingOption::Anywhere;
    bool matchCase = false;
};

}  // namespace plume
