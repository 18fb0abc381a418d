#include "tests/content/world/InPlaceModel.h"

#include <utility>

#include "content/ClipboardReplacement.h"
#include "content/PlaceholderKinds.h"
#include "content/SnippetAbbreviationVariable.h"
#include "content/SnippetDateTimeVariable.h"
#include "library/Snippet.h"

namespace plume {

namespace {

template <class Variable>
std::shared_ptr<Variable> as(const std::shared_ptr<SnippetVariable>& variable) {
    return std::dynamic_pointer_cast<Variable>(variable);
}

std::size_t putIn(InPlaceExpansion& expansion, const Range& range, const std::u16string& value) {
    expansion.text.replace(range.location, range.length, value);
    return range.location + value.size();
}

struct Value {
    std::optional<std::u16string> text;
    std::optional<AttributedString> richText = std::nullopt;
};

std::size_t putInField(InPlaceExpansion& expansion, const Range& range, const SnippetVariable& variable, Value value,
                       bool isReadonly = false) {
    auto field = std::make_shared<SnippetFieldVariable>();
    field->location = range.location;
    field->isOptional = variable.isOptional;
    field->isSelected = variable.isSelected;
    field->isReadonly = isReadonly;
    field->value = std::move(value.text);
    field->richTextValue = std::move(value.richText);
    expansion.variables.push_back(field);
    return putIn(expansion, range, u"");
}

std::size_t putInVariable(InPlaceExpansion& expansion, const Range& range,
                          const std::shared_ptr<SnippetVariable>& variable) {
    expansion.variables.push_back(variable);
    return putIn(expansion, range, u"");
}

}  // namespace

std::optional<InPlaceExpansion> InPlaceModel::expand() {
    InPlaceExpansion expansion = expand(*snippet_->plainTextContent());
    if (left_ == 0) return std::nullopt;
    return expansion;
}

InPlaceExpansion InPlaceModel::expand(const std::u16string& text) {
    InPlaceExpansion expansion{text, {}};
    std::size_t i = 0;
    while (i < expansion.text.size() && left_ > 0) {
        const std::size_t closing = expansion.text.find(u'\u3011', i);
        if (expansion.text[i] != u'\u3010' || closing == std::u16string::npos) {
            ++i;
        } else {
            i = replace(expansion, {i, closing + 1 - i});
        }
    }
    return expansion;
}

std::size_t InPlaceModel::replace(InPlaceExpansion& expansion, const Range& range) {
    const std::u16string body = expansion.text.substr(range.location + 1, range.length - 2);
    const std::u16string arrows = u"\u25C0\u25B2\u25B6\u25BC";
    const KeyCode arrowCodes[] = {KeyCode::Left, KeyCode::Up, KeyCode::Right, KeyCode::Down};
    const auto variable = parseVariable(body);
    const bool isArrow = body.size() == 1 && arrows.find(body) != std::u16string::npos;
    if (!variable && body != u"|" && !isArrow) return range.end();
    --left_;
    if (isArrow) {
        const std::size_t number = arrows.find(body);
        auto key = std::make_shared<SnippetKeyVariable>(body, arrowCodes[number]);
        key->location = number;
        return putInVariable(expansion, range, key);
    }
    if (!variable) {
        auto caret = std::make_shared<SnippetContentCaret>();
        caret->location = range.location;
        return putInVariable(expansion, range, caret);
    }
    variable->location = range.location;
    if (const auto moment = as<SnippetDateTimeVariable>(variable)) {
        const std::u16string value = moment->value(environment_);
        return moment->isOptional && optionalDatesBecomeFields ? putInField(expansion, range, *moment, {value})
                                                               : putIn(expansion, range, value);
    }
    if (const auto clipboard = as<SnippetClipboardVariable>(variable)) {
        auto value = environment_.pasteboard->string();
        if (value) value = processClipboardVariable(*clipboard, *value, environment_, patternTimeLeft_);
        return clipboard->isOptional ? putInField(expansion, range, *clipboard, {value}, true)
                                     : putIn(expansion, range, value.value_or(u""));
    }
    if (const auto nested = as<SnippetAbbreviationVariable>(variable)) {
        return replaceByNested(expansion, range, nested);
    }
    return putInVariable(expansion, range, variable);
}

std::size_t InPlaceModel::replaceByNested(InPlaceExpansion& expansion, const Range& range,
                                          const std::shared_ptr<SnippetAbbreviationVariable>& variable) {
    const auto nested = findSnippetBySnippetAbbreviationVariable(*variable, *snippet_, groups_);
    if (!nested || nested == snippet_) return putIn(expansion, range, u"");
    const auto content = nested->plainTextContent();
    if (variable->isOptional && nested->isSimpleSnippet() && !nested->isScript()) {
        auto richValue = snippet_->contentType() == ContentType::RichText ? nested->richTextContent() : std::nullopt;
        return putInField(expansion, range, *variable, {content, std::move(richValue)});
    }
    if (!nested->isScript()) {
        putIn(expansion, range, content.value_or(u""));
        return range.location;
    }
    if (variable->isOptional) putInField(expansion, {range.location, 0}, *variable, {nested->abbreviation()}, true);
    const bool before = std::exchange(optionalDatesBecomeFields, true);
    InPlaceExpansion script = expand(content.value_or(u""));
    optionalDatesBecomeFields = before;
    variable->scriptLength = script.text.size();
    expansion.variables.push_back(variable);
    for (const auto& inner : script.variables) {
        inner->location += range.location;
        expansion.variables.push_back(inner);
    }
    return putIn(expansion, range, script.text);
}

}  // namespace plume
