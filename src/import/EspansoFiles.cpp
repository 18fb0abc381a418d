#include "import/EspansoFiles.h"

#include <algorithm>
#include <set>
#include <utility>

#include "Foundation/Strings.h"
#include "import/EspansoConfigs.h"

namespace plume {

namespace {

using Path = std::filesystem::path;

constexpr std::size_t MostFiles = 5000;
constexpr std::size_t DeepestFolder = 16;

bool isYaml(const std::string& name) {
    return name.ends_with(".yml") || name.ends_with(".yaml");
}

class Loader {
  public:
    Loader(const Files* files, Remarks& remarks) : files_(files), remarks_(remarks) {}

    EspansoFiles take() { return std::move(result_); }

    void loadFolder(const Path& folder) {
        const bool isMatchFolder = folder.filename() == "match";
        result_.root = isMatchFolder ? folder.parent_path() : folder;
        Path matches = isMatchFolder ? folder : folder / "match";
        if (!files_->isFolder(matches)) matches = folder;
        std::vector<Path> found;
        listFiles(matches, 0, found);
        std::sort(found.begin(), found.end());
        readConfigs(result_.root / "config");
        if (default_) {
            loadAsConfigured(found);
        } else {
            std::erase_if(found, [](const Path& path) { return path.filename().string().starts_with('_'); });
            std::set<Path> active(found.begin(), found.end());
            addImports(active);
            for (const Path& path : active) load(path, PLFunctionAvailability{});
        }
        if (result_.files.empty()) {
            throw YamlError(folder.string() + ": no file of matches is in this folder; expected match/*.yml");
        }
    }

    void loadBytes(const Path& path, std::string_view bytes) {
        parsed_[path] = readYaml(bytes, path.string());
        load(path, PLFunctionAvailability{});
        std::set<Path> active = {path};
        addImports(active);
        active.erase(path);
        for (const Path& import : active) load(import, PLFunctionAvailability{});
    }

  private:
    void listFiles(const Path& folder, std::size_t depth, std::vector<Path>& found) {
        const auto entries = files_->list(folder);
        if (!entries) throw YamlError(entries.error().message);
        for (const Files::Entry& entry : entries.value()) {
            if (entry.name.starts_with('.')) continue;
            const Path path = folder / entry.name;
            if (entry.isFolder && depth < DeepestFolder && entry.name != "config") {
                listFiles(path, depth + 1, found);
            } else if (!entry.isFolder && isYaml(entry.name)) {
                if (found.size() >= MostFiles)
                    throw YamlError(folder.string() + ": expected at most 5000 files of matches");
                found.push_back(path);
            }
        }
    }

    const YamlValue::Pointer& parse(const Path& path) {
        YamlValue::Pointer& root = parsed_[path];
        if (root) return root;
        const Result<std::string> bytes = files_->read(path);
        if (!bytes) throw YamlError(bytes.error().message);
        root = readYaml(bytes.value(), path.string());
        return root;
    }

    void readConfigs(const Path& folder) {
        if (!files_->isFolder(folder)) return;
        const Path defaults = folder / "default.yml";
        const YamlValue::Pointer none = std::make_shared<const YamlValue>();
        default_.emplace(defaults, files_->exists(defaults) ? parse(defaults) : none, nullptr, remarks_);
        result_.wordSeparators = default_->wordSeparators();
        std::vector<Path> paths;
        listFiles(folder, DeepestFolder, paths);
        std::sort(paths.begin(), paths.end());
        for (const Path& path : paths) {
            if (path == defaults) continue;
            EspansoConfig config(path, parse(path), &*default_, remarks_);
            if (!config.isForOtherSystems()) configs_.push_back(std::move(config));
        }
    }

    // With the files that a file imports, which are active wherever it is.
    void addImports(std::set<Path>& active) {
        std::vector<Path> open(active.begin(), active.end());
        while (!open.empty()) {
            const Path path = open.back();
            open.pop_back();
            for (const Path& import : importsOf(path)) {
                if (active.insert(import).second) open.push_back(import);
            }
            if (active.size() > MostFiles) throw YamlError(path.string() + ": expected at most 5000 imported files");
        }
    }

    std::vector<Path> importsOf(const Path& path) {
        std::vector<Path> imports;
        const YamlValue::Pointer root = parse(path);
        const YamlValue* const list = root->find("imports");
        if (!list) return imports;
        for (const std::string& name : list->strings()) {
            const Path import = (path.parent_path() / name).lexically_normal();
            if (files_ && files_->exists(import)) {
                imports.push_back(import);
            } else if (missing_.insert(import).second) {
                remarks_.add(path.string() + ": the file " + name + ", which it imports, cannot be found");
            }
        }
        return imports;
    }

    std::set<Path> activeIn(const EspansoConfig& config, const std::vector<Path>& all) {
        std::set<Path> active;
        for (const Path& path : all) {
            if (config.includes(path)) active.insert(path);
        }
        addImports(active);
        return active;
    }

    void loadAsConfigured(const std::vector<Path>& all) {
        const std::set<Path> everywhere = activeIn(*default_, all);
        std::vector<std::set<Path>> active;
        std::set<Path> any = everywhere;
        for (const EspansoConfig& config : configs_) {
            active.push_back(activeIn(config, all));
            any.insert(active.back().begin(), active.back().end());
        }
        for (const Path& path : any) load(path, availabilityOf(path, everywhere.contains(path), active));
    }

    // Listed are the applications that see it otherwise than all others.
    PLFunctionAvailability availabilityOf(const Path& path, bool isEverywhere,
                                          const std::vector<std::set<Path>>& active) {
        std::vector<std::u16string> listed;
        bool isOnlyThere = !isEverywhere;
        for (std::size_t i = 0; i < configs_.size(); ++i) {
            if (active[i].contains(path) == isEverywhere) continue;
            const auto& names = configs_[i].applications();
            if (names.empty() && !isEverywhere) {
                remarks_.add(path.string() + ": it is active in some windows only, and in all of them in Plume");
                isOnlyThere = false;
            }
            listed.insert(listed.end(), names.begin(), names.end());
        }
        PLFunctionAvailability availability;
        if (listed.empty() || (!isEverywhere && !isOnlyThere)) return availability;
        availability.availability =
            isEverywhere ? PLFunctionAvailability::ExceptListed : PLFunctionAvailability::OnlyListed;
        availability.applications = std::move(listed);
        return availability;
    }

    void load(const Path& path, PLFunctionAvailability availability) {
        const YamlValue::Pointer root = parse(path);
        if (root->kind != YamlValue::Kind::Null) root->map();
        const auto applications = espansoApplications(*root, remarks_);
        if (!applications.empty()) availability = {PLFunctionAvailability::OnlyListed, applications, 0, {}};
        result_.files.push_back({path, root, availability});
    }

    const Files* files_;
    Remarks& remarks_;
    EspansoFiles result_;
    std::map<Path, YamlValue::Pointer> parsed_;
    std::set<Path> missing_;
    std::optional<EspansoConfig> default_;
    std::vector<EspansoConfig> configs_;
};

}  // namespace

EspansoFiles espansoFilesIn(const Path& path, const Files& files, Remarks& remarks) {
    Loader loader(&files, remarks);
    loader.loadFolder(path);
    return loader.take();
}

EspansoFiles espansoFile(const Path& path, std::string_view bytes, const Files* files, Remarks& remarks) {
    Loader loader(files, remarks);
    loader.loadBytes(path, bytes);
    return loader.take();
}

}  // namespace plume
