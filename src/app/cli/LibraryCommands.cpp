#include "app/cli/LibraryCommands.h"

#include <algorithm>
#include <functional>
#include <memory>
#include <ostream>
#include <utility>

#include "Foundation/Strings.h"
#include "app/cli/CommandLine.h"
#include "content/NestedScripts.h"
#include "content/SnippetParser.h"
#include "content/scripts/ShellScriptRunner.h"
#include "library/SnippetUtils.h"
#include "ports/posix/PosixProcessLauncher.h"

namespace plume {

namespace {

using Filter = std::function<bool(const Snippet&)>;

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

// The first line, as much of it as suits a list.
std::u16string beginning(const std::u16string& content) {
    constexpr std::size_t Most = 60;
    const std::u16string_view line = trimmed(std::u16string_view(content).substr(0, content.find(u'\n')));
    if (line.size() <= Most && line.size() == trimmed(content).size()) return std::u16string(line);
    std::size_t length = std::min(line.size(), Most);
    const bool cutsPair = length < line.size() && (line[length] & 0xFC00) == 0xDC00;
    if (cutsPair) --length;
    return std::u16string(trimmed(line.substr(0, length))) + u" …";
}

std::string kindOf(const Snippet& snippet) {
    if (snippet.isScript()) return "  [script]";
    return snippet.contentType() == ContentType::RichText ? "  [rich text]" : "";
}

std::size_t codePoints(std::u16string_view text) {
    return static_cast<std::size_t>(
        std::count_if(text.begin(), text.end(), [](char16_t unit) { return (unit & 0xFC00) != 0xDC00; }));
}

void showSnippet(const Snippet& snippet, std::size_t width, std::ostream& output) {
    const std::u16string abbreviation = snippet.abbreviationWithPrefix().value_or(u"");
    const std::u16string label = snippet.label().value_or(u"");
    output << "  " << toUtf8(abbreviation) << std::string(width - codePoints(abbreviation) + 2, ' ');
    if (!label.empty()) output << toUtf8(label) << ": ";
    output << toUtf8(beginning(snippet.plainTextContent().value_or(u""))) << kindOf(snippet) << '\n';
}

// The groups with those of their snippets that pass. How many did.
std::size_t show(const ChosenLibrary& library, const Filter& passes, std::ostream& output) {
    std::size_t count = 0;
    for (const auto& group : library.groups) {
        std::vector<const Snippet*> shown;
        std::size_t width = 0;
        for (const auto& snippet : group->items()) {
            if (!passes(*snippet)) continue;
            shown.push_back(snippet.get());
            width = std::max(width, codePoints(snippet->abbreviationWithPrefix().value_or(u"")));
        }
        if (shown.empty()) continue;
        output << (count > 0 ? "\n" : "") << toUtf8(group->name().value_or(u"")) << " (" << whenItExpands(*group)
               << ")\n";
        for (const Snippet* snippet : shown) showSnippet(*snippet, width, output);
        count += shown.size();
    }
    return count;
}

bool holds(const Snippet& snippet, std::u16string_view word) {
    for (const Snippet::Text& text :
         {snippet.abbreviationWithPrefix(), snippet.label(), snippet.plainTextContent(), snippet.note()}) {
        if (text && containsIgnoringCase(*text, word)) return true;
    }
    return false;
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

int listSnippets(const ChosenLibrary& library, std::ostream& output) {
    show(
        library, [](const Snippet&) { return true; }, output);
    return ExitStatus::Success;
}

int searchSnippets(const ChosenLibrary& library, const std::string& text, std::ostream& output, std::ostream& error) {
    const std::vector<std::u16string> words = split(fromUtf8(text), u' ');
    const auto holdsAll = [&](const Snippet& snippet) {
        return std::all_of(words.begin(), words.end(),
                           [&](const std::u16string& word) { return word.empty() || holds(snippet, word); });
    };
    if (show(library, holdsAll, output) > 0) return ExitStatus::Success;
    error << "plume: no snippet in " << library.file.string() << " holds \"" << text << "\"\n";
    return ExitStatus::Failure;
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
