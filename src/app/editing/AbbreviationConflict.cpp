#include "app/editing/AbbreviationConflict.h"

#include <string>

namespace plume {

namespace {

// Nothing is copied: each of very many snippets is looked at with every letter.
std::u16string_view viewOf(const std::optional<std::u16string>& text) {
    return text ? std::u16string_view(*text) : std::u16string_view();
}

// How the beginning of `typed`, or all of it, is this snippet's abbreviation.
AbbreviationConflict::Kind kindOf(const Snippet& other, std::u16string_view prefix, bool isImmediate,
                                  std::u16string_view typed) {
    const std::u16string_view abbreviation = viewOf(other.abbreviation());
    if (abbreviation.empty() || !typed.starts_with(prefix)) return AbbreviationConflict::Kind::None;
    const std::u16string_view rest = typed.substr(prefix.size());
    if (rest == abbreviation) return AbbreviationConflict::Kind::Same;
    return isImmediate && rest.starts_with(abbreviation) ? AbbreviationConflict::Kind::ExpandsFirst
                                                         : AbbreviationConflict::Kind::None;
}

}  // namespace

AbbreviationConflict conflictOf(const Snippet& snippet, std::u16string_view abbreviation, const SnippetGroups& groups) {
    if (abbreviation.empty()) return {};
    const auto itsGroup = snippet.parentGroup();
    std::u16string typed(itsGroup ? viewOf(itsGroup->abbreviationPrefix()) : std::u16string_view());
    typed += abbreviation;
    AbbreviationConflict found;
    for (const auto& group : groups) {
        const bool isImmediate = group->expandTrigger() == ExpandTrigger::Immediately;
        for (const auto& other : group->items()) {
            if (other.get() == &snippet) continue;
            const auto kind = kindOf(*other, viewOf(group->abbreviationPrefix()), isImmediate, typed);
            if (kind == AbbreviationConflict::Kind::Same) return {kind, other};
            if (kind == AbbreviationConflict::Kind::ExpandsFirst && !found.other) found = {kind, other};
        }
    }
    return found;
}

}  // namespace plume
