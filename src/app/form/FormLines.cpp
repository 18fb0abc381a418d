#include "app/form/FormLines.h"

#include <unicode/utf16.h>

#include <algorithm>
#include <memory>
#include <utility>

#include "Foundation/Strings.h"
#include "library/Snippet.h"

namespace plume {

namespace {

// A text up to here is shown whole.
constexpr std::size_t LongText = 20'000;
constexpr std::size_t ManyLines = 300;
// Of a longer one: so many lines before and behind one with a field, and so much of what stands between two fields.
constexpr std::size_t LinesNearField = 4;
constexpr std::size_t UnitsNearField = 300;

class LineMaker {
  public:
    explicit LineMaker(const SnippetExpandedContent& content) : content_(content), fields_(content.fields()) {}

    std::vector<FormLine> make() {
        for (const auto& variable : content_.variables) {
            if (std::dynamic_pointer_cast<SnippetFieldVariable>(variable)) {
                addTextTo(variable->location);
                add({FormPiece::Kind::Field, {}, variable->attributes, fieldCount_++});
            } else if (const auto script = std::dynamic_pointer_cast<SnippetAbbreviationVariable>(variable)) {
                if (script->scriptLength > 0) addScript(*script);
            }
        }
        addTextTo(content_.string().size());
        return std::move(lines_);
    }

  private:
    void add(FormPiece piece) { lines_.back().push_back(std::move(piece)); }

    void addScript(const SnippetAbbreviationVariable& script) {
        addTextTo(script.location);
        std::u16string name = script.snippet ? script.snippet->label().value_or(u"") : u"";
        if (name.empty()) name = script.snippet ? script.snippet->abbreviation().value_or(u"") : u"";
        // The box of an optional script has its name already.
        if (!hasBoxOf(script)) add({FormPiece::Kind::Script, std::move(name), script.attributes, 0});
        position_ = std::max(position_, script.location + script.scriptLength);
    }

    bool hasBoxOf(const SnippetAbbreviationVariable& script) const {
        const FormLine& line = lines_.back();
        if (line.empty() || line.back().kind != FormPiece::Kind::Field) return false;
        return fields_[line.back().field]->script.get() == &script;
    }

    // A field in a script's source stands behind the script's name, which is where the source would end.
    void addTextTo(std::size_t end) {
        end = std::min(end, content_.string().size());
        while (position_ < end) {
            const std::size_t runEnd = std::min(end, endOfRun(position_));
            addRun(std::u16string_view(content_.string()).substr(position_, runEnd - position_));
            position_ = runEnd;
        }
    }

    std::size_t endOfRun(std::size_t position) {
        const auto* rich = std::get_if<AttributedString>(&content_.content);
        if (!rich) return content_.string().size();
        while (runStart_ + rich->runs()[run_].length <= position) runStart_ += rich->runs()[run_++].length;
        attributes_ = rich->runs()[run_].attributes;
        return runStart_ + rich->runs()[run_].length;
    }

    void addRun(std::u16string_view text) {
        while (!text.empty()) {
            const std::size_t lineEnd = std::min(text.find_first_of(u"\r\n\u2028\u2029"), text.size());
            if (lineEnd > 0) add({FormPiece::Kind::Text, std::u16string(text.substr(0, lineEnd)), attributes_, 0});
            text.remove_prefix(lineEnd);
            if (text.empty()) return;
            text.remove_prefix(text.starts_with(u"\r\n") ? 2 : 1);
            lines_.emplace_back();
        }
    }

    const SnippetExpandedContent& content_;
    const std::vector<std::shared_ptr<SnippetFieldVariable>> fields_;
    std::vector<FormLine> lines_{FormLine()};
    std::size_t position_ = 0;
    std::size_t fieldCount_ = 0;
    std::size_t run_ = 0;
    std::size_t runStart_ = 0;
    SharedAttributes attributes_;  // of the run that position_ lies in
};

const FormPiece OmittedPiece{FormPiece::Kind::Omitted, u"…", nullptr, 0};

bool hasField(const FormLine& line) {
    return std::ranges::any_of(line, [](const FormPiece& piece) { return piece.kind == FormPiece::Kind::Field; });
}

// Not between the halves of a character.
std::size_t cutBefore(const std::u16string& text, std::size_t index) {
    return index > 0 && U16_IS_TRAIL(text[index]) ? index - 1 : index;
}

FormPiece textPiece(const FormPiece& whole, std::u16string text) {
    return {FormPiece::Kind::Text, std::move(text), whole.attributes, 0};
}

// The end of a text that stands before a field, the beginning of one behind it, and both of one between two.
FormLine shortened(const FormLine& line) {
    FormLine result;
    for (std::size_t index = 0; index < line.size(); ++index) {
        const FormPiece& piece = line[index];
        if (piece.kind != FormPiece::Kind::Text || piece.text.size() <= 2 * UnitsNearField) {
            result.push_back(piece);
            continue;
        }
        const bool isLast = index + 1 == line.size();
        if (index > 0 || isLast) {
            result.push_back(textPiece(piece, piece.text.substr(0, cutBefore(piece.text, UnitsNearField))));
        }
        result.push_back(OmittedPiece);
        if (!isLast) {
            const std::size_t start = cutBefore(piece.text, piece.text.size() - UnitsNearField);
            result.push_back(textPiece(piece, piece.text.substr(start)));
        }
    }
    return result;
}

std::vector<FormLine> nearFields(const std::vector<FormLine>& lines) {
    std::vector<bool> isKept(lines.size());
    for (std::size_t index = 0; index < lines.size(); ++index) {
        if (!hasField(lines[index])) continue;
        const std::size_t first = index - std::min(index, LinesNearField);
        const std::size_t end = std::min(index + LinesNearField + 1, lines.size());
        for (std::size_t near = first; near < end; ++near) isKept[near] = true;
    }
    std::vector<FormLine> result;
    for (std::size_t index = 0; index < lines.size(); ++index) {
        if (isKept[index]) {
            result.push_back(shortened(lines[index]));
        } else if (index == 0 || isKept[index - 1]) {
            result.push_back({OmittedPiece});
        }
    }
    return result;
}

}  // namespace

std::vector<FormLine> formLines(const SnippetExpandedContent& content) {
    std::vector<FormLine> lines = LineMaker(content).make();
    const bool isLong = content.string().size() > LongText || lines.size() > ManyLines;
    return isLong ? nearFields(lines) : lines;
}

}  // namespace plume
