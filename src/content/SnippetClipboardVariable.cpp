#include "content/SnippetClipboardVariable.h"

namespace plume {

SnippetClipboardVariable::SnippetClipboardVariable(const VariableParams& params)
    : SnippetVariable(params), find(textParam(params, u"find")), replacement(textParam(params, u"replacement")) {
    const std::int64_t flags = integerParam(params, u"flags");
    regularExpressions = (flags & 1) != 0;
    matchingOption = static_cast<MatchingOption>((flags >> 1) & 3);
    matchCase = (flags & 8) != 0;
}

std::u16string SnippetClipboardVariable::toString() const {
    BodyWriter writer;
    writer.part(u"clipboard");
    writer.paramIfSet(u"find", find);
    writer.paramIfSet(u"replacement", replacement);
    writer.param(u"flags",
                 (regularExpressions ? 1 : 0) + 2 * static_cast<std::int64_t>(matchingOption) + (matchCase ? 8 : 0));
    if (isOptional) writer.part(SnippetVariable::toString());
    return writer.take();
}

}  // namespace plume
