#include "app/cli/EditCommand.h"

#include <sys/wait.h>
#include <unistd.h>

#include <cstdlib>
#include <istream>
#include <ostream>
#include <string>

#include "app/cli/CommandLine.h"
#include "app/cli/UserLibrary.h"
#include "library/EditedLibrary.h"
#include "library/LibraryFile.h"
#include "ports/posix/PollRunLoop.h"

namespace plume {

namespace {

// A folder of the user's own for the text. It goes when the text has been taken, not before.
class EditedText {
  public:
    explicit EditedText(Files& files) : files_(files) {}

    Result<void> begin(const std::string& text) {
        const char* const runtime = std::getenv("XDG_RUNTIME_DIR");
        std::string folder = std::string(runtime && *runtime == '/' ? runtime : "/tmp") + "/plume-edit-XXXXXX";
        if (!mkdtemp(folder.data())) return Error{folder + " cannot be made; is the disk full?"};
        path_ = std::filesystem::path(folder) / "library.json";
        return files_.write(path_, text);
    }

    Result<std::string> read() const { return files_.read(path_); }
    const std::filesystem::path& path() const { return path_; }

    void remove() const {
        std::error_code ignored;
        std::filesystem::remove_all(path_.parent_path(), ignored);
    }

  private:
    Files& files_;
    std::filesystem::path path_;
};

std::string editorCommand() {
    for (const char* variable : {"VISUAL", "EDITOR"}) {
        const char* const value = std::getenv(variable);
        if (value && *value) return value;
    }
    return "$(command -v editor || command -v nano || echo vi)";
}

// As the shell would run it, so that options and quotes in $EDITOR count. Nothing when it did its work.
std::optional<std::string> runEditor(const std::filesystem::path& file) {
    const std::string command = editorCommand();
    const pid_t child = fork();
    if (child < 0) return "no process can be made for the editor";
    if (child == 0) {
        const std::string line = command + " \"$1\"";
        execl("/bin/sh", "sh", "-c", line.c_str(), "sh", file.c_str(), nullptr);
        _exit(127);
    }
    int status = 0;
    if (waitpid(child, &status, 0) == child && WIFEXITED(status) && WEXITSTATUS(status) == 0) return std::nullopt;
    return "the editor did not end well: " + command;
}

bool wantsToGoOn(std::istream& input, std::ostream& output) {
    if (isatty(STDIN_FILENO) == 0) return false;
    output << "Edit it again? [Y/n] " << std::flush;
    std::string answer;
    return std::getline(input, answer) && (answer.empty() || answer.front() == 'y' || answer.front() == 'Y');
}

class Edit {
  public:
    Edit(UserLibrary& library, std::istream& input, std::ostream& output, std::ostream& error)
        : library_(library), text_(library.files()), input_(input), output_(output), error_(error) {}

    int run() {
        const std::string before = LibraryFile::write(library_.manager().snippetGroups());
        if (const auto begun = text_.begin(before); !begun) return fail(begun.error().message, ExitStatus::Failure);
        for (;;) {
            if (const auto problem = runEditor(text_.path())) return failWithText(*problem, ExitStatus::Failure);
            const auto after = text_.read();
            if (!after) return failWithText(after.error().message, ExitStatus::Failure);
            if (after.value() == before) {
                text_.remove();
                output_ << "Nothing has changed.\n";
                return ExitStatus::Success;
            }
            const auto groups = LibraryFile::read(after.value(), text_.path().string());
            if (groups) return take(groups.value());
            error_ << "plume: " << groups.error().message << '\n';
            if (!wantsToGoOn(input_, output_)) return failWithText("nothing was changed", ExitStatus::WrongInput);
        }
    }

  private:
    int take(const SnippetGroups& edited) {
        DataManager& manager = library_.manager();
        const auto kept = manager.backups().backup();
        if (!kept) return failWithText(kept.error().message, ExitStatus::Failure);
        manager.snippetGroups() = takeEdits(manager.snippetGroups(), edited);
        manager.notifyDataChanged();
        if (const auto written = manager.writeJournal(); !written) {
            return failWithText(written.error().message, ExitStatus::Failure);
        }
        text_.remove();
        output_ << "The library is changed. What it was before is in " << kept.value().string() << ".\n";
        return ExitStatus::Success;
    }

    int fail(const std::string& sentence, int status) {
        error_ << "plume: " << sentence << '\n';
        return status;
    }

    int failWithText(const std::string& sentence, int status) {
        return fail(sentence + "; your text is in " + text_.path().string(), status);
    }

    UserLibrary& library_;
    EditedText text_;
    std::istream& input_;
    std::ostream& output_;
    std::ostream& error_;
};

}  // namespace

int editLibrary(std::istream& input, std::ostream& output, std::ostream& error) {
    PollRunLoop loop;
    const auto report = [&error](const std::string& sentence) { error << "plume: " << sentence << '\n'; };
    const auto library = UserLibrary::open({.loop = loop, .report = report});
    if (!library) {
        report(library.error().message);
        return ExitStatus::Failure;
    }
    return Edit(*library.value(), input, output, error).run();
}

}  // namespace plume
