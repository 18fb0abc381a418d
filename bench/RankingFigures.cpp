// What one key of a query costs in quick search.
#include <algorithm>
#include <string>
#include <string_view>
#include <vector>

#include "app/ranking/SnippetRanking.h"
#include "bench/Figures.h"
#include "bench/GeneratedLibrary.h"
#include "bench/SearchFigures.h"

namespace plume::bench {

namespace {

// Abbreviations, labels, contents, several terms, slips, and what is nowhere.
constexpr std::u16string_view Typed[] = {
    u"abbr77",    u"abbr1234",  u"label",    u"label of",      u"snippet 99", u"a label 500",   u"quick brown",
    u"text 4321", u"fox jumps", u"lazy dog", u"na\u00EFve",    u"\U0001F600", u"albel",         u"snipept",
    u"zebra",     u"abr12",     u"xyz",      u"over lazy fox", u"als42",      u"runs away into"};
constexpr double NanosecondsPerMs = 1e6;

void printKeys(const SnippetGroups& groups, const std::string& name) {
    SnippetRanking ranking;
    const double reading = nanosecondsOf([&] {
        ranking.setLibrary(groups);
        ranking.prepare();
    });
    std::vector<double> times;
    std::size_t rows = 0;
    for (const std::u16string_view query : Typed) {
        (void)ranking.search(u"", {});
        for (std::size_t length = 1; length <= query.size(); ++length) {
            times.push_back(nanosecondsOf([&] { rows += ranking.search(query.substr(0, length), {}).size(); }));
        }
    }
    require(rows > 0);
    const double again = nanosecondsOf([&] {
        groups.front()->items().front()->setLabel(u"changed");
        ranking.setLibrary(groups);
        ranking.prepare();
    });
    print(name, median(times) / NanosecondsPerMs, "ms a key");
    print(name + ".p99", percentile(times, 0.99) / NanosecondsPerMs, "ms a key");
    print(name + ".max", *std::max_element(times.begin(), times.end()) / NanosecondsPerMs, "ms a key");
    print(name + ".set_library", reading / NanosecondsPerMs, "ms");
    print(name + ".set_library_again", again / NanosecondsPerMs, "ms");
    print(name + ".memory", static_cast<double>(ranking.memory()) / 1024, "KiB");
}

}  // namespace

void printRankingFigures() {
    for (const std::size_t perGroup : {SnippetsPerGroup, 10 * SnippetsPerGroup}) {
        printKeys(makeLibrary(perGroup, 0).snippetGroups, "search.rank." + std::to_string(GroupCount * perGroup));
    }
}

}  // namespace plume::bench
