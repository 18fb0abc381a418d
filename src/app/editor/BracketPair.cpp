#include "app/editor/BracketPair.h"

namespace plume {

namespace {

// Farther than this nobody looks for the other one, and the caret does not wait for it.
constexpr int FarthestBracket = 20'000;  // characters

struct Bracket {
    QChar own;
    QChar other;
    int step = 0;  // toward the other one; 0: this is none
};

Bracket bracketOf(QChar c) {
    static const QString pairs = QStringLiteral("()[]{}");
    const auto place = pairs.indexOf(c);
    if (place < 0) return {};
    return place % 2 == 0 ? Bracket{c, pairs[place + 1], 1} : Bracket{c, pairs[place - 1], -1};
}

std::optional<int> placeOfOther(const QTextDocument& document, int place) {
    const Bracket bracket = bracketOf(document.characterAt(place));
    if (bracket.step == 0) return std::nullopt;
    int depth = 0;
    int left = FarthestBracket;
    for (int at = place; at >= 0 && at < document.characterCount() && left > 0; at += bracket.step, --left) {
        const QChar c = document.characterAt(at);
        if (c == bracket.own) ++depth;
        if (c == bracket.other && --depth == 0) return at;
    }
    return std::nullopt;
}

}  // namespace

std::optional<std::pair<int, int>> bracketPairAt(const QTextDocument& document, int caret) {
    for (const int place : {caret, caret - 1}) {
        if (place < 0) continue;
        if (const auto other = placeOfOther(document, place)) return std::pair(place, *other);
    }
    return std::nullopt;
}

}  // namespace plume
