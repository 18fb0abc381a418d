#include "app/editing/ScriptLanguages.h"

#include <array>

namespace plume {

namespace {

constexpr auto ShellWords = std::to_array<std::u16string_view>(
    {u"break",    u"case",  u"cd",   u"continue", u"do",     u"done",   u"echo",     u"elif",
     u"else",     u"esac",  u"eval", u"exec",     u"exit",   u"export", u"fi",       u"for",
     u"function", u"if",    u"in",   u"local",    u"printf", u"read",   u"readonly", u"return",
     u"set",      u"shift", u"then", u"trap",     u"unset",  u"until",  u"while"});

constexpr auto PythonWords = std::to_array<std::u16string_view>(
    {u"False",  u"None",     u"True",   u"and", u"as",    u"assert", u"async",  u"await",    u"break", u"case",
     u"class",  u"continue", u"def",    u"del", u"elif",  u"else",   u"except", u"finally",  u"for",   u"from",
     u"global", u"if",       u"import", u"in",  u"is",    u"lambda", u"match",  u"nonlocal", u"not",   u"or",
     u"pass",   u"raise",    u"return", u"try", u"while", u"with",   u"yield"});

constexpr auto PerlWords = std::to_array<std::u16string_view>(
    {u"and",     u"cmp",    u"die",   u"do",      u"each",   u"else",      u"elsif", u"eq",   u"exit",    u"for",
     u"foreach", u"ge",     u"gt",    u"if",      u"join",   u"keys",      u"last",  u"le",   u"local",   u"lt",
     u"map",     u"my",     u"ne",    u"next",    u"no",     u"not",       u"or",    u"our",  u"package", u"print",
     u"printf",  u"push",   u"redo",  u"require", u"return", u"say",       u"shift", u"sort", u"split",   u"sub",
     u"undef",   u"unless", u"until", u"use",     u"values", u"wantarray", u"warn",  u"while"});

constexpr auto RubyWords = std::to_array<std::u16string_view>(
    {u"BEGIN",   u"END",    u"alias", u"and",    u"begin", u"break",  u"case",  u"class", u"def",
     u"defined", u"do",     u"else",  u"elsif",  u"end",   u"ensure", u"false", u"for",   u"if",
     u"in",      u"module", u"next",  u"nil",    u"not",   u"or",     u"puts",  u"raise", u"redo",
     u"require", u"rescue", u"retry", u"return", u"self",  u"super",  u"then",  u"true",  u"undef",
     u"unless",  u"until",  u"when",  u"while",  u"yield"});

constexpr auto JavaScriptWords = std::to_array<std::u16string_view>(
    {u"async",   u"await",     u"break",  u"case",   u"catch",  u"class",      u"const", u"continue", u"debugger",
     u"default", u"delete",    u"do",     u"else",   u"export", u"extends",    u"false", u"finally",  u"for",
     u"from",    u"function",  u"if",     u"import", u"in",     u"instanceof", u"let",   u"new",      u"null",
     u"of",      u"return",    u"static", u"super",  u"switch", u"this",       u"throw", u"true",     u"try",
     u"typeof",  u"undefined", u"var",    u"void",   u"while",  u"with",       u"yield"});

constexpr auto AppleScriptWords = std::to_array<std::u16string_view>(
    {u"and", u"as",       u"by",    u"considering", u"contains", u"copy",     u"div",    u"do",     u"else",
     u"end", u"error",    u"every", u"exit",        u"false",    u"first",    u"from",   u"get",    u"global",
     u"if",  u"ignoring", u"in",    u"is",          u"it",       u"last",     u"local",  u"me",     u"mod",
     u"my",  u"not",      u"of",    u"on",          u"or",       u"property", u"repeat", u"return", u"script",
     u"set", u"shell",    u"tell",  u"the",         u"then",     u"through",  u"times",  u"to",     u"true",
     u"try", u"until",    u"while", u"with",        u"without"});

constexpr ScriptLanguageRules ShellRules{.keywords = ShellWords,
                                         .lineComment = u"#",
                                         .commentsStartWords = true,
                                         .quotes = u"\"'",
                                         .spanningQuotes = u"\"'",
                                         .quotesWithoutEscapes = u"'",
                                         .hasHereDocuments = true,
                                         .sigils = u"$"};
constexpr ScriptLanguageRules PythonRules{
    .keywords = PythonWords, .lineComment = u"#", .quotes = u"\"'", .hasTripleQuotes = true};
// Patterns may hold a single quote: texts end with their lines.
constexpr ScriptLanguageRules PerlRules{.keywords = PerlWords,
                                        .lineComment = u"#",
                                        .commentsStartWords = true,
                                        .quotes = u"\"'`",
                                        .hasHereDocuments = true,
                                        .sigils = u"$@%"};
constexpr ScriptLanguageRules RubyRules{.keywords = RubyWords,
                                        .lineComment = u"#",
                                        .commentsStartWords = true,
                                        .quotes = u"\"'`",
                                        .hasHereDocuments = true,
                                        .sigils = u"$@"};
constexpr ScriptLanguageRules JavaScriptRules{.keywords = JavaScriptWords,
                                              .lineComment = u"//",
                                              .blockComment = u"/*",
                                              .blockCommentEnd = u"*/",
                                              .quotes = u"\"'`",
                                              .spanningQuotes = u"`"};
constexpr ScriptLanguageRules AppleScriptRules{.keywords = AppleScriptWords,
                                               .lineComment = u"--",
                                               .blockComment = u"(*",
                                               .blockCommentEnd = u"*)",
                                               .quotes = u"\"",
                                               .spanningQuotes = u"\""};
constexpr ScriptLanguageRules OtherRules{.lineComment = u"#", .commentsStartWords = true, .quotes = u"\""};

}  // namespace

const ScriptLanguageRules& rulesOf(ScriptLanguage language) {
    switch (language) {
        case ScriptLanguage::Shell:
            return ShellRules;
        case ScriptLanguage::Python:
            return PythonRules;
        case ScriptLanguage::Perl:
            return PerlRules;
        case ScriptLanguage::Ruby:
            return RubyRules;
        case ScriptLanguage::JavaScript:
            return JavaScriptRules;
        case ScriptLanguage::AppleScript:
            return AppleScriptRules;
        case ScriptLanguage::Other:
            return OtherRules;
    }
    return OtherRules;
}

}  // namespace plume
