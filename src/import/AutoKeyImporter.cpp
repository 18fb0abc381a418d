#include "import/AutoKeyImporter.h"

#include <algorithm>
#include <map>
#include <memory>
#include <set>
#include <tuple>
#include <utility>
#include <vector>

#include "Foundation/Strings.h"
#include "Foundation/json/JsonNode.h"
#include "import/AutoKeyPhrase.h"
#include "import/AutoKeySettings.h"
#include "import/Remarks.h"
#include "import/WindowNames.h"

namespace plume {

namespace {

using Path = std::filesystem::path;

constexpr std::size_t DeepestFolder = 16;
constexpr std::size_t MostFiles = 50'000;

bool isContent(const Path& name) {
    return name.extension() == ".txt" || name.extension() == ".md" || name.extension() == ".py";
}

// What a folder hands down to what is in it.
struct Inherited {
    std::u16string title;
    std::optional<std::u16string> windowFilter;
};

class Reader {
  public:
    explicit Reader(const Files& files) : files_(files) {}

    ImportedLibrary read(const Path& folder) {
        readFolder(folder, {}, 0);
        if (auto group = scripts_.group(u"AutoKey scripts")) library_.groups.push_back(std::move(group));
        library_.remarks = remarks_.take();
        return std::move(library_);
    }

  private:
    // How the snippets of one folder are told apart into groups.
    using GroupKey = std::tuple<ExpandAfter, ExpandTrigger, std::u16string, std::u16string>;

    std::string bytesOf(const Path& path) const {
        Result<std::string> bytes = files_.read(path);
        if (!bytes) throw JsonError(bytes.error().message);
        return std::move(bytes).value();
    }

    // The settings beside a file, hidden or not.
    std::optional<AutoKeySettings> settingsOf(const Path& folder, const std::string& stem) const {
        for (const Path& path : {folder / ("." + stem + ".json"), folder / (stem + ".json")}) {
            if (files_.exists(path)) return readAutoKeySettings(bytesOf(path), path.string());
        }
        return std::nullopt;
    }

    void readFolder(const Path& folder, Inherited inherited, std::size_t depth) {
        if (depth > DeepestFolder) return remarks_.add(folder.string() + ": folders this deep are left out");
        auto entries = files_.list(folder);
        if (!entries) throw JsonError(entries.error().message);
        std::vector<Files::Entry> sorted = std::move(entries).value();
        std::sort(sorted.begin(), sorted.end(), [](const auto& a, const auto& b) { return a.name < b.name; });
        inherit(folder, depth, inherited);
        std::map<GroupKey, std::shared_ptr<SnippetGroup>> groups;
        for (const Files::Entry& entry : sorted) {
            const bool isFile = !entry.isFolder && !entry.name.starts_with('.') && isContent(entry.name);
            if (isFile) readItem(folder / entry.name, inherited, groups);
        }
        for (const Files::Entry& entry : sorted) {
            if (entry.isFolder && !entry.name.starts_with('.')) readFolder(folder / entry.name, inherited, depth + 1);
        }
    }

    void inherit(const Path& folder, std::size_t depth, Inherited& inherited) {
        const auto settings = settingsOf(folder, "folder");
        std::u16string title = settings ? settings->description : std::u16string();
        if (title.empty() && (depth > 0 || settings)) title = fromUtf8(folder.filename().string());
        if (!inherited.title.empty() && !title.empty()) inherited.title += u" / ";
        inherited.title += title;
        if (!settings) return;
        if (settings->windowFilter) inherited.windowFilter = settings->windowFilter;
        if (!settings->abbreviations.empty() || !settings->hotKey.empty()) {
            remarks_.add(folder.string() + ": Plume has no menus that open by an abbreviation or a hot key");
        }
    }

    void readItem(const Path& path, const Inherited& inherited,
                  std::map<GroupKey, std::shared_ptr<SnippetGroup>>& groups) {
        if (++count_ > MostFiles) throw JsonError(path.string() + ": expected at most 50000 phrases and scripts");
        const AutoKeySettings settings =
            settingsOf(path.parent_path(), path.stem().string()).value_or(AutoKeySettings{});
        std::vector<Snippet::Text> abbreviations;
        if (settings.isByAbbreviation)
            abbreviations.assign(settings.abbreviations.begin(), settings.abbreviations.end());
        if (abbreviations.empty()) abbreviations.emplace_back(std::nullopt);
        for (const Snippet::Text& abbreviation : abbreviations) {
            auto snippet = std::make_shared<Snippet>(abbreviation, std::nullopt);
            const std::u16string stem = fromUtf8(path.stem().string());
            snippet->setLabel(settings.description.empty() ? stem : settings.description);
            if (settings.matchesCase) {
                snippet->setCaseSensitivity(CaseSensitivity::IgnoreCaseAndAdapt);
            } else if (settings.ignoresCase) {
                snippet->setCaseSensitivity(CaseSensitivity::IgnoreCase);
            }
            if (!setContent(path, *snippet)) return;
            tellWhatIsLost(settings, *snippet);
            groupFor(settings, inherited, *snippet, groups).addItem(snippet);
        }
    }

    bool setContent(const Path& path, Snippet& snippet) {
        std::u16string text = fromUtf8(bytesOf(path));
        if (path.extension() != ".py") {
            std::vector<std::string> problems;
            const std::u16string name = snippet.abbreviation().value_or(*snippet.label());
            snippet.setPlainTextContent(contentOfAutoKeyPhrase(text, name, scripts_, problems));
            for (const std::string& problem : problems) remarks_.add(snippet, problem);
            return true;
        }
        auto script = shellScriptOfPython(text);
        if (!script) {
            remarks_.add(path.string() + ": the script needs what only AutoKey gives it, and is left out");
            return false;
        }
        snippet.setPlainTextContent(std::move(*script));
        snippet.setContentType(ContentType::ShellScript);
        remarks_.add(snippet, "Plume writes what the script prints");
        return true;
    }

    void tellWhatIsLost(const AutoKeySettings& settings, const Snippet& snippet) {
        const auto tell = [&](bool isLost, const std::string& what) {
            if (isLost) remarks_.add(snippet, what);
        };
        tell(!settings.isByAbbreviation && !settings.abbreviations.empty(), "its abbreviations are switched off");
        tell(settings.isByHotKey || !settings.hotKey.empty(),
             "Plume's snippets have no hot keys, as " + toUtf8(settings.hotKey) + " is one");
        tell(settings.isByPrediction, "Plume does not offer it while it is predicted from what is typed");
        tell(!settings.erasesAbbreviation && !settings.abbreviations.empty(),
             "Plume erases its abbreviation, which AutoKey left standing");
        tell(settings.asksFirst, "Plume does not ask before it writes it");
    }

    SnippetGroup& groupFor(const AutoKeySettings& settings, const Inherited& inherited, const Snippet& snippet,
                           std::map<GroupKey, std::shared_ptr<SnippetGroup>>& groups) {
        bool isOther = false;
        const auto delimiters = delimitersOfAutoKey(settings.wordCharacters, isOther);
        if (isOther) {
            remarks_.add(snippet, "the usual characters end its abbreviation, not those of the expression " +
                                      toUtf8(settings.wordCharacters));
        }
        const auto filter = settings.windowFilter ? settings.windowFilter : inherited.windowFilter;
        const ExpandAfter after = settings.expandsInside ? ExpandAfter::Anything : ExpandAfter::Delimiter;
        const ExpandTrigger trigger = settings.isImmediate    ? ExpandTrigger::Immediately
                                      : settings.omitsTrigger ? ExpandTrigger::DelimiterSwallowed
                                                              : ExpandTrigger::DelimiterKept;
        auto& group = groups[GroupKey(after, trigger, delimiters.value_or(u""), filter.value_or(u""))];
        if (group) return *group;
        group = SnippetGroup::make();
        group->setName(inherited.title.empty() ? u"AutoKey" : inherited.title);
        group->setExpandAfter(after);
        group->setExpandTrigger(trigger);
        if (delimiters) {
            group->setExpandAfterDelimiters(CharacterSet::withCharacters(*delimiters));
            group->setDelimiters(CharacterSet::withCharacters(*delimiters));
        }
        if (filter && !filter->empty()) limit(*group, *filter);
        library_.groups.push_back(group);
        return *group;
    }

    // Filters look for a window's title or for its class, "navigator.Firefox".
    void limit(SnippetGroup& group, const std::u16string& filter) {
        auto names = namesInPattern(filter);
        if (!names) {
            remarks_.add("the group \"" + toUtf8(*group.name()) +
                         "\": a list of applications cannot say the window filter " + toUtf8(filter));
            return;
        }
        for (std::u16string& name : *names) name.erase(0, name.rfind(u'.') + 1);
        std::erase_if(*names, [](const std::u16string& name) { return name.empty(); });
        group.availability().availability = PLFunctionAvailability::OnlyListed;
        group.availability().applications = std::move(*names);
    }

    const Files& files_;
    ImportedLibrary library_;
    Remarks remarks_;
    ScriptShelf scripts_;
    std::size_t count_ = 0;
};

// Its own settings, and no phrases.
bool isDataFolderOf(const Path& folder, const Files& files) {
    return files.exists(folder / "autokey.json") && files.isFolder(folder / "data");
}

bool holdsAutoKeyFiles(const Path& folder, const Files& files, std::size_t depth) {
    const auto entries = files.list(folder);
    if (!entries) return false;
    std::set<std::string> names;
    for (const Files::Entry& entry : entries.value()) names.insert(entry.name);
    return std::any_of(entries.value().begin(), entries.value().end(), [&](const Files::Entry& entry) {
        if (entry.isFolder) return depth > 0 && holdsAutoKeyFiles(folder / entry.name, files, depth - 1);
        const std::string stem = Path(entry.name).stem().string();
        return entry.name == ".folder.json" || entry.name == "folder.json" ||
               (isContent(entry.name) && (names.contains("." + stem + ".json") || names.contains(stem + ".json")));
    });
}

}  // namespace

bool isAutoKeyFolder(const Path& folder, const Files& files) {
    constexpr std::size_t LookedInto = 3;
    return isDataFolderOf(folder, files) || holdsAutoKeyFiles(folder, files, LookedInto);
}

Result<ImportedLibrary> importAutoKeyFolder(const Path& folder, const Files& files) {
    return readingJson([&] { return Reader(files).read(isDataFolderOf(folder, files) ? folder / "data" : folder); });
}

}  // namespace plume
