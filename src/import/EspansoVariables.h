// What the variables of espanso become in Plume: placeholders, or scripts that print what they stand for.
#pragma once

#include <filesystem>
#include <map>
#include <string>
#include <string_view>
#include <vector>

#include "Foundation/text/AttributedString.h"
#include "import/ScriptShelf.h"
#include "import/YamlFile.h"

namespace plume {

class EspansoVariables {
  public:
    EspansoVariables(std::filesystem::path root, ScriptShelf& scripts) : root_(std::move(root)), scripts_(scripts) {}

    // Known to all matches; one of a name that is known already does not count. Throws YamlError.
    void addGlobals(const YamlValue* list);
    // `match` stays alive until the next one; `name` is what its scripts are called after. Throws YamlError.
    void beginMatch(const YamlValue& match, const std::u16string& name);

    // Content with placeholders. `isForm`: "[[name]]" is a field of the match's form. Throws YamlError.
    std::u16string expand(std::u16string_view text, bool isForm = false);
    AttributedString expand(const AttributedString& text);
    // The text is nothing but a variable whose script can be the whole snippet: that script. Else empty.
    std::u16string scriptInsteadOf(std::u16string_view text);

    // Why the match is not carried over whole, one reason each.
    std::vector<std::string> takeProblems();

  private:
    using Variables = std::map<std::u16string, const YamlValue*, std::less<>>;

    const YamlValue* find(std::u16string_view name) const;
    std::u16string replacementOf(const struct EspansoPiece& piece);
    std::u16string valueOf(std::u16string_view name, std::u16string_view member);
    std::u16string valueOf(const YamlValue& variable, std::u16string_view name, std::u16string_view member);
    std::u16string dateOf(const YamlValue& params);
    std::u16string dateByScript(const YamlValue& params, std::u16string_view format);
    std::u16string randomOf(const YamlValue& params);
    std::u16string choiceOf(const YamlValue& params, std::u16string_view name);
    std::u16string formFieldOf(const YamlValue& params, std::u16string_view form, std::u16string_view field);
    std::u16string fieldOf(const YamlValue* settings, std::u16string_view name);
    std::u16string shellScript(const YamlValue& params);
    std::u16string programScript(const YamlValue& params);
    std::u16string assignments(std::u16string_view command);
    std::u16string assignmentFor(std::u16string_view name, const std::u16string& variable);
    std::u16string shelved(const std::u16string& script, std::u16string_view name);
    std::u16string withFolders(std::u16string_view text) const;
    void problem(const std::string& text);

    std::filesystem::path root_;
    ScriptShelf& scripts_;
    Variables globals_;
    Variables own_;
    const YamlValue* formFields_ = nullptr;
    std::u16string matchName_;
    std::vector<std::u16string> groupNames_;  // of what a regular expression takes; each is asked for in a field
    std::vector<std::u16string> resolving_;   // innermost last
    std::vector<std::string> problems_;
    std::size_t steps_ = 0;
    std::size_t units_ = 0;
    std::size_t stepsOfAll_ = 0;
    std::size_t unitsOfAll_ = 0;
};

}  // namespace plume
