#include "lut/io/text/Numbers.h"

#include <charconv>
#include <clocale>
#include <cstdlib>
#include <string>
#include <system_error>

#include <locale.h>  // strtod_l, a POSIX function

namespace Orlith::LUT {
namespace {

/// What from_chars does not take: leading space, a plus sign, hexadecimal, values out of range.
double toDoubleInCLocale(std::string_view token) {
    static const locale_t kCLocale = newlocale(LC_ALL_MASK, "C", nullptr);
    const std::string text(token);  // ends at an embedded NUL, as a C string does
    return strtod_l(text.c_str(), nullptr, kCLocale);
}

double toDouble(std::string_view token) {
    double value = 0.0;
    const char* const end = token.data() + token.size();
    const auto [stop, error] = std::from_chars(token.data(), end, value);
    if (error == std::errc() && stop == end) return value;
    return toDoubleInCLocale(token);
}

constexpr double kPowersOfTen[] = {1e0, 1e1, 1e2,  1e3,  1e4,  1e5,  1e6,  1e7,
                                   1e8, 1e9, 1e10, 1e11, 1e12, 1e13, 1e14, 1e15};

bool isDigit(char c) {
    return static_cast<unsigned char>(c - '0') < 10;
}

bool isSeparator(char c) {
    return c == ' ' || c == '\t';
}

/// Reads [-]digits[.digits] of at most 15 digits. Both the digits as an integer and the power of
/// ten are exact doubles then, so that their quotient is the correctly rounded value, as from
/// strtod.
/// @return the place after the number, or null
const char* parsePlainDecimal(const char* at, const char* end, float& value) {
    const bool negative = at != end && *at == '-';
    if (negative) ++at;
    const char* const start = at;
    std::uint64_t digits = 0;
    while (at != end && isDigit(*at))
        digits = 10 * digits + static_cast<std::uint64_t>(*at++ - '0');
    std::ptrdiff_t digitCount = at - start;
    std::ptrdiff_t fractionDigits = 0;
    if (at != end && *at == '.') {
        const char* const fraction = ++at;
        while (at != end && isDigit(*at)) {
            digits = 10 * digits + static_cast<std::uint64_t>(*at++ - '0');
        }
        fractionDigits = at - fraction;
        digitCount += fractionDigits;
    }
    if (digitCount < 1 || digitCount > 15) return nullptr;
    const double magnitude = static_cast<double>(digits) / kPowersOfTen[fractionDigits];
    value = static_cast<float>(negative ? -magnitude : magnitude);
    return at;
}

}  // namespace

float toFloat(std::string_view token) {
    return static_cast<float>(toDouble(token));
}

std::int32_t toInt(std::string_view token) {
    const std::string text(token);  // ends at an embedded NUL, as a C string does
    return static_cast<std::int32_t>(std::strtol(text.c_str(), nullptr, 10));
}

bool parsePlainTriple(std::string_view line, RGB& rgb) {
    const char* at = line.data();
    const char* const end = at + line.size();
    float numbers[3];
    for (float& number : numbers) {
        while (at != end && isSeparator(*at))
            ++at;
        at = parsePlainDecimal(at, end, number);
        if (at == nullptr) return false;
        if (&number != &numbers[2] && (at == end || !isSeparator(*at))) return false;
    }
    if (at != end && *at == '\r' && at + 1 == end) ++at;
    while (at != end && isSeparator(*at))
        ++at;
    if (at != end) return false;
    rgb = RGB(numbers[0], numbers[1], numbers[2]);
    return true;
}

}  // namespace Orlith::LUT
