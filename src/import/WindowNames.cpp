#include "import/WindowNames.h"

#include <algorithm>

#include "Foundation/CharacterSet.h"
#include "Foundation/Strings.h"

namespace plume {

namespace {

constexpr std::size_t LongestPattern = 2000;

void removeAround(std::u16string_view& text, std::u16string_view start, std::u16string_view end) {
    if (text.starts_with(start)) text.remove_prefix(start.size());
    if (text.ends_with(end)) text.remove_suffix(end.size());
}

// One alternative without what only anchors it; nothing when it stands for more than one name.
std::optional<std::u16string> nameIn(std::u16string_view alternative) {
    removeAround(alternative, u"^", u"$");
    removeAround(alternative, u".*", u".*");
    removeAround(alternative, u"\\b", u"\\b");
    std::u16string name;
    for (std::size_t i = 0; i < alternative.size(); ++i) {
        char16_t unit = alternative[i];
        if (unit == u'\\' && i + 1 < alternative.size()) {
            unit = alternative[++i];
            if (CharacterSet::alphanumerics().contains(unit)) return std::nullopt;
        } else if (!CharacterSet::alphanumerics().contains(unit) && std::u16string_view(u"._- /").find(unit) > 4) {
            return std::nullopt;
        }
        name += unit;
    }
    if (name.empty()) return std::nullopt;
    return name;
}

void addOnce(std::vector<std::u16string>& names, std::u16string name) {
    if (std::find(names.begin(), names.end(), name) == names.end()) names.push_back(std::move(name));
}

}  // namespace

std::optional<std::vector<std::u16string>> namesInPattern(std::u16string_view pattern) {
    if (pattern.size() > LongestPattern) return std::nullopt;
    if (pattern.starts_with(u"(?i)")) pattern.remove_prefix(4);
    removeAround(pattern, u"^", u"$");
    if (pattern.starts_with(u'(') && pattern.find(u')') == pattern.size() - 1) {
        pattern = pattern.substr(1, pattern.size() - 2);
        if (pattern.starts_with(u"?:")) pattern.remove_prefix(2);
    }
    std::vector<std::u16string> names;
    for (const std::u16string& alternative : split(pattern, u'|')) {
        const std::optional<std::u16string> name = nameIn(alternative);
        if (!name) return std::nullopt;
        addOnce(names, *name);
        addOnce(names, lowercased(*name));
    }
    return names;
}

std::vector<std::u16string> programNames(const std::vector<std::u16string>& paths) {
    std::vector<std::u16string> names;
    for (const std::u16string& path : paths) {
        std::u16string name = path.substr(path.find_last_of(u"/\\") + 1);
        if (lowercased(name).ends_with(u".exe")) name.resize(name.size() - 4);
        if (!name.empty()) addOnce(names, std::move(name));
    }
    return names;
}

}  // namespace plume
