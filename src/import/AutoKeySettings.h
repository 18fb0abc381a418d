// What AutoKey's files of settings say about a phrase, a script or a folder.
#pragma once

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace plume {

struct AutoKeySettings {
    std::u16string description;  // of a folder, its title
    std::vector<std::u16string> abbreviations;
    bool isImmediate = false;
    bool expandsInside = false;
    bool ignoresCase = false;
    bool matchesCase = false;
    bool erasesAbbreviation = true;
    bool omitsTrigger = false;
    bool asksFirst = false;
    bool isByAbbreviation = false;
    bool isByHotKey = false;
    bool isByPrediction = false;
    std::u16string wordCharacters = u"[\\w]";
    std::u16string hotKey;
    std::optional<std::u16string> windowFilter;
    bool isFilterRecursive = false;
};

// Throws JsonError.
AutoKeySettings readAutoKeySettings(std::string_view json, const std::string& fileName);

// The characters that end an abbreviation, from the expression for those that do not. Nothing for the usual ones, and
// for what a set of a few characters cannot say; the latter sets `isOther`.
std::optional<std::u16string> delimitersOfAutoKey(std::u16string_view wordCharacters, bool& isOther);

}  // namespace plume
