// Libraries of separated values: abbreviation, content and label, without a heading.
#include <algorithm>
#include <array>
#include <utility>

#include "Foundation/Strings.h"
#include "Foundation/text/CSV.h"
#include "import/ForeignFile.h"
#include "import/Remarks.h"
#include "import/TextExpanderMacros.h"
#include "import/TextFile.h"

namespace plume {

namespace {

constexpr const char16_t* Abbreviation = u"Name";
constexpr const char16_t* Content = u"Value";
constexpr const char16_t* Label = u"Label";
constexpr const char* Expected = "expected abbreviation,text,label on each line";

CSVParser parserOf(std::u16string text, char16_t separator) {
    return {std::move(text), std::u16string(1, separator), std::nullopt, false, {Abbreviation, Content, Label}};
}

std::u16string take(CSVParser::Row& row, const char16_t* column) {
    const auto found = row.find(column);
    return found != row.end() ? std::move(found->second) : std::u16string();
}

// Whether every record of the beginning has an abbreviation and a content when it is read with this separator.
bool separatesAll(const std::u16string& text, char16_t separator) {
    constexpr std::size_t Looked = 16384;
    CSVParser parser = parserOf(text.substr(0, Looked), separator);
    auto rows = parser.arrayOfParsedRows();
    if (!rows) return false;
    if (text.size() > Looked) rows->pop_back();  // it may be cut
    return !rows->empty() && std::all_of(rows->begin(), rows->end(), [](CSVParser::Row& row) {
        return row.contains(Content) && !take(row, Abbreviation).empty();
    });
}

// A comma, unless only another separator makes sense of every record.
char16_t separatorOf(const std::u16string& text) {
    if (separatesAll(text, u',')) return u',';
    if (separatesAll(text, u';')) return u';';
    return separatesAll(text, u'\t') ? u'\t' : u',';
}

// The text with quotes doubled that are escaped by a backslash.
std::u16string withDoubledQuotes(std::u16string_view text) {
    std::u16string result;
    result.reserve(text.size());
    for (std::size_t i = 0; i < text.size(); ++i) {
        const bool isEscape = text[i] == u'\\' && i + 1 < text.size() && text[i + 1] == u'"';
        const bool isEscaped = i > 0 && text[i - 1] == u'\\';
        result += isEscape && !isEscaped ? u'"' : text[i];
    }
    return result;
}

class CsvReading {
  public:
    CsvReading(std::u16string text, bool convertsMacros)
        : text_(std::move(text)), separator_(separatorOf(text_)), convertsMacros_(convertsMacros) {}

    Result<ImportedLibrary> read(const ForeignFile& file) {
        const bool readsToEnd = parse();
        if (!readsToEnd && stoppedAt_ > 0) readEscapedQuotes();
        if (snippets_.empty()) return file.fault("line 1: no snippet could be read; " + std::string(Expected));
        if (convertsMacros_) {
            for (const auto& snippet : snippets_) remarks_.addAll(*snippet, convertTextExpanderMacros(*snippet));
        } else {
            tellOfMacros();
        }
        tellOfRest();
        auto group = SnippetGroup::make();
        group->setName(file.title());
        group->addItems(snippets_);
        return ImportedLibrary{{std::move(group)}, remarks_.take()};
    }

  private:
    bool parse() {
        snippets_.clear();
        tooMany_ = longer_ = 0;
        CSVParser parser = parserOf(text_, separator_);
        parser.parseRowsForReceiver([&](CSVParser::Row row) { add(std::move(row)); });
        stoppedAt_ = parser.position();
        return stoppedAt_ == text_.size();
    }

    void add(CSVParser::Row row) {
        if (snippets_.size() == MostImportedSnippets) {
            ++tooMany_;
            return;
        }
        longer_ += row.size() > 3;
        auto snippet = std::make_shared<Snippet>(take(row, Abbreviation), take(row, Content));
        snippet->setLabel(take(row, Label));
        snippets_.push_back(std::move(snippet));
    }

    // Where quotes break the rules they may be escaped in another way; that holds when it makes sense of more.
    void readEscapedQuotes() {
        std::u16string other = withDoubledQuotes(text_);
        if (other == text_) return;
        const std::size_t before = stoppedAt_;
        std::swap(text_, other);
        parse();
        if (stoppedAt_ > before) return;
        std::swap(text_, other);
        parse();
    }

    void tellOfMacros() {
        const auto count = std::count_if(snippets_.begin(), snippets_.end(), [](const auto& snippet) {
            return holdsTextExpanderMacros(snippet->richTextContent()->string());
        });
        remarks_.addCount(static_cast<std::size_t>(count),
                          "snippet seems to hold placeholders of TextExpander, which stay as text",
                          "snippets seem to hold placeholders of TextExpander, which stay as text");
    }

    void tellOfRest() {
        remarks_.addCount(longer_, "record has more than three columns; only the first three are taken",
                          "records have more than three columns; only the first three are taken");
        remarks_.addTooMany(tooMany_);
        if (stoppedAt_ == text_.size()) return;
        remarks_.add("line " + std::to_string(lineNumberAt(text_, stoppedAt_)) +
                     ": a double quote breaks the record; nothing from there on is read");
    }

    std::u16string text_;
    char16_t separator_;
    bool convertsMacros_;
    std::vector<std::shared_ptr<Snippet>> snippets_;
    std::size_t stoppedAt_ = 0;
    std::size_t tooMany_ = 0;
    std::size_t longer_ = 0;
    Remarks remarks_;
};

}  // namespace

Result<ImportedLibrary> importCsv(const ForeignFile& file) {
    Result<std::u16string> text = textOfFile(file.bytes, CodePage::MacRoman);
    if (!text) return file.fault(text.error().message);
    return CsvReading(std::move(text).value(), file.options.textExpanderPlaceholders).read(file);
}

}  // namespace plume
