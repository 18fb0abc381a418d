// Numbers as a locale writes them, without groups of digits, and as programs write them: digits, a point, a minus.
//
// What a user has written keeps all its digits. Used by one thread at a time.
#pragma once

#include <unicode/unum.h>

#include <memory>
#include <optional>
#include <string>
#include <string_view>

namespace plume {

class DecimalNumbers {
  public:
    struct Number {
        double value;
        std::string plain;  // as programs write it, with all its digits
    };

    // Empty: the user's locale for numbers.
    explicit DecimalNumbers(const std::string& locale);

    // The number that the locale's text says. Nothing for other text, for numbers without an end, and for those that
    // are longer than anyone writes.
    std::optional<Number> read(std::u16string_view shown) const;
    // The same number in the locale; nothing when it is no number of a program's.
    std::optional<std::u16string> written(std::u16string_view plain) const;
    // Of a computed number, three digits behind the decimal sign.
    std::u16string written(double number) const;

  private:
    using Format = std::unique_ptr<UNumberFormat, void (*)(UNumberFormat*)>;
    static Format decimalFormat(const std::string& locale, int fractionDigits);
    static std::u16string formatted(const Format& format, const std::string& decimal);

    Format rounded_;
    Format exact_;
    Format plain_;
};

}  // namespace plume
