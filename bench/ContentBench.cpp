// How long an expansion waits for its content: placeholders, dates, the shell.
#include <cstdlib>
#include <memory>
#include <string>

#include "bench/Figures.h"
#include "content/SnippetDateTimeVariable.h"
#include "content/SnippetParser.h"
#include "content/scripts/ShellScriptRunner.h"
#include "library/Snippet.h"
#include "ports/posix/PosixProcessLauncher.h"

namespace plume::bench {
namespace {

// A benchmark of something that does not work would be worth nothing.
void require(bool condition) {
    if (!condition) std::abort();
}

class SmallPasteboard final : public PasteboardReader {
  public:
    std::vector<std::string> types() const override { return {std::string(PasteboardType::String)}; }
    std::optional<std::u16string> string() const override { return u"https://example.org/page"; }
    std::optional<std::string> data(std::string_view) const override { return std::nullopt; }
};

const SmallPasteboard pasteboard;

ContentEnvironment makeEnvironment() {
    ContentEnvironment environment;
    environment.timeZone = "Europe/Berlin";
    environment.locale = "en_US";
    environment.pasteboard = &pasteboard;
    return environment;
}

std::shared_ptr<Snippet> makePlain(std::u16string content) {
    return std::make_shared<Snippet>(u"abbr", std::move(content));
}

constexpr std::u16string_view Sentence = u"The quick brown fox jumps over the lazy dog and runs away into the wood. ";

// Plain text of `length` units.
std::u16string filler(std::size_t length) {
    std::u16string text;
    while (text.size() < length) text += Sentence.substr(0, length - text.size());
    return text;
}

// The middle of several timings of `batch` expansions each, in nanoseconds for one.
double nanosecondsOfParsing(const std::shared_ptr<Snippet>& snippet, std::size_t variableCount, int runs, int batch) {
    SnippetParser parser(makeEnvironment());
    const SnippetParser::Groups groups;
    const auto expansion = parser.parseSnippet(snippet, groups);
    require(expansion && expansion->variables.size() == variableCount);
    require(expansion->string().find(u'\u3010') == std::u16string::npos);
    return medianNanoseconds(runs,
                             [&] {
                                 for (int i = 0; i < batch; ++i)
                                     require(parser.parseSnippet(snippet, groups) != nullptr);
                             }) /
           batch;
}

void benchShort() {
    const std::u16string start = u"Seen 【date:yyyy-MM-dd】 at 【clipboard】: 【|】";
    const auto snippet = makePlain(start + filler(200 - start.size()));
    print("content.parse.short", nanosecondsOfParsing(snippet, 1, 101, 200) / 1e3, "us");
}

// 1,000,000 units, 10,000 placeholders of five kinds in turn.
void benchLong() {
    constexpr std::size_t Count = 10'000, Length = 1'000'000;
    const std::u16string_view placeholders[] = {u"【date:yyyy-MM-dd】", u"【clipboard】", u"【key:⇥ code:48】",
                                                u"【field:Name value:Jo】", u"【time:HH:mm day:1】"};
    std::u16string content;
    for (std::size_t i = 0; i < Count; ++i) {
        const auto placeholder = placeholders[i % 5];
        content += filler(Length / Count - placeholder.size());
        content += placeholder;
    }
    require(content.size() == Length);
    print("content.parse.long", nanosecondsOfParsing(makePlain(std::move(content)), Count / 5 * 2, 15, 1) / 1e6, "ms");
}

// Rich text of 10,000 runs of 20 units; one run in ten is a placeholder.
void benchRich() {
    constexpr std::size_t Count = 10'000;
    AttributedString content;
    for (std::size_t i = 0; i < Count; ++i) {
        TextAttributes attributes;
        attributes.font = FontAttribute{u"Helvetica", 12, i % 2 == 0, false};
        const bool isPlaceholder = i % 10 == 0;
        content.append(isPlaceholder ? std::u16string(u"【date:EEE, MMM d yyy】") : filler(20),
                       std::make_shared<TextAttributes>(attributes));
    }
    require(content.runs().size() == Count);
    const auto snippet = makePlain(u"");
    snippet->setContentType(ContentType::RichText);
    snippet->setRichTextContent(std::move(content));
    print("content.parse.rich", nanosecondsOfParsing(snippet, 0, 31, 1) / 1e6, "ms");
}

void benchDate() {
    const ContentEnvironment environment = makeEnvironment();
    SnippetDateVariable variable;
    variable.format = u"EEEE, d MMMM yyyy";
    variable.day = 1;
    require(!variable.value(environment).empty());
    constexpr int Batch = 100;
    const double batch = medianNanoseconds(101, [&] {
        for (int i = 0; i < Batch; ++i) require(!variable.value(environment).empty());
    });
    print("content.date", batch / Batch / 1e3, "us");
}

void benchShell() {
    PosixProcessLauncher launcher;
    ShellScriptRunner runner(launcher, [](const std::string&) {});
    require(runner.run(u"echo hi", false) == u"hi");
    print("content.shell", medianNanoseconds(201, [&] { require(runner.run(u"echo hi", false) == u"hi"); }) / 1e6,
          "ms");
}

}  // namespace
}  // namespace plume::bench

int main() {
    plume::bench::benchShort();
    plume::bench::benchLong();
    plume::bench::benchRich();
    plume::bench::benchDate();
    plume::bench::benchShell();
}
