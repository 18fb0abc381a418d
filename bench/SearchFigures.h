// What the benchmark of lists and searches is made of: each prints its own figures.
#pragma once

namespace plume::bench {

// What snippets the typed letters may become: refreshSuggestions through the engine.
void printSuggestionFigures();
// Which snippets a search finds, key by key.
void printRankingFigures();
// The windows, on a desktop.
void printListFigures();

}  // namespace plume::bench
