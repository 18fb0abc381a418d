// How the languages of scripts write words, texts, comments and variables.
#pragma once

#include <span>
#include <string_view>

#include "app/editing/ScriptSyntax.h"

namespace plume {

struct ScriptLanguageRules {
    std::span<const std::u16string_view> keywords = {};  // in order
    std::u16string_view lineComment = {};
    // A comment begins only where a word could: the sign means something else inside of one.
    bool commentsStartWords = false;
    std::u16string_view blockComment = {};  // empty: there are none
    std::u16string_view blockCommentEnd = {};
    std::u16string_view quotes = {};          // what texts begin and end with
    std::u16string_view spanningQuotes = {};  // those whose texts may go on in the next line
    std::u16string_view quotesWithoutEscapes = {};
    bool hasTripleQuotes = false;
    bool hasHereDocuments = false;
    std::u16string_view sigils = {};  // what variables begin with
};

const ScriptLanguageRules& rulesOf(ScriptLanguage language);

}  // namespace plume
