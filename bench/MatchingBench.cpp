// How long a key waits for the matcher, by the size of the library.
#include <cstdlib>
#include <memory>
#include <new>
#include <random>
#include <string>
#include <vector>

#include "bench/Figures.h"
#include "engine/AutoText.h"
#include "engine/SnippetMatcher.h"
#include "ports/simulated/SimulatedInputSources.h"
#include "ports/simulated/SimulatedProcessManager.h"

namespace {
std::size_t allocations = 0;
}

void* operator new(std::size_t size) {
    ++allocations;
    if (void* memory = std::malloc(size ? size : 1)) return memory;
    throw std::bad_alloc();
}
void operator delete(void* memory) noexcept {
    std::free(memory);
}
void operator delete(void* memory, std::size_t) noexcept {
    std::free(memory);
}

namespace plume::bench {
namespace {

constexpr std::size_t GroupCount = 20;

// Where the keys go.
struct Editor {
    KeyDestination destination() { return {resolver, inputSources, process}; }

    SimulatedProcessManager processes;
    SimulatedInputSources inputSources;
    BundleIdentifierResolver resolver{processes};
    ProcessSerialNumber process = processes.launch(u"org.example.editor");
};

class Library {
  public:
    explicit Library(std::size_t size) {
        for (std::size_t i = 0; i < GroupCount; ++i) groups.push_back(makeGroup(i));
        for (std::size_t i = 0; i < size; ++i) {
            groups[i % GroupCount]->addItem(std::make_shared<Snippet>(randomAbbreviation(), u"content"));
        }
    }

    // Three to twelve letters or digits, the first one never a vowel: what people make up.
    std::u16string randomAbbreviation() {
        std::u16string text(1, u"bcdfghjklmnpqrstvwxz"[random() % 20]);
        for (std::size_t length = 2 + random() % 10; length > 0; --length) {
            text += u"abcdefghijklmnopqrstuvwxyz0123456789"[random() % 36];
        }
        return text;
    }

    std::vector<std::shared_ptr<SnippetGroup>> groups;
    std::mt19937 random{20};  // the same library in every run

  private:
    // A quarter with a prefix, a tenth limited to applications, half expanding at a delimiter.
    static std::shared_ptr<SnippetGroup> makeGroup(std::size_t i) {
        const auto group = SnippetGroup::make();
        group->setExpandTrigger(i % 2 == 0 ? ExpandTrigger::Immediately : ExpandTrigger::DelimiterKept);
        group->setExpandAfter(static_cast<ExpandAfter>(i % 3));
        if (i % 4 == 1) group->setAbbreviationPrefix(i % 8 == 1 ? u";" : u";;");
        if (i % 10 == 4) {
            group->availability().availability = PLFunctionAvailability::OnlyListed;
            group->availability().applications = {{u"org.example.editor", u"org.example.mail"}};
        }
        return group;
    }
};

// Words of a person, none of which is an abbreviation: vowels come first in each, and never a digit.
std::u16string prose(std::size_t length, std::mt19937& random) {
    std::u16string text;
    while (text.size() <= length) {
        text += u"aeiou"[random() % 5];
        for (std::size_t n = 1 + random() % 7; n > 0; --n) text += u"abcdefghijklmnopqrstuvwxyz"[random() % 26];
        text += random() % 8 ? u" " : u", ";
    }
    return text;
}

constexpr std::size_t KeysInBatch = 20'000;

struct Miss {
    double nanoseconds = 0;
    std::size_t allocations = 0;
};

// Typing at the end of a buffer: what a key costs that completes nothing. Keys that complete something by chance are
// left out beforehand.
Miss missCost(const SnippetMatcher& matcher, std::size_t bufferLength, std::mt19937& random) {
    const std::u16string text = prose(bufferLength + KeysInBatch, random);
    Editor editor;
    SnippetMatcher::Refusals refusals;
    refusals.reserve(DecisionLog::Capacity);
    const auto finds = [&](std::size_t start) {
        const auto letters = std::u16string_view(text).substr(start, bufferLength + 1);
        const auto before = letters.substr(0, bufferLength);
        refusals.clear();
        return !matcher.findSnippetsInLetters(letters, letters.back(), before, editor.destination(), refusals).empty();
    };
    std::vector<std::size_t> misses;
    for (std::size_t start = 0; start < KeysInBatch; ++start) {
        if (!finds(start)) misses.push_back(start);
    }
    const auto batch = [&] {
        for (const std::size_t start : misses) {
            if (finds(start)) std::abort();
        }
    };
    const std::size_t before = allocations;
    batch();
    const std::size_t allocated = allocations - before;
    return {medianNanoseconds(31, batch) / static_cast<double>(misses.size()), allocated};
}

void benchMisses() {
    std::size_t allocated = 0;
    for (const std::size_t size : {100U, 1'000U, 10'000U, 100'000U}) {
        Library library(size);
        SnippetMatcher matcher(AutoText::defaultDelimiters());
        matcher.setSnippetGroups(library.groups);
        double slowest = 0;
        for (const std::size_t buffer : {10U, 1'000U, 100'000U}) {
            const Miss miss = missCost(matcher, buffer, library.random);
            slowest = std::max(slowest, miss.nanoseconds);
            allocated += miss.allocations;
        }
        print("matching.miss." + std::to_string(size), slowest, "ns");
    }
    print("matching.miss.allocations", static_cast<double>(allocated), "count");
}

// Every 37th snippet typed to its end, with whatever its group wants before and after it.
void benchHits() {
    Library library(100'000);
    SnippetMatcher matcher(AutoText::defaultDelimiters());
    matcher.setSnippetGroups(library.groups);
    std::vector<std::u16string> typings;
    std::vector<bool> delimited;
    for (const auto& group : library.groups) {
        for (std::size_t i = 0; i < group->items().size(); i += 37) {
            const bool atDelimiter = group->expandTrigger() == ExpandTrigger::DelimiterKept;
            typings.push_back(u"and then " + *group->items()[i]->abbreviationWithPrefix() + (atDelimiter ? u" " : u""));
            delimited.push_back(atDelimiter);
        }
    }
    Editor editor;
    SnippetMatcher::Refusals refusals;
    std::size_t found = 0;
    const double batch = medianNanoseconds(31, [&] {
        found = 0;
        for (const auto& typing : typings) {
            const std::u16string_view letters = typing;
            const auto before = letters.substr(0, letters.size() - 1);
            const auto matches =
                matcher.findSnippetsInLetters(letters, letters.back(), before, editor.destination(), refusals);
            found += matches.empty() ? 0U : 1U;
            refusals.clear();
        }
    });
    if (found != typings.size()) std::abort();
    print("matching.hit.100000", batch / static_cast<double>(typings.size()), "ns");
}

void benchBuilding() {
    Library library(100'000);
    std::vector<double> builds;
    for (int i = 0; i < 15; ++i) {
        SnippetMatcher fresh(AutoText::defaultDelimiters());
        builds.push_back(nanosecondsOf([&] { fresh.setSnippetGroups(library.groups); }));
    }
    print("matching.build.100000", median(builds) / 1e6, "ms");

    SnippetMatcher matcher(AutoText::defaultDelimiters());
    matcher.setSnippetGroups(library.groups);
    std::vector<double> times;
    for (int i = 0; i < 20'000; ++i) {
        const auto& items = library.groups[library.random() % GroupCount]->items();
        const auto& snippet = items[library.random() % items.size()];
        std::u16string abbreviation = library.randomAbbreviation();
        times.push_back(nanosecondsOf([&] { snippet->setAbbreviation(std::move(abbreviation)); }));
    }
    print("matching.edit.100000", median(times) / 1e3, "us");
}

}  // namespace
}  // namespace plume::bench

int main() {
    plume::bench::benchMisses();
    plume::bench::benchHits();
    plume::bench::benchBuilding();
}
