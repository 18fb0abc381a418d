#include "import/TextLines.h"

namespace plume {

std::optional<std::u16string_view> TextLines::peek() const {
    if (rest_.empty()) return std::nullopt;
    return rest_.substr(0, rest_.find_first_of(u"\r\n"));
}

std::optional<std::u16string_view> TextLines::next() {
    const auto line = peek();
    if (!line) return line;
    rest_.remove_prefix(line->size());
    if (rest_.starts_with(u"\r\n")) {
        rest_.remove_prefix(2);
    } else if (!rest_.empty()) {
        rest_.remove_prefix(1);
    }
    ++number_;
    return line;
}

}  // namespace plume
