#include "bench/GeneratedLibrary.h"

#include <chrono>
#include <memory>
#include <optional>
#include <string>
#include <string_view>
#include <utility>

#include "Foundation/Date.h"
#include "Foundation/Strings.h"

namespace plume::bench {

namespace {

std::u16string numbered(const char* name, std::size_t number) {
    return fromUtf8(name + std::to_string(number));
}

constexpr std::u16string_view Sentence = u"The quick brown fox jumps over the lazy dog and runs away into the wood. ";

// Of 5 to 150 units, most of them short; one in eight is not ASCII.
std::u16string contentOf(std::size_t number) {
    std::u16string text = numbered("Text ", number);
    text += Sentence.substr(0, number * 7 % 73);
    if (number % 5 == 0) text += Sentence;
    if (number % 8 == 0) text += u" \u2014 na\u00EFve \U0001F600";
    return text;
}

SharedAttributes attributesOf(const char16_t* family, bool bold, double red) {
    auto attributes = std::make_shared<TextAttributes>();
    attributes->font = FontAttribute{family, 12, bold, false};
    if (red > 0) attributes->foregroundColor = ColorAttribute{red, 0, 0, 1};
    attributes->paragraphStyle.emplace().headIndent = 36;
    return attributes;
}

AttributedString richContentOf(std::size_t number) {
    AttributedString text(contentOf(number), attributesOf(u"Helvetica", false, 0));
    text.append(u" bold ", attributesOf(u"Helvetica", true, 0));
    text.append(u" red\n", attributesOf(u"Times", false, number % 2 == 0 ? 1 : 0.5));
    return text;
}

std::shared_ptr<Snippet> makeSnippet(std::size_t number, bool rich) {
    auto snippet = std::make_shared<Snippet>(numbered("abbr", number), contentOf(number));
    if (number % 3 != 0) snippet->setLabel(numbered("A label of snippet ", number));
    if (number % 20 == 0) snippet->setNote(u"A note.");
    if (rich) {
        snippet->setContentType(ContentType::RichText);
        snippet->setRichTextContent(richContentOf(number));
    }
    snippet->updateLastTimeUsed();
    return snippet;
}

}  // namespace

LibraryContents makeLibrary(std::size_t snippetsPerGroup, std::size_t richEvery) {
    Date now{std::chrono::seconds(1'700'000'000)};
    const ScopedDateSource dates([&now] { return now += std::chrono::microseconds(1'234'567'891); });
    LibraryContents library;
    library.dateInstalled = currentDate();
    for (std::size_t g = 0; g < GroupCount; ++g) {
        auto group = SnippetGroup::make();
        group->setName(numbered("Group ", g));
        if (g % 10 == 0) group->setDelimiters(CharacterSet::withCharacters(u" \t\r.,;"));
        for (std::size_t i = 0; i < snippetsPerGroup; ++i) {
            const std::size_t number = g * snippetsPerGroup + i;
            group->addItem(makeSnippet(number, richEvery != 0 && number % richEvery == 0));
        }
        library.snippetGroups.push_back(std::move(group));
    }
    return library;
}

}  // namespace plume::bench
