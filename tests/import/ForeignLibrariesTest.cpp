// Folders and files of other text expanders, as tests/import/data has them, and beside each what is made of it.
#include <gtest/gtest.h>

#include <filesystem>
#include <fstream>
#include <regex>
#include <sstream>

#include "Foundation/text/HTMLExport.h"
#include "ports/simulated/SimulatedFiles.h"
#include "tests/import/ImportSupport.h"

namespace plume::test {
namespace {

namespace fs = std::filesystem;

const fs::path Data = "tests/import/data";

std::string textOf(const fs::path& path) {
    std::ostringstream text;
    text << std::ifstream(path, std::ios::binary).rdbuf();
    return text.str();
}

// Puts the test data at the root of a disk in memory.
void copyDataTo(SimulatedFiles& files) {
    for (const auto& entry : fs::recursive_directory_iterator(Data)) {
        const fs::path path = "/" / entry.path().lexically_relative(Data);
        const bool isDone =
            bool(entry.is_directory() ? files.createFolder(path) : files.write(path, textOf(entry.path())));
        EXPECT_TRUE(isDone) << path;
    }
}

std::string onOneLine(std::string text) {
    return std::regex_replace(text, std::regex("\n"), "\\n");
}

void show(std::ostream& out, const Snippet& snippet) {
    const auto line = [](const Snippet::Text& text) { return onOneLine(toUtf8(*text)); };
    out << (snippet.abbreviation() ? line(snippet.abbreviation()) : "(none)");
    if (snippet.caseSensitivity() != CaseSensitivity::CaseSensitive) {
        out << " case:" << static_cast<int>(snippet.caseSensitivity());
    }
    if (snippet.label()) out << " label:" << line(snippet.label());
    if (snippet.note()) out << " note:" << line(snippet.note());
    out << (snippet.isScript() ? " => script " : " => ");
    const bool isRich = snippet.contentType() == ContentType::RichText && snippet.richTextContent();
    out << onOneLine(isRich ? htmlFromAttributedString(*snippet.richTextContent(), defaultExcludedTags())
                            : toUtf8(snippet.plainTextContent().value_or(u"(none)")))
        << "\n";
}

void show(std::ostream& out, const SnippetGroup& group) {
    out << "[" << toUtf8(group.name().value_or(u"nil")) << "] after:" << static_cast<int>(group.expandAfter())
        << " trigger:" << static_cast<int>(group.expandTrigger());
    if (group.expandAfterDelimiters()) out << " delimiters:" << toUtf8(group.expandAfterDelimiters()->characters());
    if (group.availability().applications) {
        out << (group.availability().availability == PLFunctionAvailability::OnlyListed ? " only:" : " except:");
        for (const auto& name : *group.availability().applications) out << toUtf8(name) << ",";
    }
    out << "\n";
    for (const auto& snippet : group.items()) show(out, *snippet);
}

std::string shownWhole(const Result<ImportedLibrary>& library) {
    if (!library) return "error: " + library.error().message + "\n";
    std::ostringstream out;
    for (const auto& group : library.value().groups) show(out, *group);
    for (const std::string& remark : library.value().remarks) out << "! " << remark << "\n";
    return std::regex_replace(out.str(), std::regex("uuid:[0-9A-F-]{36}"), "uuid:U");
}

TEST(ForeignLibraries, BecomeWhatIsExpected) {
    SimulatedFiles files;
    copyDataTo(files);
    for (const char* const name :
         {"espanso/all", "espanso/single/text.yml", "espanso/single/broken.yml", "espanso/single/variables.yml",
          "espanso/all/match/packages/greek", "autokey", "autokey-broken", "beeftext/comboList.json",
          "beeftext/broken.json", "beeftext/export.csv"}) {
        const fs::path expected = (Data / name).string() + ".expected";
        const std::string shown = shownWhole(importLibrary(fs::path("/") / name, files));
        if (std::getenv("PLUME_WRITE_EXPECTED")) std::ofstream(expected) << shown;
        EXPECT_EQ(shown, textOf(expected)) << name;
    }
}

TEST(ForeignLibraries, OfYamlAreBounded) {
    std::string bomb = "a0: &a0 [x, x, x, x, x, x, x, x, x, x]\n";
    for (int i = 1; i < 20; ++i) {
        const std::string before = "*a" + std::to_string(i - 1);
        bomb += "a" + std::to_string(i) + ": &a" + std::to_string(i) + " [";
        for (int k = 0; k < 10; ++k) bomb += before + ",";
        bomb += "]\n";
    }
    const std::string doubling = "global_vars:\n- {name: a0, type: echo, params: {echo: x}}\n";
    std::string nested = doubling;
    for (int i = 1; i < 15; ++i) {
        const std::string before = "{{a" + std::to_string(i - 1) + "}}";
        nested += "- {name: a" + std::to_string(i) + ", type: echo, params: {echo: '";
        for (int k = 0; k < 100; ++k) nested += before;
        nested += "'}}\n";
    }
    nested += "matches:\n- {trigger: t, replace: '{{a14}}'}\n";
    const std::pair<std::string, std::string> cases[] = {
        {bomb,
         "error: /x.yml: line 6, column 46: expected at most a million values and 64 MiB of text, counting what "
         "aliases repeat\n"},
        {std::string(100, '['), "error: /x.yml: line 1, column 33: expected at most 64 levels within each other\n"},
        {"matches: &m [*m]",
         "error: /x.yml: line 1, column 14: an alias within what it stands for; expected one that is complete\n"},
        {"a: 1\na: 2", "error: /x.yml: line 2, column 1: the key \"a\" stands twice; expected it once\n"},
    };
    for (const auto& [yaml, error] : cases) EXPECT_EQ(shownWhole(importFile("/x.yml", yaml)), error);
    EXPECT_LT(shownWhole(importFile("/x.yml", nested)).size(), std::size_t{64} << 20);
}

}  // namespace
}  // namespace plume::test
