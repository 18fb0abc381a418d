#include "import/EspansoImporter.h"

#include <algorithm>
#include <array>
#include <map>
#include <memory>
#include <utility>

#include "Foundation/Strings.h"
#include "Foundation/text/HTMLImport.h"
#include "Foundation/text/MarkdownImport.h"
#include "import/EspansoFiles.h"
#include "import/EspansoVariables.h"
#include "import/ForeignFile.h"
#include "import/Remarks.h"

namespace plume {

namespace {

constexpr std::size_t LargestImage = std::size_t{16} << 20;

// Which sides of a trigger must not be within a word.
struct WordSides {
    bool left = false;
    bool right = false;

    auto operator<=>(const WordSides&) const = default;
};

bool flag(const YamlValue& match, std::string_view key) {
    const YamlValue* const value = match.find(key);
    return value && value->boolean();
}

WordSides wordSidesOf(const YamlValue& match) {
    const bool isWord = flag(match, "word");
    return {isWord || flag(match, "left_word"), isWord || flag(match, "right_word")};
}

std::u16string titleOf(const std::filesystem::path& path, WordSides sides) {
    const bool isPackage = path.stem() == "package" && path.has_parent_path();
    const std::u16string title = fromUtf8(isPackage ? path.parent_path().filename().string() : path.stem().string());
    if (sides.left && sides.right) return title + u" (whole words)";
    if (sides.left) return title + u" (starts of words)";
    return sides.right ? title + u" (ends of words)" : title;
}

// Whether a regular expression means only itself.
bool isLiteral(std::string_view pattern) {
    return pattern.find_first_of("\\^$.|?*+()[]{}") == std::string_view::npos;
}

class MatchReader {
  public:
    MatchReader(const EspansoFiles& library, const Files* files, Remarks& remarks)
        : library_(library), files_(files), remarks_(remarks), variables_(library.root, scripts_) {
        for (const EspansoFile& file : library.files) variables_.addGlobals(file.root->find("global_vars"));
    }

    std::vector<std::shared_ptr<SnippetGroup>> read() {
        for (const EspansoFile& file : library_.files) readFile(file);
        if (auto group = scripts_.group(u"espanso scripts")) groups_.push_back(std::move(group));
        return std::move(groups_);
    }

  private:
    void readFile(const EspansoFile& file) {
        tellUnknownKeys(file.root,
                        {"matches", "global_vars", "imports", "filter_title", "filter_class", "filter_exec",
                         "filter_os", "name", "parent", "anchors"},
                        file.path.string());
        own_.clear();
        const YamlValue* const matches = file.root->find("matches");
        if (!matches) return;
        for (const YamlValue::Pointer& match : matches->list()) readMatch(file, match->map());
    }

    void tellUnknownKeys(const YamlValue::Pointer& map, std::initializer_list<std::string_view> known,
                         const std::string& where) {
        for (const auto& [key, value] : map->members) {
            if (std::find(known.begin(), known.end(), key) == known.end()) {
                remarks_.add(std::string(where).append(": Plume has nothing for \"").append(key).append("\""));
            }
        }
    }

    void readMatch(const EspansoFile& file, const YamlValue& match) {
        std::vector<std::string> triggers;
        const YamlValue* const regex = match.find("regex");
        if (const YamlValue* const one = match.find("trigger")) triggers.push_back(one->string());
        if (const YamlValue* const many = match.find("triggers")) triggers = many->strings();
        if (triggers.empty() && regex && isLiteral(regex->string())) triggers.push_back(regex->text);
        if (triggers.empty() && !regex) match.fail(R"(expected "trigger", "triggers" or "regex" in a match)");
        if (triggers.empty()) {
            const auto snippet = add(file, match, std::nullopt);
            if (snippet)
                remarks_.add(*snippet,
                             "a regular expression triggers it, which Plume does not have; it has no abbreviation");
        }
        for (const std::string& trigger : triggers) add(file, match, fromUtf8(trigger));
    }

    std::shared_ptr<Snippet> add(const EspansoFile& file, const YamlValue& match, Snippet::Text abbreviation) {
        if (count_ == MostImportedSnippets) remarks_.add(file.path.string() + ": the rest of its matches is too many");
        if (++count_ > MostImportedSnippets) return nullptr;
        auto snippet = std::make_shared<Snippet>(std::move(abbreviation), std::nullopt);
        variables_.beginMatch(match, snippet->abbreviation().value_or(u"espanso"));
        if (!snippet->abbreviation()) snippet->setLabel(fromUtf8(match.find("regex")->text));
        if (const YamlValue* const label = match.find("label")) snippet->setLabel(fromUtf8(label->string()));
        setNote(match, *snippet);
        if (flag(match, "propagate_case")) snippet->setCaseSensitivity(CaseSensitivity::IgnoreCaseAndAdapt);
        setContent(file, match, *snippet);
        tellWhatIsLost(match, *snippet);
        groupFor(file, wordSidesOf(match)).addItem(snippet);
        return snippet;
    }

    static void setNote(const YamlValue& match, Snippet& snippet) {
        std::string note;
        if (const YamlValue* const comment = match.find("comment")) note = comment->string();
        if (const YamlValue* const terms = match.find("search_terms")) {
            if (!note.empty()) note += "\n";
            for (const std::string& term : terms->strings())
                note += (note.empty() || note.back() == '\n' ? "" : ", ") + term;
        }
        if (!note.empty()) snippet.setNote(fromUtf8(note));
    }

    void tellWhatIsLost(const YamlValue& match, const Snippet& snippet) {
        for (const std::string& problem : variables_.takeProblems()) remarks_.add(snippet, problem);
        const YamlValue* const style = match.find("uppercase_style");
        if (style && style->string() != "uppercase") {
            remarks_.add(snippet, "Plume writes all of it in capitals, not in the style \"" + style->text + "\"");
        }
        constexpr std::array<std::string_view, 21> Known = {
            "trigger",        "triggers", "regex",          "replace",
            "markdown",       "html",     "image_path",     "form",
            "form_fields",    "vars",     "word",           "left_word",
            "right_word",     "label",    "propagate_case", "uppercase_style",
            "search_terms",   "comment",  "paragraph",      "force_mode",
            "force_clipboard"};
        for (const auto& [key, value] : match.members) {
            if (std::find(Known.begin(), Known.end(), key) == Known.end()) {
                remarks_.add(snippet, "Plume has nothing for \"" + key + "\"");
            }
        }
    }

    void setContent(const EspansoFile& file, const YamlValue& match, Snippet& snippet) {
        if (const YamlValue* const text = match.find("replace")) {
            setPlain(fromUtf8(text->string()), snippet);
        } else if (const YamlValue* const form = match.find("form")) {
            snippet.setPlainTextContent(variables_.expand(fromUtf8(form->string()), true));
        } else if (const YamlValue* const markdown = match.find("markdown")) {
            setRich(attributedStringFromMarkdown(markdown->string()), snippet);
        } else if (const YamlValue* const html = match.find("html")) {
            setRich(attributedStringFromHTML(html->string()), snippet);
        } else if (const YamlValue* const image = match.find("image_path")) {
            setImage(file, image->string(), snippet);
        } else {
            match.fail(R"(expected "replace", "markdown", "html", "form" or "image_path" in a match)");
        }
    }

    void setPlain(std::u16string_view text, Snippet& snippet) {
        std::u16string script = variables_.scriptInsteadOf(text);
        const bool isScript = !script.empty();
        snippet.setPlainTextContent(isScript ? std::move(script) : variables_.expand(text));
        if (isScript) snippet.setContentType(ContentType::ShellScript);
    }

    void setRich(const AttributedString& text, Snippet& snippet) {
        snippet.setContentType(ContentType::RichText);
        snippet.setRichTextContent(variables_.expand(text));
    }

    void setImage(const EspansoFile& file, const std::string& name, Snippet& snippet) {
        constexpr std::string_view Root = "$CONFIG/";
        const bool isInRoot = name.starts_with(Root);
        const std::filesystem::path path =
            isInRoot ? library_.root / name.substr(Root.size()) : file.path.parent_path() / name;
        snippet.setContentType(ContentType::RichText);
        const Result<std::string> bytes =
            files_ ? files_->read(path) : Result<std::string>(Error{"there is no folder"});
        if (!bytes || bytes.value().size() > LargestImage) {
            remarks_.add(snippet, "its image cannot be read: " + path.string());
            snippet.setPlainTextContent(fromUtf8(path.string()));
            return;
        }
        auto look = std::make_shared<TextAttributes>();
        look->attachment = std::make_shared<const TextAttachment>(
            TextAttachment{fromUtf8(path.filename().string()), bytes.value(), {}});
        snippet.setRichTextContent(AttributedString(u"\xfffc", look));
    }

    SnippetGroup& groupFor(const EspansoFile& file, WordSides sides) {
        std::shared_ptr<SnippetGroup>& group = own_[sides];
        if (group) return *group;
        group = SnippetGroup::make();
        group->setName(titleOf(file.path, sides));
        group->setExpandAfter(sides.left ? ExpandAfter::Delimiter : ExpandAfter::Anything);
        group->setExpandTrigger(sides.right ? ExpandTrigger::DelimiterKept : ExpandTrigger::Immediately);
        group->availability() = file.availability;
        if (library_.wordSeparators) {
            const auto set = SnippetGroup::replaceNewlineCharacterByCarriageReturnCharacter(
                CharacterSet::withCharacters(*library_.wordSeparators));
            if (sides.left) group->setExpandAfterDelimiters(set);
            if (sides.right) group->setDelimiters(set);
        }
        groups_.push_back(group);
        return *group;
    }

    const EspansoFiles& library_;
    const Files* files_;
    Remarks& remarks_;
    ScriptShelf scripts_;
    EspansoVariables variables_;
    std::vector<std::shared_ptr<SnippetGroup>> groups_;
    std::map<WordSides, std::shared_ptr<SnippetGroup>> own_;  // of the file that is read
    std::size_t count_ = 0;
};

template <typename Load>
Result<ImportedLibrary> imported(const Files* files, Load load) {
    try {
        Remarks remarks;
        const EspansoFiles library = load(remarks);
        ImportedLibrary result;
        result.groups = MatchReader(library, files, remarks).read();
        result.remarks = remarks.take();
        return result;
    } catch (const YamlError& error) {
        return Error{error.what()};
    }
}

}  // namespace

bool isEspansoFolder(const std::filesystem::path& folder, const Files& files) {
    if (files.isFolder(folder / "match") || folder.filename() == "match") return true;
    const auto entries = files.list(folder);
    return entries && std::any_of(entries.value().begin(), entries.value().end(), [](const Files::Entry& entry) {
               return !entry.isFolder && (entry.name.ends_with(".yml") || entry.name.ends_with(".yaml"));
           });
}

Result<ImportedLibrary> importEspansoFolder(const std::filesystem::path& folder, const Files& files) {
    return imported(&files, [&](Remarks& remarks) { return espansoFilesIn(folder, files, remarks); });
}

// What the file imports and the images that it names are left out when only its bytes are at hand.
Result<ImportedLibrary> importEspanso(const ForeignFile& file) {
    return imported(file.files,
                    [&](Remarks& remarks) { return espansoFile(file.path, file.bytes, file.files, remarks); });
}

}  // namespace plume
