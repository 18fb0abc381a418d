#include "app/DecimalNumbers.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <cmath>

#include "Foundation/Strings.h"
#include "Foundation/UserLocale.h"

namespace plume {

namespace {

constexpr int ComputedDigits = 3;
constexpr int MostDigits = 340;  // doubles reach as far behind the decimal sign
constexpr std::size_t LongestNumber = 400;

std::optional<double> finiteNumber(std::string_view plain) {
    double number = 0;
    const char* const end = plain.data() + plain.size();
    const auto [readTo, error] = std::from_chars(plain.data(), end, number);
    if (error != std::errc() || readTo != end || !std::isfinite(number)) return std::nullopt;
    return number;
}

}  // namespace

DecimalNumbers::DecimalNumbers(const std::string& locale)
    : rounded_(decimalFormat(locale.empty() ? userLocale(LocaleCategory::Numbers) : locale, ComputedDigits)),
      exact_(decimalFormat(locale.empty() ? userLocale(LocaleCategory::Numbers) : locale, MostDigits)),
      plain_(decimalFormat("en_US_POSIX", MostDigits)) {}

DecimalNumbers::Format DecimalNumbers::decimalFormat(const std::string& locale, int fractionDigits) {
    UErrorCode status = U_ZERO_ERROR;
    UNumberFormat* format = unum_open(UNUM_DECIMAL, nullptr, 0, locale.c_str(), nullptr, &status);
    unum_setAttribute(format, UNUM_GROUPING_USED, 0);
    unum_setAttribute(format, UNUM_MAX_FRACTION_DIGITS, fractionDigits);
    return {format, [](UNumberFormat* opened) { unum_close(opened); }};
}

std::u16string DecimalNumbers::formatted(const Format& format, const std::string& decimal) {
    std::array<char16_t, 2 * LongestNumber> text{};
    UErrorCode status = U_ZERO_ERROR;
    const std::int32_t length =
        unum_formatDecimal(format.get(), decimal.data(), static_cast<std::int32_t>(decimal.size()), text.data(),
                           static_cast<std::int32_t>(text.size()), nullptr, &status);
    if (U_FAILURE(status)) return {};
    return {text.data(), static_cast<std::size_t>(length)};
}

std::optional<DecimalNumbers::Number> DecimalNumbers::read(std::u16string_view shown) const {
    const std::u16string_view digits = trimmed(shown);
    if (digits.empty() || digits.size() > LongestNumber) return std::nullopt;
    std::array<char, 2 * LongestNumber> decimal{};
    UErrorCode status = U_ZERO_ERROR;
    std::int32_t end = 0;
    const auto length = static_cast<std::int32_t>(digits.size());
    const std::int32_t written = unum_parseDecimal(exact_.get(), digits.data(), length, &end, decimal.data(),
                                                   static_cast<std::int32_t>(decimal.size()), &status);
    if (U_FAILURE(status) || end != length) return std::nullopt;
    const std::string_view text(decimal.data(), static_cast<std::size_t>(written));
    const auto number = finiteNumber(text);
    if (!number) return std::nullopt;
    return Number{*number, toUtf8(formatted(plain_, std::string(text)))};
}

std::optional<std::u16string> DecimalNumbers::written(std::u16string_view plain) const {
    const std::string text = toUtf8(trimmed(plain));
    if (text.size() > LongestNumber || !finiteNumber(text)) return std::nullopt;
    return formatted(exact_, text);
}

std::u16string DecimalNumbers::written(double number) const {
    constexpr double RoundedToZero = 0.0005;  // which is not to be "-0"
    if (std::abs(number) <= RoundedToZero) number = 0;
    std::array<char16_t, LongestNumber> text{};
    UErrorCode status = U_ZERO_ERROR;
    const std::int32_t length = unum_formatDouble(rounded_.get(), number, text.data(),
                                                  static_cast<std::int32_t>(text.size()), nullptr, &status);
    if (U_FAILURE(status)) return {};
    return {text.data(), static_cast<std::size_t>(length)};
}

}  // namespace plume
