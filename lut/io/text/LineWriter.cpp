#include "lut/io/text/LineWriter.h"

#include <charconv>
#include <cstring>

#include "lut/Exception.h"
#include "lut/io/text/FixedNotation.h"

namespace Orlith::LUT {
namespace {

constexpr std::size_t kBlockBytes = std::size_t{256} << 10;
constexpr std::size_t kIntegerLength = 11;  // "-2147483648"

}  // namespace

LineWriter::LineWriter(const std::string& filename, bool flushLines)
    : file_(std::fopen(filename.c_str(), "w")), handOverAt_(flushLines ? 0 : kBlockBytes) {
    if (!file_) throw Exception("unable to open file for writing");
    // Lines are gathered here; a second buffer below would only copy them again.
    std::setvbuf(file_.get(), nullptr, _IONBF, 0);
}

LineWriter::~LineWriter() {
    handOver();
}

LineWriter& LineWriter::text(std::string_view text) {
    std::memcpy(reserve(text.size()), text.data(), text.size());
    length_ += text.size();
    return *this;
}

LineWriter& LineWriter::integer(int number) {
    char* const out = reserve(kIntegerLength);
    length_ += static_cast<std::size_t>(std::to_chars(out, out + kIntegerLength, number).ptr - out);
    return *this;
}

LineWriter& LineWriter::fixed(float number) {
    char* const out = reserve(kFixedLength);
    length_ += static_cast<std::size_t>(writeFixed(out, number) - out);
    return *this;
}

LineWriter& LineWriter::fixedTriple(const float* rgb) {
    char* const start = reserve(3 * kFixedLength + 2);
    char* out = writeFixed(start, rgb[0]);
    *out++ = ' ';
    out = writeFixed(out, rgb[1]);
    *out++ = ' ';
    out = writeFixed(out, rgb[2]);
    length_ += static_cast<std::size_t>(out - start);
    return *this;
}

LineWriter& LineWriter::integerTriple(const int* rgb) {
    return integer(rgb[0]).text(" ").integer(rgb[1]).text(" ").integer(rgb[2]);
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
    if (length_ == 0) return;
    std::fwrite(gathered_.data(), 1, length_, file_.get());
    length_ = 0;
}

}  // namespace Orlith::LUT
