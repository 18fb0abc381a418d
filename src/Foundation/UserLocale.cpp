#include "Foundation/UserLocale.h"

#include <unicode/uloc.h>

#include <array>
#include <cstdlib>

namespace plume {

namespace {

constexpr const char* WithoutLocale = "en_US_POSIX";

const char* chosenLocale(LocaleCategory category) {
    const char* const own = category == LocaleCategory::Dates ? "LC_TIME" : "LC_NUMERIC";
    for (const char* const variable : {"LC_ALL", own, "LANG"}) {
        const char* const value = std::getenv(variable);
        if (value && *value != '\0') return value;
    }
    return "C";
}

}  // namespace

std::string userLocale(LocaleCategory category) {
    // Without the character set ("de_DE.UTF-8"), and with what follows an "@" as ICU writes it.
    std::array<char, ULOC_FULLNAME_CAPACITY> name{};
    UErrorCode status = U_ZERO_ERROR;
    uloc_canonicalize(chosenLocale(category), name.data(), name.size() - 1, &status);
    const std::string canonical = name.data();
    return U_FAILURE(status) || canonical == "c" || canonical == "posix" ? WithoutLocale : canonical;
}

}  // namespace plume
