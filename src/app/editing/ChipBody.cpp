#include "app/editing/ChipBody.h"

#include <algorithm>
#include <vector>

#include "content/PlaceholderBody.h"
#include "content/PlaceholderKinds.h"
#include "content/SnippetFieldVariable.h"
#include "content/SnippetKeyVariable.h"

namespace plume {

namespace {

// What a kind reads: what it does not write of these has been taken away by hand, or says nothing.
struct KnownParameters {
    std::u16string_view keyword;
    std::vector<std::u16string_view> names;
};

const std::vector<KnownParameters>& knownParameters() {
    static const std::vector<KnownParameters> all{
        {u"date", {u"valueType", u"year", u"month", u"day", u"weekday", u"locale"}},
        {u"time", {u"hour", u"minute", u"second", u"locale"}},
        {u"clipboard", {u"find", u"replacement", u"flags"}},
        {u"snippet", {u"uuid"}},
        {u"field", {u"type", u"value", u"defaultIndex", u"width", u"height"}},
        {u"key", {u"code", u"count", u"delay", u"modifiers"}},
    };
    return all;
}

bool knows(const VariableParams& written, std::u16string_view name) {
    if (written.contains(name) || name == u"optional" || name == u"readonly") return true;
    return std::any_of(knownParameters().begin(), knownParameters().end(), [&](const KnownParameters& kind) {
        return written.contains(kind.keyword) &&
               std::find(kind.names.begin(), kind.names.end(), name) != kind.names.end();
    });
}

}  // namespace

std::shared_ptr<SnippetVariable> editablePlaceholder(std::u16string_view body) {
    if (auto variable = parseVariable(body)) return variable;
    return std::dynamic_pointer_cast<SnippetKeyVariable>(parseSign(body, 0));
}

std::u16string editedBody(std::u16string_view original, const SnippetVariable& changed) {
    BodyWriter writer;
    const std::u16string body = changed.toString();
    writer.part(body);
    // The kind writes a menu's first choice under a name from which it does not read it.
    const auto* field = dynamic_cast<const SnippetFieldVariable*>(&changed);
    if (field && field->isPopupMenu()) writer.paramUnlessZero(u"defaultIndex", field->defaultIndex);
    if (parseSign(original, 0)) return writer.take();
    const VariableParams written = parseParams(body);
    for (const auto& [name, value] : parseParams(original)) {
        if (knows(written, name)) continue;
        writer.part(value.empty() ? escapeParam(name) : escapeParam(name) + u":" + escapeParam(value));
    }
    return writer.take();
}

}  // namespace plume
