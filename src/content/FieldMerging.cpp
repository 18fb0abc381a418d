#include "content/FieldMerging.h"

#include <algorithm>
#include <utility>
#include <vector>

#include "content/ContentRewriter.h"

namespace plume {

namespace {

using Fields = std::vector<std::shared_ptr<SnippetFieldVariable>>;

void emptyUnusedFields(const Fields& fields) {
    for (const auto& field : fields) {
        if (field->script) {
            field->script->isSelected = field->isSelected;
            field->value = u"";
        }
        if (!field->value || (field->isOptional && !field->isSelected)) field->value = u"";
    }
}

bool isLocatedBefore(const std::shared_ptr<SnippetFieldVariable>& a, const std::shared_ptr<SnippetFieldVariable>& b) {
    return a->location < b->location;
}

void appendValue(ContentRewriter& rewriter, const SnippetFieldVariable& field) {
    if (rewriter.isRich() && field.richTextValue) {
        rewriter.append(*field.richTextValue);
    } else {
        rewriter.append(*field.value, field.attributes);
    }
}

std::size_t lengthOfValue(const SnippetFieldVariable& field, bool isRich) {
    return isRich && field.richTextValue ? field.richTextValue->length() : field.value->size();
}

// As if each value were put in at its field's location, from the last field to the first. Fields in ascending order,
// as parsing yields them, take one pass over the content.
void insertValues(SnippetExpandedContent& content, const Fields& fields) {
    auto end = fields.end();
    while (end != fields.begin()) {
        auto start = end - 1;
        while (start != fields.begin() && !isLocatedBefore(*start, *(start - 1))) --start;
        ContentRewriter rewriter(content.content);
        for (auto field = start; field != end; ++field) {
            rewriter.copyTo((*field)->location);
            appendValue(rewriter, **field);
        }
        content.setContent(rewriter.finish());
        end = start;
    }
}

// Moves what is listed behind a field on by the length of its value, and lengthens the scripts that it lies in.
void moveVariables(const SnippetExpandedContent& content, bool fieldsAscend) {
    struct Script {
        SnippetAbbreviationVariable* variable;
        std::size_t lastInner;  // in the list: what stands at its end and is listed up to here lies in it
    };
    std::size_t shift = 0;
    std::vector<Script> scripts;  // that a further field may lie in
    for (std::size_t index = 0; index < content.variables.size(); ++index) {
        SnippetVariable& variable = *content.variables[index];
        const auto* field = dynamic_cast<const SnippetFieldVariable*>(&variable);
        if (field == nullptr) {
            variable.location += shift;
            if (auto* script = dynamic_cast<SnippetAbbreviationVariable*>(&variable)) {
                scripts.push_back({script, index + script->innerVariables});
            }
            continue;
        }
        const std::size_t place = field->location + shift;
        const std::size_t length = lengthOfValue(*field, content.isRich());
        const auto endsBefore = [place, index](const Script& script) {
            return script.lastInner < index && script.variable->location + script.variable->scriptLength <= place;
        };
        if (fieldsAscend) std::erase_if(scripts, endsBefore);
        for (const Script& script : scripts) {
            if (!endsBefore(script)) script.variable->scriptLength += length;
        }
        shift += length;
    }
}

}  // namespace

void mergeFields(SnippetExpandedContent& content) {
    const Fields fields = content.fields();
    emptyUnusedFields(fields);
    insertValues(content, fields);
    moveVariables(content, std::is_sorted(fields.begin(), fields.end(), isLocatedBefore));
}

}  // namespace plume
