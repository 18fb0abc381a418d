#include "import/EspansoVariables.h"

#include <algorithm>
#include <array>
#include <utility>

#include "Foundation/Strings.h"
#include "import/EspansoTemplate.h"
#include "import/ForeignPlaceholders.h"
#include "import/ShellText.h"

namespace plume {

namespace {

constexpr std::size_t DeepestVariable = 16;
// Variables that hold others could ask for far more than a file says: for one match, and for all.
constexpr std::size_t MostSteps = 10'000;
constexpr std::size_t MostUnits = std::size_t{1} << 20;
constexpr std::size_t MostStepsOfAll = 1'000'000;
constexpr std::size_t MostUnitsOfAll = std::size_t{64} << 20;

const YamlValue& paramsOf(const YamlValue& variable) {
    static const YamlValue none;
    const YamlValue* const params = variable.find("params");
    return params ? params->map() : none;
}

std::u16string textOf(const YamlValue& map, std::string_view key) {
    const YamlValue* const value = map.find(key);
    return value ? fromUtf8(value->string()) : std::u16string();
}

// The texts of a list, of lines, or of what the items of a list are worth.
std::vector<std::u16string> choicesIn(const YamlValue& values) {
    if (values.kind == YamlValue::Kind::Scalar) {
        std::vector<std::u16string> lines = split(trimmed(fromUtf8(values.text)), u'\n');
        return lines;
    }
    std::vector<std::u16string> choices;
    for (const YamlValue::Pointer& item : values.list()) {
        const YamlValue* const id = item->find("id");
        choices.push_back(fromUtf8(id ? id->string() : item->string()));
    }
    return choices;
}

// What a regular expression calls the parts of what was typed: "(?P<name>…)".
std::vector<std::u16string> namesOfGroups(std::u16string_view pattern) {
    std::vector<std::u16string> names;
    for (std::size_t at = pattern.find(u"(?"); at != std::u16string_view::npos; at = pattern.find(u"(?", at + 2)) {
        std::u16string_view rest = pattern.substr(at + 2);
        if (rest.starts_with(u'P')) rest.remove_prefix(1);
        const std::size_t close = rest.find(u'>');
        if (rest.starts_with(u'<') && close != std::u16string_view::npos) names.emplace_back(rest.substr(1, close - 1));
    }
    return names;
}

bool isOneOf(std::u16string_view text, std::initializer_list<std::u16string_view> list) {
    return std::find(list.begin(), list.end(), text) != list.end();
}

}  // namespace

// ---- Matches ----

void EspansoVariables::addGlobals(const YamlValue* list) {
    if (!list) return;
    for (const YamlValue::Pointer& variable : list->list()) {
        globals_.emplace(textOf(variable->map(), "name"), variable.get());
    }
}

void EspansoVariables::beginMatch(const YamlValue& match, const std::u16string& name) {
    own_.clear();
    steps_ = units_ = 0;
    matchName_ = name;
    const YamlValue* const regex = match.find("regex");
    groupNames_ = regex ? namesOfGroups(fromUtf8(regex->string())) : std::vector<std::u16string>();
    formFields_ = match.find("form_fields");
    if (formFields_) formFields_->map();
    const YamlValue* const list = match.find("vars");
    if (!list) return;
    for (const YamlValue::Pointer& variable : list->list()) own_[textOf(variable->map(), "name")] = variable.get();
}

std::vector<std::string> EspansoVariables::takeProblems() {
    return std::exchange(problems_, {});
}

void EspansoVariables::problem(const std::string& text) {
    if (std::find(problems_.begin(), problems_.end(), text) == problems_.end()) problems_.push_back(text);
}

const YamlValue* EspansoVariables::find(std::u16string_view name) const {
    for (const Variables* variables : {&own_, &globals_}) {
        if (const auto found = variables->find(name); found != variables->end()) return found->second;
    }
    return nullptr;
}

// ---- Text ----

std::u16string EspansoVariables::expand(std::u16string_view text, bool isForm) {
    std::u16string result;
    for (const EspansoPiece& piece : piecesOfEspansoTemplate(text, isForm)) {
        if (piece.kind == EspansoPiece::Kind::Text && holdsMarker(piece.text)) {
            problem("its text holds \xe3\x80\x90, with which Plume's placeholders begin");
        }
        std::u16string value = piece.kind == EspansoPiece::Kind::Text ? piece.text : replacementOf(piece);
        units_ += value.size();
        unitsOfAll_ += value.size();
        if (units_ > MostUnits || unitsOfAll_ > MostUnitsOfAll) {
            problem("its variables ask for more text than Plume takes");
            return result;
        }
        result += value;
    }
    return result;
}

AttributedString EspansoVariables::expand(const AttributedString& text) {
    AttributedString result;
    for (const EspansoPiece& piece : piecesOfEspansoTemplate(text.string(), false)) {
        if (piece.kind != EspansoPiece::Kind::Text) {
            result.append(replacementOf(piece), text.attributesAt(piece.range.location));
        } else if (piece.text.size() == piece.range.length) {
            result.append(text.substring(piece.range));
        } else {
            result.append(piece.text, text.attributesAt(piece.range.location));
        }
    }
    return result;
}

std::u16string EspansoVariables::replacementOf(const EspansoPiece& piece) {
    if (piece.kind == EspansoPiece::Kind::Caret) return std::u16string(CaretPlaceholder);
    if (piece.kind == EspansoPiece::Kind::Field) {
        return fieldOf(formFields_ ? formFields_->find(toUtf8(piece.name)) : nullptr, piece.name);
    }
    return valueOf(piece.name, piece.member);
}

std::u16string EspansoVariables::scriptInsteadOf(std::u16string_view text) {
    const auto pieces = piecesOfEspansoTemplate(text, false);
    if (pieces.size() != 1 || pieces[0].kind != EspansoPiece::Kind::Variable) return {};
    const YamlValue* const variable = find(pieces[0].name);
    if (!variable) return {};
    const std::u16string type = textOf(*variable, "type");
    if (!isOneOf(type, {u"shell", u"script", u"random"})) return {};
    resolving_.push_back(pieces[0].name);
    const YamlValue& params = paramsOf(*variable);
    std::u16string script = type == u"shell"    ? shellScript(params)
                            : type == u"script" ? programScript(params)
                                                : randomOf(params);
    resolving_.pop_back();
    return script;
}

// ---- Variables ----

std::u16string EspansoVariables::valueOf(std::u16string_view name, std::u16string_view member) {
    const std::string shown = toUtf8(name);
    const YamlValue* const variable = find(name);
    if (!variable && std::find(groupNames_.begin(), groupNames_.end(), name) != groupNames_.end()) {
        return fieldOf(nullptr, name);
    }
    if (!variable) {
        problem("the variable \"" + shown + "\" is not defined, and stays as it is written");
        return u"{{" + std::u16string(name) + (member.empty() ? u"" : u"." + std::u16string(member)) + u"}}";
    }
    if (resolving_.size() >= DeepestVariable ||
        std::find(resolving_.begin(), resolving_.end(), name) != resolving_.end()) {
        problem("the variable \"" + shown + "\" holds itself, and is left out there");
        return {};
    }
    if (++steps_ > MostSteps || ++stepsOfAll_ > MostStepsOfAll) {
        problem("the file has too many variables; \"" + shown + "\" is left out");
        return {};
    }
    resolving_.emplace_back(name);
    std::u16string value = valueOf(*variable, name, member);
    resolving_.pop_back();
    return value;
}

std::u16string EspansoVariables::valueOf(const YamlValue& variable, std::u16string_view name,
                                         std::u16string_view member) {
    const YamlValue& params = paramsOf(variable);
    const std::u16string type = textOf(variable, "type");
    if (type == u"date") return dateOf(params);
    if (type == u"clipboard") return std::u16string(ClipboardPlaceholder);
    if (type == u"echo") return expand(textOf(params, "echo"));
    if (type == u"shell") return shelved(shellScript(params), name);
    if (type == u"script") return shelved(programScript(params), name);
    if (type == u"random") return shelved(randomOf(params), name);
    if (type == u"choice") return choiceOf(params, name);
    if (type == u"form") return formFieldOf(params, name, member);
    if (type == u"match") return snippetPlaceholder(textOf(params, "trigger"), {});
    if (type == u"global") {
        const auto global = globals_.find(name);
        if (global != globals_.end() && global->second != &variable) return valueOf(*global->second, name, member);
    }
    problem("Plume has nothing for the variable \"" + toUtf8(name) + "\" of type \"" + toUtf8(type) + "\"");
    return {};
}

std::u16string EspansoVariables::dateOf(const YamlValue& params) {
    const std::u16string format = textOf(params, "format");
    if (format.empty()) return u"\u3010date:medium\u3011";
    DateShift shift;
    if (const YamlValue* const offset = params.find("offset")) shift.seconds = offset->integer();
    const std::u16string locale = replacingAll(textOf(params, "locale"), u"-", u"_");
    const auto pieces = piecesOfStrftime(format);
    if (pieces && !params.find("tz")) {
        if (auto value = datePlaceholders(*pieces, shift, locale)) return *value;
    }
    return dateByScript(params, format);
}

// What patterns cannot show, the system's own command can.
std::u16string EspansoVariables::dateByScript(const YamlValue& params, std::u16string_view format) {
    constexpr std::u16string_view Unknown = u"fv+.3";
    for (std::size_t at = format.find(u'%'); at != std::u16string_view::npos; at = format.find(u'%', at + 2)) {
        if (at + 1 < format.size() && Unknown.find(format[at + 1]) != std::u16string_view::npos) {
            problem("Plume cannot show a date as \"" + toUtf8(format) + "\", and shows it as usual");
            return u"\u3010date:medium\u3011";
        }
    }
    std::u16string command;
    const std::u16string locale = replacingAll(textOf(params, "locale"), u"-", u"_");
    if (!locale.empty()) command += u"LC_ALL=" + quotedForShell(locale + u".UTF-8") + u" ";
    if (params.find("tz")) command += u"TZ=" + quotedForShell(textOf(params, "tz")) + u" ";
    command += u"date ";
    if (const YamlValue* const offset = params.find("offset")) {
        command += u"-d '" + fromUtf8(std::to_string(offset->integer())) + u" seconds' ";
    }
    return shelved(command + quotedForShell(u"+" + std::u16string(format)) + u"\n", u"date");
}

std::u16string EspansoVariables::randomOf(const YamlValue& params) {
    const YamlValue* const list = params.find("choices");
    if (!list) params.fail("expected \"choices\" of a random text");
    const std::vector<std::u16string> choices = choicesIn(*list);
    const bool isSimple = std::none_of(choices.begin(), choices.end(), [](const std::u16string& choice) {
        return choice.find(u"{{") != std::u16string::npos;
    });
    if (isSimple) return randomChoiceScript(choices);
    // A text that holds placeholders is set aside first, where the shell cannot take it for commands.
    std::u16string script = u"#!/bin/bash\n";
    std::vector<std::u16string> names;
    for (const std::u16string& choice : choices) {
        names.push_back(u"CHOICE_" + fromUtf8(std::to_string(names.size())));
        script += shellAssignment(names.back(), expand(choice));
    }
    script += u"choices=(";
    for (const std::u16string& name : names) script += u" \"$" + name + u"\"";
    return script + u" )\nprintf '%s' \"${choices[RANDOM % ${#choices[@]}]}\"\n";
}

// ---- Fields ----

std::u16string EspansoVariables::choiceOf(const YamlValue& params, std::u16string_view name) {
    const YamlValue* const values = params.find("values");
    if (!values) params.fail("expected \"values\" to choose from");
    ForeignField field;
    field.name = name;
    field.choices = choicesIn(*values);
    if (values->text.find("{{") != std::string::npos) {
        problem("what the list \"" + toUtf8(name) + "\" offers comes from a variable; it is a field to write in");
        field.choices.clear();
    }
    return fieldPlaceholder(field);
}

std::u16string EspansoVariables::formFieldOf(const YamlValue& params, std::u16string_view form,
                                             std::u16string_view field) {
    if (field.empty()) {
        problem("the form \"" + toUtf8(form) + "\" gives nothing by itself, only its fields do");
        return {};
    }
    const YamlValue* const fields = params.find("fields");
    const YamlValue* const settings = fields ? fields->map().find(toUtf8(field)) : nullptr;
    return fieldOf(settings, field);
}

std::u16string EspansoVariables::fieldOf(const YamlValue* settings, std::u16string_view name) {
    ForeignField field;
    field.name = name;
    if (!settings) return fieldPlaceholder(field);
    const YamlValue& map = settings->map();
    const YamlValue* const isMultiline = map.find("multiline");
    field.isMultiline = isMultiline && isMultiline->boolean();
    field.initial = textOf(map, "default");
    const std::u16string type = textOf(map, "type");
    if (isOneOf(type, {u"choice", u"list"})) {
        if (const YamlValue* const values = map.find("values")) field.choices = choicesIn(*values);
    }
    const bool isComputed = std::any_of(field.choices.begin(), field.choices.end(),
                                        [](const auto& choice) { return choice.find(u"{{") != std::u16string::npos; });
    if (isComputed || field.initial.find(u"{{") != std::u16string::npos) {
        problem("what the field \"" + toUtf8(name) + "\" starts with comes from a variable; it starts empty");
        field.choices.clear();
        field.initial.clear();
    }
    return fieldPlaceholder(field);
}

// ---- Scripts ----

std::u16string EspansoVariables::shelved(const std::u16string& script, std::u16string_view name) {
    if (script.empty()) return {};
    return scripts_.placeholderFor(script, matchName_ + u" " + std::u16string(name));
}

std::u16string EspansoVariables::withFolders(std::u16string_view text) const {
    std::u16string result = replacingAll(text, u"%CONFIG%", fromUtf8(root_.string()));
    return replacingAll(result, u"%PACKAGES%", fromUtf8((root_ / "match" / "packages").string()));
}

std::u16string EspansoVariables::shellScript(const YamlValue& params) {
    const YamlValue* const command = params.find("cmd");
    if (!command) params.fail("expected \"cmd\", the command to run");
    const std::u16string shell = params.find("shell") ? textOf(params, "shell") : u"bash";
    if (!isOneOf(shell, {u"bash", u"sh", u"zsh", u"fish", u"nu", u"pwsh"})) {
        problem("its command is for the shell " + toUtf8(shell) + ", which Linux does not have; it is left out");
        return {};
    }
    const bool isPlain = shell == u"bash" || shell == u"sh";
    std::u16string script = isPlain ? u"#!/bin/" + shell + u"\n" : u"#!/usr/bin/env " + shell + u"\n";
    const std::u16string text = withFolders(fromUtf8(command->string()));
    script += assignments(text);
    script += replacingAll(expand(text), u"%HOME%", u"$HOME") + u"\n";
    const YamlValue* const trim = params.find("trim");
    if (trim && !trim->boolean()) script += u"echo\n";  // Plume leaves out one line feed at the end
    return script;
}

std::u16string EspansoVariables::programScript(const YamlValue& params) {
    const YamlValue* const arguments = params.find("args");
    if (!arguments) params.fail("expected \"args\", the program to run and what it is given");
    std::u16string script = u"#!/bin/sh\n";
    std::u16string command;
    std::u16string all;
    std::size_t number = 0;
    for (const std::string& argument : arguments->strings()) {
        const std::u16string text = withFolders(fromUtf8(argument));
        all += text;
        if (!command.empty()) command += u' ';
        if (text.find(u"{{") == std::u16string::npos) {
            command += replacingAll(quotedForShell(text), u"%HOME%", u"'\"$HOME\"'");
            continue;
        }
        const std::u16string name = u"ARGUMENT_" + fromUtf8(std::to_string(++number));
        script += shellAssignment(name, expand(text));
        command += u"\"$" + name + u"\"";
    }
    return script + assignments(all) + command + u"\n";
}

// espanso tells commands the values of all variables and fields in their environment; `command` names those it uses.
std::u16string EspansoVariables::assignments(std::u16string_view command) {
    constexpr std::u16string_view Start = u"ESPANSO_";
    std::u16string result;
    std::vector<std::u16string> seen;
    for (std::size_t at = command.find(Start); at != std::u16string_view::npos; at = command.find(Start, at + 1)) {
        std::size_t end = at + Start.size();
        const auto isNameUnit = [](char16_t c) {
            return (c >= u'A' && c <= u'Z') || (c >= u'0' && c <= u'9') || c == u'_';
        };
        while (end < command.size() && isNameUnit(command[end])) ++end;
        const std::u16string variable(command.substr(at, end - at));
        if (std::find(seen.begin(), seen.end(), variable) != seen.end()) continue;
        seen.push_back(variable);
        result += assignmentFor(variable.substr(Start.size()), variable);
    }
    return result;
}

std::u16string EspansoVariables::assignmentFor(std::u16string_view name, const std::u16string& variable) {
    for (const Variables* variables : {&own_, &globals_}) {
        for (const auto& [own, value] : *variables) {
            const std::u16string upper = uppercased(own);
            if (std::find(resolving_.begin(), resolving_.end(), own) != resolving_.end()) continue;
            if (upper == name) return shellAssignment(variable, valueOf(own, {}));
            if (textOf(*value, "type") == u"form" && name.starts_with(upper + u"_")) {
                return shellAssignment(variable, valueOf(own, lowercased(name.substr(upper.size() + 1))));
            }
        }
    }
    return {};
}

}  // namespace plume
