// The bracket that belongs to the one at the caret.
//
// Pure; what the brackets stand for is not looked at.
#pragma once

#include <QTextDocument>
#include <optional>
#include <utility>

namespace plume {

// The places of both, that at the caret first: the one behind it or, where there is none, the one in front of it.
// Nothing where there is none, or no other one nearby.
std::optional<std::pair<int, int>> bracketPairAt(const QTextDocument& document, int caret);

}  // namespace plume
