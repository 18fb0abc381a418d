#include "app/cli/StoreCommands.h"

#include <algorithm>
#include <filesystem>
#include <numeric>
#include <ostream>
#include <utility>
#include <vector>

#include "Foundation/Strings.h"
#include "Foundation/Uuid.h"
#include "app/cli/UserLibrary.h"
#include "import/Importers.h"
#include "library/LibraryExport.h"
#include "library/LibraryFile.h"
#include "ports/posix/PollRunLoop.h"

namespace plume {

namespace {

using Path = std::filesystem::path;

constexpr const char16_t* GroupForAddedSnippets = u"My Snippets";

// One command on a library.
class StoreCommand {
  public:
    explicit StoreCommand(const StoreCommandContext& context) : context_(context) {}

    // Tells of the change and writes it down.
    int keep() {
        context_.manager.notifyDataChanged();
        return writeDown();
    }
    int writeDown() {
        if (const auto kept = context_.manager.writeJournal(); !kept) {
            return fail(kept.error().message, ExitStatus::Failure);
        }
        return ExitStatus::Success;
    }

    int fail(const std::string& sentence, int status) {
        context_.error << "plume: " << sentence << '\n';
        return status;
    }

    DataManager& manager() { return context_.manager; }
    std::ostream& output() { return context_.output; }
    Files& files() { return context_.files; }
    Path absolute(const std::string& file) const { return (context_.folder / file).lexically_normal(); }

  private:
    const StoreCommandContext& context_;
};

std::string nameOf(const SnippetGroup& group) {
    return "\"" + toUtf8(group.name().value_or(u"")) + "\"";
}

std::string countOf(std::size_t snippets) {
    return std::to_string(snippets) + (snippets == 1 ? " snippet" : " snippets");
}

std::size_t snippetCount(const SnippetGroups& groups) {
    return std::accumulate(groups.begin(), groups.end(), std::size_t{0},
                           [](std::size_t sum, const auto& group) { return sum + group->items().size(); });
}

struct Found {
    std::shared_ptr<SnippetGroup> group;
    std::shared_ptr<Snippet> snippet;
};

// Those whose abbreviation with its prefix is this text; if there are none, those whose abbreviation alone is.
std::vector<Found> snippetsTyped(const SnippetGroups& groups, const std::u16string& text) {
    std::vector<Found> whole;
    std::vector<Found> alone;
    for (const auto& group : groups) {
        for (const auto& snippet : group->items()) {
            if (snippet->abbreviationWithPrefix() == text) whole.push_back({group, snippet});
            if (snippet->abbreviation() == text) alone.push_back({group, snippet});
        }
    }
    return whole.empty() ? alone : whole;
}

std::shared_ptr<SnippetGroup> groupForAdding(DataManager& manager, const std::u16string& name) {
    if (auto known = manager.groupWithName(name)) return known;
    return manager.generateSnippetGroupSamples(name, {});
}

// The library as the file's ending says; nothing when files of that ending cannot be written.
std::optional<std::string> written(const LibraryContents& contents, const std::shared_ptr<SnippetGroup>& onlyGroup,
                                   const Path& file) {
    const std::string extension = extensionOf(file.filename().string());
    const SnippetGroups groups = onlyGroup ? SnippetGroups{onlyGroup} : contents.snippetGroups;
    if (extension == "json") return LibraryFile::write(groups);
    if (extension == "csv") return onlyGroup ? csvFromGroup(*onlyGroup) : csvFromLibrary(groups);
    if (extension != "plume") return std::nullopt;
    return onlyGroup ? groupArchive(onlyGroup, contents.dateInstalled) : libraryArchive(contents);
}

std::string cannotWrite(const Path& file) {
    return file.string() + ": a library can be written as .plume, .csv or .json, not as \"" +
           file.extension().string() + "\"";
}

std::string newestLast(const LibraryBackups& backups, std::ostream& output) {
    std::vector<LibraryBackups::Backup> all = backups.backups();
    std::stable_sort(all.begin(), all.end(), [](const auto& a, const auto& b) { return a.modified < b.modified; });
    for (const auto& backup : all) output << backup.path.string() << '\n';
    return all.empty() ? "there is no backup in " + backups.directory().string() : "";
}

int addSnippet(const CommandLine& line, StoreCommand command) {
    DataManager& manager = command.manager();
    const std::u16string abbreviation = fromUtf8(line.text);
    if (abbreviation.empty()) return command.fail("an abbreviation needs a character", ExitStatus::WrongInput);
    const auto group = groupForAdding(manager, line.group ? fromUtf8(*line.group) : GroupForAddedSnippets);
    if (group->findSnippetWithAbbreviation(abbreviation)) {
        return command.fail("the group " + nameOf(*group) + " has \"" + line.text +
                                "\" already; plume remove takes it away, plume edit changes it",
                            ExitStatus::Failure);
    }
    auto snippet = std::make_shared<Snippet>(abbreviation, fromUtf8(line.content));
    if (line.label) snippet->setLabel(fromUtf8(*line.label));
    group->addItem(snippet);
    const int status = command.keep();
    if (status == ExitStatus::Success) {
        command.output() << toUtf8(*snippet->abbreviationWithPrefix()) << " is in the group " << nameOf(*group)
                         << " now.\n";
    }
    return status;
}

int removeSnippet(const CommandLine& line, StoreCommand command) {
    DataManager& manager = command.manager();
    const std::vector<Found> found = snippetsTyped(manager.snippetGroups(), fromUtf8(line.text));
    if (found.empty()) {
        return command.fail("no snippet has the abbreviation \"" + line.text + "\"; plume list shows them all",
                            ExitStatus::Failure);
    }
    const bool isOne = std::all_of(found.begin(), found.end(),
                                   [&](const Found& each) { return each.snippet == found.front().snippet; });
    if (!isOne) {
        return command.fail(std::to_string(found.size()) + " snippets have the abbreviation \"" + line.text +
                                "\"; plume edit shows them",
                            ExitStatus::Failure);
    }
    for (const Found& each : found) each.group->removeItem(each.snippet);
    const int status = command.keep();
    if (status == ExitStatus::Success) {
        command.output() << "\"" << line.text << "\" is gone from the group " << nameOf(*found.front().group) << ".\n";
    }
    return status;
}

int importFiles(const CommandLine& line, StoreCommand command) {
    DataManager& manager = command.manager();
    int status = ExitStatus::Success;
    bool any = false;
    for (const std::string& file : line.files) {
        const ImportOptions options{.textExpanderPlaceholders = line.textExpanderPlaceholders};
        const auto imported = importLibrary(command.absolute(file), command.files(), options);
        if (!imported) {
            status = command.fail(imported.error().message, ExitStatus::WrongInput);
            continue;
        }
        if (!any && !manager.snippetGroups().empty()) {
            const auto kept = manager.backups().backup();
            if (!kept) return command.fail(kept.error().message, ExitStatus::Failure);
        }
        any = true;
        manager.append(imported.value());
        for (const std::string& remark : imported.value().remarks) command.output() << file << ": " << remark << '\n';
        command.output() << countOf(snippetCount(imported.value().groups)) << " from " << file << ".\n";
    }
    if (!any) return status;
    const int kept = command.keep();
    return kept == ExitStatus::Success ? status : kept;
}

int exportLibrary(const CommandLine& line, StoreCommand command) {
    DataManager& manager = command.manager();
    const Path file = command.absolute(line.files.front());
    std::shared_ptr<SnippetGroup> group;
    if (line.group) {
        group = manager.groupWithName(fromUtf8(*line.group));
        if (!group) return command.fail("no group is called \"" + *line.group + "\"", ExitStatus::WrongInput);
    }
    LibraryContents contents = manager.library();
    if (line.withPreferences) {
        if (group || extensionOf(file.filename().string()) != "plume") {
            return command.fail("only a whole library in a .plume file can hold settings", ExitStatus::WrongInput);
        }
        contents.preferences = manager.preferences();
    }
    const auto bytes = written(contents, group, file);
    if (!bytes) return command.fail(cannotWrite(file), ExitStatus::WrongInput);
    if (const auto kept = command.files().write(file, *bytes); !kept) {
        return command.fail(kept.error().message, ExitStatus::Failure);
    }
    return ExitStatus::Success;
}

int makeBackup(StoreCommand command) {
    DataManager& manager = command.manager();
    const auto kept = manager.backups().backup();
    if (!kept) return command.fail(kept.error().message, ExitStatus::Failure);
    command.output() << kept.value().string() << '\n';
    return ExitStatus::Success;
}

int listBackups(StoreCommand command) {
    DataManager& manager = command.manager();
    const std::string problem = newestLast(manager.backups(), command.output());
    return problem.empty() ? ExitStatus::Success : command.fail(problem, ExitStatus::Failure);
}

int restoreBackup(const CommandLine& line, StoreCommand command) {
    DataManager& manager = command.manager();
    Path file = command.absolute(line.files.front());
    if (line.files.front() == "latest") {
        const auto newest = manager.backups().newestBackup();
        if (!newest) {
            return command.fail("there is no backup in " + manager.backups().directory().string(), ExitStatus::Failure);
        }
        file = *newest;
    }
    const auto before = manager.restoreFile(file);
    if (!before) return command.fail(before.error().message, ExitStatus::WrongInput);
    if (const int status = command.writeDown(); status != ExitStatus::Success) return status;
    command.output() << "The library is that of " << file.string()
                     << " now: " << countOf(snippetCount(manager.snippetGroups())) << ".\nWhat it was before is in "
                     << before.value().string() << ".\n";
    return ExitStatus::Success;
}

}  // namespace

bool isStoreCommand(Command command) {
    switch (command) {
        case Command::Add:
        case Command::Remove:
        case Command::Import:
        case Command::Export:
        case Command::Backup:
        case Command::Backups:
        case Command::Restore:
            return true;
        default:
            return false;
    }
}

int performOnLibrary(const CommandLine& line, const StoreCommandContext& context) {
    StoreCommand command(context);
    switch (line.command) {
        case Command::Add:
            return addSnippet(line, command);
        case Command::Remove:
            return removeSnippet(line, command);
        case Command::Import:
            return importFiles(line, command);
        case Command::Export:
            return exportLibrary(line, command);
        case Command::Backup:
            return makeBackup(command);
        case Command::Backups:
            return listBackups(command);
        default:
            return restoreBackup(line, command);
    }
}

int performOnUsersLibrary(const CommandLine& line, std::ostream& output, std::ostream& error) {
    PollRunLoop loop;
    const auto say = [&error](const std::string& sentence) { error << "plume: " << sentence << '\n'; };
    const auto opened = UserLibrary::open({.loop = loop, .report = say});
    if (!opened) {
        say(opened.error().message);
        return ExitStatus::Failure;
    }
    UserLibrary& library = *opened.value();
    return performOnLibrary(line, {library.manager(), library.files(), std::filesystem::current_path(), output, error});
}

int convertFile(const CommandLine& line, std::ostream& output, std::ostream& error) {
    const auto fail = [&error](const std::string& sentence, int status) {
        error << "plume: " << sentence << '\n';
        return status;
    };
    PosixFiles files;
    const Path from = std::filesystem::absolute(line.files.front());
    const Path to = std::filesystem::absolute(line.files.back());
    const ImportOptions options{.textExpanderPlaceholders = line.textExpanderPlaceholders};
    const auto imported = importLibrary(from, files, options);
    if (!imported) return fail(imported.error().message, ExitStatus::WrongInput);
    const Date now = currentDate();
    const LibraryContents contents{imported.value().groups,   now, Uuid::random().toString(),
                                   Uuid::random().toString(), now, std::nullopt};
    const auto bytes = written(contents, nullptr, to);
    if (!bytes) return fail(cannotWrite(to), ExitStatus::WrongInput);
    if (const auto kept = files.write(to, *bytes); !kept) return fail(kept.error().message, ExitStatus::Failure);
    for (const std::string& remark : imported.value().remarks) output << remark << '\n';
    output << countOf(snippetCount(contents.snippetGroups)) << " in " << line.files.back() << ".\n";
    return ExitStatus::Success;
}

}  // namespace plume
