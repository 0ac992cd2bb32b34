#include "lut/io/text/LineWriter.h"

#include <charconv>
#include <cstdint>
#include <cstring>

#include "lut/io/text/DigitPairs.h"
#include "lut/io/text/FixedNotation.h"

namespace Orlith::LUT {
namespace {

constexpr std::size_t kBlockBytes = std::size_t{256} << 10;
constexpr std::size_t kIntegerLength = 11;  // "-2147483648"

/// @return the place after the last digit
char* writeInteger(char* out, int number) {
    if (number < 0 || number > 9999) return std::to_chars(out, out + kIntegerLength, number).ptr;
    // The common codes: four digits, from the first that counts. No branch, since the lengths of
    // neighbouring numbers are anyone's guess.
    const auto code = static_cast<std::uint32_t>(number);
    char digits[8] = {};
    writeDigitPair(digits, code / 100);
    writeDigitPair(digits + 2, code % 100);
    const int skipped = int{code < 1000} + int{code < 100} + int{code < 10};
    std::memcpy(out, digits + skipped, 4);
    return out + 4 - skipped;
}

/// Three numbers with a blank between them.
template <class Number, class Write>
char* writeTriple(char* out, const Number* rgb, Write write) {
    out = write(out, rgb[0]);
    *out++ = ' ';
    out = write(out, rgb[1]);
    *out++ = ' ';
    return write(out, rgb[2]);
}

}  // namespace

LineWriter::LineWriter(const std::string& filename, bool flushLines, bool& wroteAll)
    : file_(filename, wroteAll), handOverAt_(flushLines ? 0 : kBlockBytes) {}

LineWriter::~LineWriter() {
    handOver();
}

LineWriter& LineWriter::text(std::string_view text) {
    length_ += text.copy(reserve(text.size()), text.size());
    return *this;
}

LineWriter& LineWriter::integer(int number) {
    char* const out = reserve(kIntegerLength);
    length_ += static_cast<std::size_t>(writeInteger(out, number) - out);
    return *this;
}

LineWriter& LineWriter::fixed(float number) {
    char* const out = reserve(kFixedLength);
    length_ += static_cast<std::size_t>(writeFixed(out, number) - out);
    return *this;
}

LineWriter& LineWriter::fixedTriple(const float* rgb) {
    char* const start = reserve(3 * kFixedLength + 2);
    length_ += static_cast<std::size_t>(writeTriple(start, rgb, writeFixed) - start);
    return *this;
}

LineWriter& LineWriter::integerTriple(const int* rgb) {
    char* const start = reserve(3 * kIntegerLength + 2);
    length_ += static_cast<std::size_t>(writeTriple(start, rgb, writeInteger) - start);
    return *this;
}

LineWriter& LineWriter::shortestTriple(const float* rgb) {
    char* const start = reserve(3 * kShortestLength + 2);
    length_ += static_cast<std::size_t>(writeTriple(start, rgb, writeShortest) - start);
    return *this;
}

void LineWriter::endLine() {
    *reserve(1) = '\n';
    ++length_;
    if (length_ >= handOverAt_) handOver();
}

char* LineWriter::reserve(std::size_t length) {
    if (gathered_.size() - length_ < length) gathered_.resize(2 * gathered_.size() + length + 256);
    return gathered_.data() + length_;
}

void LineWriter::handOver() {
    file_.write(gathered_.data(), length_);
    length_ = 0;
}

}  // namespace Orlith::LUT
