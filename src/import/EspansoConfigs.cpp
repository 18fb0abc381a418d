#include "import/EspansoConfigs.h"

#include <algorithm>
#include <array>
#include <utility>

#include "Foundation/Strings.h"
#include "import/WindowNames.h"

namespace plume {

namespace {

constexpr std::size_t LongestGlob = 512;
constexpr std::string_view AllMatchFiles = "../match/**/[!_]*.yml";

// The characters that a "[…]" at `start` takes; `end` is behind it. Nothing when it is not closed.
std::optional<bool> takesSet(std::string_view pattern, std::size_t start, char c, std::size_t& end) {
    const std::size_t close = pattern.find(']', start + 2);
    if (close == std::string_view::npos) return std::nullopt;
    std::string_view set = pattern.substr(start + 1, close - start - 1);
    const bool isInverted = set.starts_with('!') || set.starts_with('^');
    if (isInverted) set.remove_prefix(1);
    end = close + 1;
    return (set.find(c) != std::string_view::npos) != isInverted && c != '/';
}

}  // namespace

// Which prefixes of the path each prefix of the pattern takes: time is that of both lengths multiplied.
bool matchesGlob(std::string_view pattern, std::string_view path) {
    if (pattern.size() > LongestGlob || path.size() > 8 * LongestGlob) return false;
    std::vector<bool> taken(path.size() + 1, false);
    taken[0] = true;
    for (std::size_t i = 0; i < pattern.size();) {
        std::vector<bool> next(path.size() + 1, false);
        const bool isFolders = pattern.substr(i, 3) == "**/";
        const bool isAny = pattern[i] == '*';
        std::size_t end = i + (isFolders ? 3 : pattern.substr(i, 2) == "**" ? 2 : 1);
        bool running = false;
        for (std::size_t k = 0; k <= path.size(); ++k) {
            if (isAny) {
                running = (running && (isFolders || path[k - 1] != '/' || end == i + 2)) || taken[k];
                next[k] = isFolders ? taken[k] || (running && k > 0 && path[k - 1] == '/') : running;
            } else if (k > 0 && taken[k - 1]) {
                const char c = path[k - 1];
                std::size_t setEnd = end;
                const auto set = pattern[i] == '[' ? takesSet(pattern, i, c, setEnd) : std::nullopt;
                next[k] = set ? *set : pattern[i] == c || (pattern[i] == '?' && c != '/');
            }
        }
        if (pattern[i] == '[') takesSet(pattern, i, ' ', end);
        taken = std::move(next);
        i = end;
    }
    return taken[path.size()];
}

std::vector<std::u16string> espansoApplications(const YamlValue& file, Remarks& remarks) {
    std::vector<std::u16string> all;
    for (const std::string key : {"filter_class", "filter_exec", "filter_title"}) {
        const YamlValue* const filter = file.find(key);
        if (!filter) continue;
        const auto names = key == "filter_title" ? std::nullopt : namesInPattern(fromUtf8(filter->string()));
        if (!names) {
            remarks.add(*file.fileName + ": a list of applications cannot say " + key + ": " + filter->text);
            continue;
        }
        const auto programs = programNames(*names);
        all.insert(all.end(), programs.begin(), programs.end());
    }
    return all;
}

EspansoConfig::EspansoConfig(const std::filesystem::path& path, YamlValue::Pointer root, const EspansoConfig* fallback,
                             Remarks& remarks)
    : path_(path), root_(std::move(root)), fallback_(fallback) {
    if (const YamlValue* const enable = root_->find("enable")) isEnabled_ = enable->boolean();
    if (!fallback_ && !isEnabled_) {
        remarks.add(path.string() + ": espanso is switched off by \"enable\"; what it holds is active in Plume");
        isEnabled_ = true;
    }
    readFilters(remarks);
    constexpr std::array<std::string_view, 13> Known = {
        "label",    "enable",   "filter_title",   "filter_class",   "filter_exec",           "filter_os",
        "includes", "excludes", "extra_includes", "extra_excludes", "use_standard_includes", "word_separators",
        "inherits"};
    std::string others;
    for (const auto& [key, value] : root_->members) {
        if (std::find(Known.begin(), Known.end(), key) == Known.end()) others += (others.empty() ? "" : ", ") + key;
    }
    if (!others.empty()) remarks.add(path.string() + ": these settings stay behind: " + others);
}

void EspansoConfig::readFilters(Remarks& remarks) {
    if (const YamlValue* const system = root_->find("filter_os")) {
        isForOtherSystems_ = system->string().find("linux") == std::string::npos;
    }
    if (fallback_ && !isForOtherSystems_) applications_ = espansoApplications(*root_, remarks);
}

std::vector<std::string> EspansoConfig::patterns(std::string_view key) const {
    if (const YamlValue* const own = root_->find(key)) return own->strings();
    return fallback_ ? fallback_->patterns(key) : std::vector<std::string>();
}

bool EspansoConfig::includes(const std::filesystem::path& matchFile) const {
    if (!isEnabled_) return false;
    const std::string relative = matchFile.lexically_relative(path_.parent_path()).generic_string();
    const auto isIn = [&](std::string_view key) {
        const std::vector<std::string> list = patterns(key);
        return std::any_of(list.begin(), list.end(), [&](const std::string& p) { return matchesGlob(p, relative); });
    };
    const YamlValue* standard = root_->find("use_standard_includes");
    if (!standard && fallback_) standard = fallback_->root_->find("use_standard_includes");
    const bool isStandard = (!standard || standard->boolean()) &&
                            (matchesGlob(AllMatchFiles, relative) || matchesGlob("../match/**/[!_]*.yaml", relative));
    return (isStandard || isIn("includes") || isIn("extra_includes")) && !isIn("excludes") && !isIn("extra_excludes");
}

std::optional<std::u16string> EspansoConfig::wordSeparators() const {
    const YamlValue* const list = root_->find("word_separators");
    if (!list) return std::nullopt;
    std::u16string characters;
    for (const std::string& text : list->strings()) characters += fromUtf8(text);
    return characters;
}

}  // namespace plume
