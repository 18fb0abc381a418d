#include "app/cli/LibraryCommands.h"

#include <algorithm>
#include <memory>
#include <ostream>
#include <utility>

#include "Foundation/Strings.h"
#include "app/cli/CommandLine.h"
#include "app/cli/SnippetLine.h"
#include "content/NestedScripts.h"
#include "content/SnippetParser.h"
#include "content/scripts/ShellScriptRunner.h"
#include "library/SnippetUtils.h"
#include "ports/posix/PosixProcessLauncher.h"

namespace plume {

namespace {

// ---- Showing ----

std::string whenItExpands(const SnippetGroup& group) {
    switch (group.expandTrigger()) {
        case ExpandTrigger::Immediately:
            return "expands as soon as it is typed";
        case ExpandTrigger::DelimiterKept:
            return "expands after a space or punctuation, which stays";
        case ExpandTrigger::DelimiterSwallowed:
            return "expands after a space or punctuation, which goes";
        case ExpandTrigger::Never:
            return "for other snippets, does not expand by itself";
        case ExpandTrigger::HotKey:
            return "expands at the hot key";
    }
    return "";
}

// One abbreviation a line: those that hold a line break themselves are left out.
void listAbbreviations(const ChosenLibrary& library, std::ostream& output) {
    for (const auto& group : library.groups) {
        for (const auto& snippet : group->items()) {
            const std::u16string typed = snippet->abbreviationWithPrefix().value_or(u"");
            if (!typed.empty() && typed.find_first_of(u"\r\n") == std::u16string::npos) output << toUtf8(typed) << '\n';
        }
    }
}

void showGroup(const SnippetGroup& group, std::ostream& output) {
    output << toUtf8(group.name().value_or(u"")) << " (" << whenItExpands(group) << ")\n";
    std::size_t width = 0;
    for (const auto& snippet : group.items()) width = std::max(width, typedWidth(*snippet));
    for (const auto& snippet : group.items()) output << snippetLine(*snippet, width) << '\n';
}

// ---- Expanding ----

std::shared_ptr<Snippet> findSnippet(const ChosenLibrary& library, const std::u16string& abbreviation) {
    auto snippet = SnippetUtils::findSnippetByAbbreviation(abbreviation, library.groups, true);
    return snippet ? snippet : SnippetUtils::findSnippetByAbbreviation(abbreviation, library.groups);
}

std::u16string runScripts(const Snippet& snippet, SnippetExpandedContent& content, ScriptRunner& runner) {
    processScripts(content);
    for (const auto& script : content.scripts) script->execute(runner);
    mergeScriptResults(content);
    if (!snippet.isScript()) return content.copyString();
    PLScript script;
    script.script = content.string();
    script.isAppleScript = snippet.contentType() == ContentType::AppleScript;
    script.execute(runner);
    return script.result.value_or(u"");
}

}  // namespace

int listSnippets(const ChosenLibrary& library, bool onlyAbbreviations, std::ostream& output) {
    if (onlyAbbreviations) {
        listAbbreviations(library, output);
        return ExitStatus::Success;
    }
    bool isFirst = true;
    for (const auto& group : library.groups) {
        if (group->items().empty()) continue;
        if (!std::exchange(isFirst, false)) output << '\n';
        showGroup(*group, output);
    }
    return ExitStatus::Success;
}

int expandSnippet(const ChosenLibrary& library, const std::string& abbreviation, std::ostream& output,
                  std::ostream& error) {
    const std::shared_ptr<Snippet> snippet = findSnippet(library, fromUtf8(abbreviation));
    if (!snippet) {
        error << "plume: no snippet in " << library.file.string() << " has the abbreviation \"" << abbreviation
              << "\"; plume list shows them all\n";
        return ExitStatus::Failure;
    }
    const auto report = [&error](const std::string& sentence) { error << "plume: " << sentence << '\n'; };
    ContentEnvironment environment;
    environment.report = report;
    const auto content = SnippetParser(environment).parseSnippet(snippet, library.groups);
    if (!content) {
        error << "plume: \"" << abbreviation << "\" cannot be expanded\n";
        return ExitStatus::Failure;
    }
    if (!content->fields().empty()) {
        error << "plume: \"" << abbreviation
              << "\" asks for values in a form, which is not possible on the command line\n";
        return ExitStatus::Failure;
    }
    PosixProcessLauncher launcher;
    ShellScriptRunner runner(launcher, report);
    const std::u16string text = runScripts(*snippet, *content, runner);
    if (runner.allSucceeded() || !text.empty()) output << toUtf8(text) << '\n';
    if (!runner.allSucceeded()) {
        error << "plume: a script of \"" << abbreviation << "\" did not succeed\n";
        return ExitStatus::Failure;
    }
    return ExitStatus::Success;
}

}  // namespace plume
