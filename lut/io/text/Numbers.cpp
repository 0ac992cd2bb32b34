#include "lut/io/text/Numbers.h"

#include <algorithm>
#include <boost/endian/conversion.hpp>
#include <charconv>
#include <clocale>
#include <cstdlib>
#include <cstring>
#include <limits>
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

bool isDigit(char c) {
    return static_cast<unsigned char>(c - '0') < 10;
}

bool isSeparator(char c) {
    return c == ' ' || c == '\t';
}

/// Part of a line that is still to be read. It may end where readable memory ends.
struct Rest {
    const char* at;
    const char* const end;
    const char* const start;  // of the line

    bool startsWith(char c) const { return at != end && *at == c; }

    void skipSeparators() {
        while (at != end && isSeparator(*at))
            ++at;
    }

    /// The next eight bytes, the first one lowest; zero after the end.
    std::uint64_t nextEight() const {
        const auto left = static_cast<std::size_t>(end - at);
        if (left >= 8) return boost::endian::load_little_u64(bytes(at));
        if (left == 0) return 0;
        if (end - start >= 8)
            return boost::endian::load_little_u64(bytes(end - 8)) >> 8 * (8 - left);
        unsigned char few[8] = {};
        std::memcpy(few, at, left);
        return boost::endian::load_little_u64(few);
    }

    static const unsigned char* bytes(const char* text) {
        return reinterpret_cast<const unsigned char*>(text);
    }
};

constexpr std::uint64_t everyByte(std::uint64_t byte) {
    return 0x0101010101010101U * byte;
}

/// Takes the digits that come next and appends them to `number`, eight at a time.
/// @return how many there were; number has wrapped if that is more than 19
std::ptrdiff_t takeDigits(Rest& rest, std::uint64_t& number) {
    static constexpr std::uint64_t kPowers[] = {1,      10,      100,      1000,     10000,
                                                100000, 1000000, 10000000, 100000000};
    const char* const first = rest.at;
    unsigned count = 8;
    while (count == 8) {
        // The values of the digits; the first byte of 10 or more is no digit. A carry out of
        // that byte spoils later ones only.
        std::uint64_t digits = rest.nextEight() ^ everyByte('0');
        const std::uint64_t others = ((digits + everyByte(0x80 - 10)) | digits) & everyByte(0x80);
        count = others == 0 ? 8 : static_cast<unsigned>(__builtin_ctzll(others)) / 8;
        if (count == 0) break;
        // Zeros in front make them eight; then neighbours are joined to pairs, and pairs to eight.
        digits <<= 8 * (8 - count);
        digits = 10 * digits + (digits >> 8);
        constexpr std::uint64_t kPairs = 0x000000FF000000FF;
        digits = ((digits & kPairs) * (100 + (1000000ULL << 32)) +
                  ((digits >> 16) & kPairs) * (1 + (10000ULL << 32))) >>
                 32;
        number = number * kPowers[count] + digits;
        rest.at += count;
    }
    return rest.at - first;
}

/// Reads [-]digits[.digits] of at most 15 digits. Both the digits as an integer and the power of
/// ten are exact doubles then, so that their quotient is the correctly rounded value, as from
/// strtod.
/// @return false if there is no such number
bool takePlainDecimal(Rest& rest, float& value) {
    static constexpr double kPowers[] = {1e0, 1e1, 1e2,  1e3,  1e4,  1e5,  1e6,  1e7,
                                         1e8, 1e9, 1e10, 1e11, 1e12, 1e13, 1e14, 1e15};
    const bool isNegative = rest.startsWith('-');
    if (isNegative) ++rest.at;
    std::uint64_t digits = 0;
    const char* const first = rest.at;
    while (rest.at != rest.end && isDigit(*rest.at))
        digits = 10 * digits + static_cast<std::uint64_t>(*rest.at++ - '0');
    std::ptrdiff_t digitCount = rest.at - first;
    std::ptrdiff_t fractionDigits = 0;
    if (rest.startsWith('.')) {
        ++rest.at;
        fractionDigits = takeDigits(rest, digits);
        digitCount += fractionDigits;
    }
    if (digitCount < 1 || digitCount > 15) return false;
    const double magnitude =
        static_cast<double>(static_cast<std::int64_t>(digits)) / kPowers[fractionDigits];
    value = static_cast<float>(isNegative ? -magnitude : magnitude);
    return true;
}

}  // namespace

float toFloat(std::string_view token) {
    return static_cast<float>(toDouble(token));
}

std::int32_t toInt(std::string_view token) {
    token.remove_prefix(std::min(token.find_first_not_of(" \t\n\v\f\r"), token.size()));
    const bool isNegative = !token.empty() && token.front() == '-';
    if (!token.empty() && token.front() == '+') {
        token.remove_prefix(1);
        if (!token.empty() && token.front() == '-') return 0;  // from_chars would take it
    }
    long number = 0;
    const auto [stop, error] = std::from_chars(token.data(), token.data() + token.size(), number);
    if (error == std::errc::result_out_of_range) {
        using Limits = std::numeric_limits<long>;
        number = isNegative ? Limits::min() : Limits::max();
    }
    return static_cast<std::int32_t>(number);
}

bool hasDecimalComma(std::string_view word) {
    if (!word.empty() && (word[0] == '-' || word[0] == '+')) word.remove_prefix(1);
    const std::size_t comma = word.find(',');
    if (comma == std::string_view::npos || comma == 0 || comma + 1 == word.size()) return false;
    return std::all_of(word.begin(), word.end(), [](char c) { return isDigit(c) || c == ','; }) &&
           word.find(',', comma + 1) == std::string_view::npos;
}

bool parsePlainTriple(std::string_view line, RGB& rgb) {
    Rest rest{line.data(), line.data() + line.size(), line.data()};
    float numbers[3];
    for (int c = 0; c < 3; ++c) {
        if (c > 0 && (rest.at == rest.end || !isSeparator(*rest.at))) return false;
        rest.skipSeparators();
        if (!takePlainDecimal(rest, numbers[c])) return false;
    }
    if (rest.startsWith('\r') && rest.at + 1 == rest.end) ++rest.at;
    rest.skipSeparators();
    if (rest.at != rest.end) return false;
    rgb = RGB(numbers[0], numbers[1], numbers[2]);
    return true;
}

}  // namespace Orlith::LUT
