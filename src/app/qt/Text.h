// Between Plume's texts and Qt's: both are UTF-16.
#pragma once

#include <QString>
#include <string>
#include <string_view>

namespace plume {

inline QString toQString(std::u16string_view text) {
    return QString::fromUtf16(text.data(), static_cast<qsizetype>(text.size()));
}

inline std::u16string fromQString(const QString& text) {
    return {reinterpret_cast<const char16_t*>(text.utf16()), static_cast<std::size_t>(text.size())};
}

}  // namespace plume
