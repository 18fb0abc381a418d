#include "app/editing/ScriptSyntax.h"

#include <algorithm>
#include <optional>

#include "app/editing/ScriptLanguages.h"

namespace plume {

namespace {

constexpr char16_t PlaceholderStart = u'【';
constexpr char16_t PlaceholderEnd = u'】';

constexpr bool isBlank(char16_t c) {
    return c == u' ' || c == u'\t';
}

constexpr bool isDigit(char16_t c) {
    return c >= u'0' && c <= u'9';
}

constexpr bool startsWord(char16_t c) {
    if (c == PlaceholderStart || c == PlaceholderEnd) return false;
    return (c >= u'a' && c <= u'z') || (c >= u'A' && c <= u'Z') || c == u'_' || c >= 0x80;
}

constexpr bool isInWord(char16_t c) {
    return startsWord(c) || isDigit(c);
}

bool holds(std::u16string_view set, char16_t c) {
    return set.find(c) != std::u16string_view::npos;
}

// Finds the same sign again and again from places that go forward, in linear time also where there is none.
class ForwardSearch {
  public:
    ForwardSearch(std::u16string_view line, char16_t sign) : line_(line), sign_(sign) {}

    std::optional<std::size_t> from(std::size_t place) {
        if (!hasLooked_ || next_ < place) next_ = line_.find(sign_, place);
        hasLooked_ = true;
        return next_ == std::u16string_view::npos ? std::nullopt : std::optional(next_);
    }

  private:
    std::u16string_view line_;
    char16_t sign_;
    std::size_t next_ = 0;
    bool hasLooked_ = false;
};

class LineScanner {
  public:
    LineScanner(std::u16string_view line, const ScriptState& before, std::vector<ScriptStretch>& found)
        : line_(line),
          state_(before),
          rules_(rulesOf(before.language)),
          found_(found),
          braces_(line, u'}'),
          sum_(line.find(u"((")) {}

    ScriptState run() {
        goOn();
        while (at_ < line_.size()) step();
        if (hereDocument_) state_ = *hereDocument_;
        findPlaceholders();
        return state_;
    }

  private:
    using Open = ScriptState::Open;

    void add(ScriptToken token, std::size_t start, std::size_t end) {
        if (end > start) found_.push_back({token, {start, end - start}});
    }
    bool isAt(std::u16string_view text) const { return !text.empty() && line_.substr(at_).starts_with(text); }
    char16_t charAt(std::size_t place) const { return place < line_.size() ? line_[place] : u'\0'; }

    void goOn();
    void step();
    bool takeComment();
    void finishBlockComment();
    void startText();
    void finishText();
    void finishTripleText();
    void closeText();
    bool takeVariable();
    std::size_t endOfVariable();
    bool takeHereDocument();
    void takeHereDocumentLine();
    void takeWord();
    void findPlaceholders();

    const std::u16string_view line_;
    ScriptState state_;
    const ScriptLanguageRules& rules_;
    std::vector<ScriptStretch>& found_;
    ForwardSearch braces_;
    const std::size_t sum_;  // where the first one begins
    std::size_t at_ = 0;
    std::optional<ScriptState> hereDocument_;  // that begins below the line
};

// ---- What is open ----

void LineScanner::goOn() {
    switch (state_.open) {
        case Open::Nothing:
            return;
        case Open::Quotes:
            return finishText();
        case Open::TripleQuotes:
            return finishTripleText();
        case Open::BlockComment:
            return finishBlockComment();
        case Open::HereDocument:
            return takeHereDocumentLine();
    }
}

void LineScanner::step() {
    const char16_t c = line_[at_];
    if (takeComment()) return;
    if (holds(rules_.quotes, c)) return startText();
    if (holds(rules_.sigils, c) && takeVariable()) return;
    if (rules_.hasHereDocuments && c == u'<' && takeHereDocument()) return;
    if (isInWord(c)) return takeWord();
    at_ += c == u'\\' ? 2U : 1U;
}

// ---- Comments ----

bool LineScanner::takeComment() {
    if (isAt(rules_.blockComment)) {
        state_.open = Open::BlockComment;
        finishBlockComment();
        return true;
    }
    if (!isAt(rules_.lineComment)) return false;
    if (rules_.commentsStartWords && at_ > 0 && !isBlank(line_[at_ - 1]) && !holds(u";&|(", line_[at_ - 1])) {
        return false;
    }
    add(ScriptToken::Comment, at_, line_.size());
    at_ = line_.size();
    return true;
}

void LineScanner::finishBlockComment() {
    const std::size_t start = at_;
    // Its own first sign is no part of its last one.
    const std::size_t from = line_.substr(at_).starts_with(rules_.blockComment) ? at_ + 2 : at_;
    const std::size_t end = line_.find(rules_.blockCommentEnd, from);
    const bool ends = end != std::u16string_view::npos;
    at_ = ends ? end + rules_.blockCommentEnd.size() : line_.size();
    if (ends) state_.open = Open::Nothing;
    add(ScriptToken::Comment, start, at_);
}

// ---- Texts ----

void LineScanner::startText() {
    state_.quote = line_[at_];
    const std::u16string triple(3, state_.quote);
    const bool isTriple = rules_.hasTripleQuotes && isAt(triple);
    const std::size_t opening = isTriple ? triple.size() : 1;
    add(ScriptToken::String, at_, at_ + opening);
    at_ += opening;
    state_.open = isTriple ? Open::TripleQuotes : Open::Quotes;
    isTriple ? finishTripleText() : finishText();
}

void LineScanner::finishText() {
    const bool hasEscapes = !holds(rules_.quotesWithoutEscapes, state_.quote);
    const bool hasVariables = state_.quote == u'"' && holds(rules_.sigils, u'$');
    std::size_t start = at_;
    bool ends = false;
    while (at_ < line_.size() && !ends) {
        const char16_t c = line_[at_];
        if (hasVariables && c == u'$' && endOfVariable() != at_) {
            add(ScriptToken::String, start, at_);
            takeVariable();
            start = at_;
            continue;
        }
        ends = c == state_.quote;
        at_ += hasEscapes && c == u'\\' ? 2U : 1U;
    }
    at_ = std::min(at_, line_.size());
    add(ScriptToken::String, start, at_);
    if (ends || !holds(rules_.spanningQuotes, state_.quote)) closeText();
}

void LineScanner::finishTripleText() {
    const std::size_t start = at_;
    const std::u16string triple(3, state_.quote);
    while (at_ < line_.size() && !isAt(triple)) at_ += line_[at_] == u'\\' ? 2U : 1U;
    const bool ends = at_ < line_.size();
    at_ = ends ? at_ + triple.size() : line_.size();
    add(ScriptToken::String, start, at_);
    if (ends) closeText();
}

void LineScanner::closeText() {
    state_.open = Open::Nothing;
    state_.quote = 0;
}

// ---- Variables ----

bool LineScanner::takeVariable() {
    const std::size_t end = endOfVariable();
    if (end == at_) return false;
    add(ScriptToken::Variable, at_, end);
    at_ = end;
    return true;
}

// Where it begins when it is none.
std::size_t LineScanner::endOfVariable() {
    std::size_t end = at_ + 1;
    const char16_t next = charAt(end);
    if (line_[at_] == u'$' && next == u'{') {
        const auto brace = braces_.from(end);
        return brace ? *brace + 1 : at_;
    }
    if (line_[at_] == u'$' && (isDigit(next) || holds(u"@*#?$!-", next)) && next != 0) return end + 1;
    if (line_[at_] == u'@' && next == u'@') ++end;
    if (!startsWord(charAt(end))) return at_;
    while (isInWord(charAt(end))) ++end;
    return end;
}

// ---- Here-documents ----

// "<<END", "<<-END", "<<~END", also with the word in quotes. A sum that shifts bits looks like one: those of shells
// stand behind two parentheses.
bool LineScanner::takeHereDocument() {
    if (!isAt(u"<<")) return false;
    if (isAt(u"<<<")) {
        at_ += 3;
        return true;
    }
    std::size_t word = at_ + 2;
    const bool mayBeIndented = charAt(word) == u'-' || charAt(word) == u'~';
    if (mayBeIndented) ++word;
    while (state_.language == ScriptLanguage::Shell && isBlank(charAt(word))) ++word;
    const bool isQuoted = charAt(word) == u'\'' || charAt(word) == u'"' || charAt(word) == u'\\';
    if (isQuoted) ++word;
    std::size_t end = word;
    while (isInWord(charAt(end))) ++end;
    const bool isShift = !isQuoted && !startsWord(charAt(word));
    if (end == word || isShift || sum_ < at_) {
        at_ += 2;
        return true;
    }
    if (!hereDocument_) {
        hereDocument_ = ScriptState{state_.language, Open::HereDocument, 0,
                                    std::u16string(line_.substr(word, end - word)), mayBeIndented};
    }
    at_ = isQuoted && charAt(end) == charAt(word - 1) ? end + 1 : end;
    return true;
}

void LineScanner::takeHereDocumentLine() {
    std::u16string_view text = line_;
    while (state_.mayBeIndented && !text.empty() && isBlank(text.front())) text.remove_prefix(1);
    if (text == state_.terminator) state_ = ScriptState{state_.language, Open::Nothing, 0, {}, false};
    add(ScriptToken::String, 0, line_.size());
    at_ = line_.size();
}

// ---- Words and placeholders ----

void LineScanner::takeWord() {
    const std::size_t start = at_;
    while (at_ < line_.size() && isInWord(line_[at_])) ++at_;
    const bool isPartOfName = start > 0 && holds(u"-./$\\", line_[start - 1]);
    const std::u16string_view word = line_.substr(start, at_ - start);
    const auto& words = rules_.keywords;
    if (!isPartOfName && std::binary_search(words.begin(), words.end(), word)) add(ScriptToken::Keyword, start, at_);
}

void LineScanner::findPlaceholders() {
    std::size_t start = line_.find(PlaceholderStart);
    while (start != std::u16string_view::npos) {
        const std::size_t end = line_.find(PlaceholderEnd, start);
        if (end == std::u16string_view::npos) return;
        add(ScriptToken::Placeholder, start, end + 1);
        start = line_.find(PlaceholderStart, end);
    }
}

// ---- The language ----

std::u16string_view nextWord(std::u16string_view& text) {
    while (!text.empty() && isBlank(text.front())) text.remove_prefix(1);
    const std::size_t end = std::min(text.find_first_of(u" \t"), text.size());
    const std::u16string_view word = text.substr(0, end);
    text.remove_prefix(end);
    return word;
}

// The program that the line names, without its folder and its version.
std::u16string_view interpreterIn(std::u16string_view line) {
    line.remove_prefix(2);
    std::u16string_view program = nextWord(line);
    program.remove_prefix(program.rfind(u'/') + 1);
    if (program == u"env") {
        do program = nextWord(line);
        while (!program.empty() && (program.front() == u'-' || holds(program, u'=')));
        program.remove_prefix(program.rfind(u'/') + 1);
    }
    while (!program.empty() && (isDigit(program.back()) || program.back() == u'.')) program.remove_suffix(1);
    return program;
}

}  // namespace

ScriptLanguage languageOfScript(std::u16string_view firstLine) {
    if (!firstLine.starts_with(u"#!")) return ScriptLanguage::Shell;
    const std::u16string_view program = interpreterIn(firstLine);
    for (const auto* shell : {u"sh", u"bash", u"dash", u"ash", u"ksh", u"zsh"}) {
        if (program == shell) return ScriptLanguage::Shell;
    }
    if (program == u"python") return ScriptLanguage::Python;
    if (program == u"perl") return ScriptLanguage::Perl;
    if (program == u"ruby") return ScriptLanguage::Ruby;
    if (program == u"node" || program == u"nodejs" || program == u"gjs") return ScriptLanguage::JavaScript;
    return ScriptLanguage::Other;
}

ScriptState scanScriptLine(std::u16string_view line, const ScriptState& before, std::vector<ScriptStretch>& found) {
    return LineScanner(line, before, found).run();
}

std::u16string indentBelow(std::u16string_view line, ScriptLanguage language) {
    const std::size_t text = std::min(line.find_first_not_of(u" \t"), line.size());
    std::u16string indent(line.substr(0, text));
    line.remove_prefix(text);
    while (!line.empty() && isBlank(line.back())) line.remove_suffix(1);
    std::size_t word = line.size();
    while (word > 0 && isInWord(line[word - 1])) --word;
    const std::u16string_view last = line.substr(word);
    const bool opensShellBlock =
        language == ScriptLanguage::Shell && (last == u"then" || last == u"do" || last == u"else");
    const bool opens = !line.empty() && (holds(u"{([", line.back()) || opensShellBlock ||
                                         (language == ScriptLanguage::Python && line.back() == u':'));
    // In the way in which the line itself is indented.
    if (opens) indent += indent.starts_with(u' ') ? u"    " : u"\t";
    return indent;
}

}  // namespace plume
