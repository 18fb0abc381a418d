// How long it takes to find what the user may want: for the list at the caret, and for quick search.
//   bench_search [suggestions|ranking|lists]…    all of them when none is named
#include <algorithm>
#include <string>
#include <vector>

#include "bench/SearchFigures.h"

int main(int argc, char** argv) {
    using namespace plume::bench;
    const std::vector<std::string> named(argv + 1, argv + argc);
    const auto isWanted = [&](const std::string& subject) {
        return named.empty() || std::find(named.begin(), named.end(), subject) != named.end();
    };
    if (isWanted("suggestions")) printSuggestionFigures();
    if (isWanted("ranking")) printRankingFigures();
    if (isWanted("lists")) printListFigures();
}
