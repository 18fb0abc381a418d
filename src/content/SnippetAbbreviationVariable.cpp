#include "content/SnippetAbbreviationVariable.h"

#include "library/SnippetUtils.h"

namespace plume {

SnippetAbbreviationVariable::SnippetAbbreviationVariable(const VariableParams& params)
    : SnippetVariable(params), abbreviation(textParam(params, u"snippet")), uuid(textParam(params, u"uuid")) {}

std::u16string SnippetAbbreviationVariable::toString() const {
    BodyWriter writer;
    writer.param(u"snippet", abbreviation.value_or(std::u16string()));
    writer.paramIfSet(u"uuid", uuid);
    if (isOptional) writer.part(SnippetVariable::toString());
    return writer.take();
}

std::shared_ptr<Snippet> findSnippetBySnippetAbbreviationVariable(
    const SnippetAbbreviationVariable& variable, const Snippet& snippet,
    const std::vector<std::shared_ptr<SnippetGroup>>& groups) {
    const std::optional<std::u16string>& abbreviation = variable.abbreviation;
    std::shared_ptr<Snippet> found;
    if (variable.uuid) {
        found = SnippetUtils::findSnippetByUUID(*variable.uuid, groups);
    } else if (abbreviation) {
        found = SnippetUtils::findSnippetByAbbreviation(*abbreviation, groups, true);
    }
    if (found || !abbreviation) return found;
    if (const auto ownGroup = snippet.parentGroup()) found = ownGroup->findSnippetWithAbbreviation(*abbreviation);
    return found ? found : SnippetUtils::findSnippetByAbbreviation(*abbreviation, groups);
}

}  // namespace plume
