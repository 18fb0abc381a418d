#include "import/TextExpanderFields.h"

#include <algorithm>
#include <array>
#include <vector>

#include "Foundation/Strings.h"
#include "content/PlaceholderBody.h"
#include "content/SnippetFieldVariable.h"

namespace plume {

namespace {

using View = std::u16string_view;
using Text = std::u16string;

struct Parameters {
    Text name;
    Text initial;  // "default"
    bool hasInitial = false;
    std::int64_t width = 0;
    std::int64_t height = 0;
    std::vector<Text> choices;  // pieces without a name, and the default one, in order
};

constexpr std::array<View, 4> Names = {u"name=", u"default=", u"width=", u"height="};

bool isNamed(View piece) {
    return std::any_of(Names.begin(), Names.end(), [&](View name) { return piece.starts_with(name); });
}

// Pieces between colons. Where there are no choices, a colon belongs to a value unless a name follows it.
std::vector<Text> piecesOf(View parameters, bool hasChoices) {
    std::vector<Text> pieces;
    for (Text& piece : split(parameters, u':')) {
        if (hasChoices || pieces.empty() || isNamed(piece)) {
            pieces.push_back(std::move(piece));
        } else {
            pieces.back() += u':' + piece;
        }
    }
    return pieces;
}

Parameters parametersOf(View text, bool hasChoices) {
    Parameters parameters;
    for (const Text& piece : piecesOf(text, hasChoices)) {
        const View value = View(piece).substr(std::min(piece.find(u'=') + 1, piece.size()));
        if (piece.starts_with(u"name=")) {
            parameters.name = value;
        } else if (piece.starts_with(u"default=")) {
            parameters.initial = value;
            parameters.hasInitial = true;
            parameters.choices.emplace_back(value);
        } else if (piece.starts_with(u"width=")) {
            parameters.width = integerValue(value);
        } else if (piece.starts_with(u"height=")) {
            parameters.height = integerValue(value);
        } else {
            parameters.choices.push_back(piece);
        }
    }
    // The default may be one of the choices already, or be named only as the default.
    auto& choices = parameters.choices;
    const auto first = std::find(choices.begin(), choices.end(), parameters.initial);
    if (parameters.hasInitial) choices.erase(std::remove(first + 1, choices.end(), parameters.initial), choices.end());
    return parameters;
}

// A menu that does not start at its first item has to say so.
Text menuBody(const Parameters& parameters) {
    BodyWriter writer;
    if (parameters.name.empty()) {
        writer.part(u"field");
    } else {
        writer.param(u"field", parameters.name);
    }
    writer.param(u"type", static_cast<std::int64_t>(FieldType::PopupMenu));
    Text items;
    std::int64_t index = 0;
    for (std::size_t i = 0; i < parameters.choices.size(); ++i) {
        items += (i > 0 ? u"\n" : u"") + parameters.choices[i];
        if (parameters.choices[i] == parameters.initial) index = static_cast<std::int64_t>(i);
    }
    writer.param(u"value", items);
    writer.paramUnlessZero(u"defaultIndex", index);
    return writer.take();
}

Text textBody(const Parameters& parameters, FieldType type) {
    SnippetFieldVariable field;
    field.name = parameters.name;
    field.type = type;
    field.value = parameters.initial;
    field.setWidth(parameters.width);
    field.setHeight(parameters.height);
    return field.toString();
}

// What follows the keyword, when it is this one.
std::optional<View> behind(View macro, View keyword) {
    if (!macro.starts_with(keyword)) return std::nullopt;
    return macro.substr(keyword.size());
}

}  // namespace

std::optional<Text> fieldFromTextExpander(View macro) {
    if (const auto text = behind(macro, u"filltext:"))
        return textBody(parametersOf(*text, false), FieldType::Singleline);
    if (const auto text = behind(macro, u"fillarea:"))
        return textBody(parametersOf(*text, false), FieldType::Multiline);
    if (const auto text = behind(macro, u"fillpopup:")) return menuBody(parametersOf(*text, true));
    return std::nullopt;
}

std::optional<TextExpanderPart> partFromTextExpander(View macro) {
    const auto text = behind(macro, u"fillpart:");
    if (!text) return std::nullopt;
    Parameters parameters = parametersOf(*text, false);
    const bool isSelected = !parameters.hasInitial || equalsIgnoringCase(parameters.initial, u"yes");
    return TextExpanderPart{std::move(parameters.name), isSelected};
}

Text bodyOfPart(const TextExpanderPart& part, View content) {
    SnippetFieldVariable field;
    field.name = part.name;
    field.type = content.find(u'\n') == View::npos ? FieldType::Singleline : FieldType::Multiline;
    field.value = Text(content);
    field.isOptional = true;
    field.isSelected = part.isSelected;
    field.isReadonly = true;
    return field.toString();
}

}  // namespace plume
