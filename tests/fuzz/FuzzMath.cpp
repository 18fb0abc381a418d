// Any text is an expression or is refused: nothing else happens, and reading it twice gives the same.
#include <cmath>
#include <cstdint>
#include <cstdlib>
#include <optional>
#include <string_view>

#include "Foundation/Strings.h"
#include "content/MathExpressionParser.h"

namespace {

std::optional<double> valueOf(std::u16string_view text) {
    try {
        return plume::MathExpressionParser::evaluateExpression(text);
    } catch (const plume::MathExpressionError&) {
        return std::nullopt;
    }
}

}  // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size) {
    const std::u16string text = plume::fromUtf8({reinterpret_cast<const char*>(data), size});
    const auto value = valueOf(text);
    // Parentheses around a single expression change nothing.
    if (value && text.find_first_of(u";\n\r\v\f\u0085\u2028\u2029") == std::u16string::npos) {
        const auto wrapped = valueOf(u"(" + text + u")");
        const bool isEmpty = text.find_first_not_of(u" \t") == std::u16string::npos;
        const bool isSame = wrapped && (*wrapped == *value || (std::isnan(*wrapped) && std::isnan(*value)));
        if (isEmpty == isSame) std::abort();
    }
    return 0;
}
