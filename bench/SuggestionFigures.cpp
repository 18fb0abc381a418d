// How long the list of what the letters may become takes, by the size of the library.
#include <random>
#include <string>
#include <vector>

#include "bench/Figures.h"
#include "bench/GeneratedLibrary.h"
#include "bench/SearchFigures.h"
#include "engine/AutoText.h"
#include "engine/SnippetMatcher.h"

namespace plume::bench {

namespace {

using Groups = SnippetMatcher::Groups;

// Three to twelve letters or digits, the first one a consonant.
std::u16string randomAbbreviation(std::mt19937& random) {
    std::u16string text(1, u"bcdfghjklmnpqrstvwxz"[random() % 20]);
    for (std::size_t length = 2 + random() % 10; length > 0; --length) {
        text += u"abcdefghijklmnopqrstuvwxyz0123456789"[random() % 36];
    }
    return text;
}

// A third of the groups within words too, a third after white space only; a quarter with a prefix.
Groups suggestingGroups(std::size_t size, std::mt19937& random) {
    Groups groups = makeLibrary(size / GroupCount, 0).snippetGroups;
    for (std::size_t i = 0; i < groups.size(); ++i) {
        groups[i]->setExpandAfter(static_cast<ExpandAfter>(i % 3));
        if (i % 4 == 1) groups[i]->setAbbreviationPrefix(i % 8 == 1 ? u";" : u";;");
        for (const auto& snippet : groups[i]->items()) {
            snippet->setAbbreviation(randomAbbreviation(random));
            snippet->setCaseSensitivity(static_cast<CaseSensitivity>(random() % 3));
        }
    }
    return groups;
}

// Forty words, and then the first two to four letters of an abbreviation, behind its prefix.
std::vector<std::u16string> typedBuffers(const Groups& groups, std::mt19937& random) {
    constexpr std::size_t Buffers = 500;
    std::vector<std::u16string> buffers;
    for (std::size_t i = 0; i < Buffers; ++i) {
        std::u16string text;
        for (int word = 0; word < 40; ++word) {
            for (std::size_t n = 1 + random() % 7; n > 0; --n) text += u"abcdefghijklmnopqrstuvwxyz"[random() % 26];
            text += random() % 8 != 0 ? u" " : u", ";
        }
        const SnippetGroup& group = *groups[random() % groups.size()];
        const Snippet& snippet = *group.items()[random() % group.items().size()];
        text += group.abbreviationPrefix().value_or(u"");
        buffers.push_back(text + snippet.abbreviation()->substr(0, 2 + random() % 3));
    }
    return buffers;
}

void printComputing(std::size_t size) {
    std::mt19937 random{25};  // the same library in every run
    const Groups groups = suggestingGroups(size, random);
    SnippetMatcher matcher(AutoText::defaultDelimiters());
    matcher.setSnippetGroups(groups);
    SuggestionList list;
    std::vector<double> times;
    std::size_t found = 0;
    const std::vector<std::u16string> buffers = typedBuffers(groups, random);
    for (int round = 0; round < 11; ++round) {
        for (const std::u16string& letters : buffers) {
            times.push_back(nanosecondsOf([&] {
                list.clear();
                matcher.findSuggestions(letters, groups, list);
            }));
            require(!list.isEmpty());
            found += list.size();
        }
    }
    const std::string number = std::to_string(size);
    const auto listed = static_cast<double>(found) / static_cast<double>(times.size());
    print("suggest.compute." + number, median(times) / 1e3, "us");
    print("suggest.compute." + number + ".p99", percentile(times, 0.99) / 1e3, "us");
    print("suggest.listed." + number, listed, "entries");
}

// Until they can be suggested.
void printAdding() {
    std::vector<double> times;
    for (int run = 0; run < 11; ++run) {
        std::mt19937 random{25};
        const Groups groups = suggestingGroups(SnippetCount, random);
        SnippetMatcher matcher(AutoText::defaultDelimiters());
        matcher.setSnippetGroups(groups);
        std::vector<std::shared_ptr<Snippet>> added;
        for (std::size_t i = 0; i < SnippetCount; ++i) {
            added.push_back(std::make_shared<Snippet>(randomAbbreviation(random), u"content"));
        }
        SuggestionList list;
        matcher.findSuggestions(u"si", groups, list);
        times.push_back(nanosecondsOf([&] {
            groups[0]->addItems(added);
            matcher.findSuggestions(u"si", groups, list);
        }));
    }
    print("suggest.add.10000", median(times) / 1e6, "ms");
}

}  // namespace

void printSuggestionFigures() {
    printComputing(SnippetCount);
    printComputing(10 * SnippetCount);
    printAdding();
}

}  // namespace plume::bench
