#include "tests/support/Gzip.h"

#include <gtest/gtest.h>
#include <zlib.h>

namespace test {
namespace {

/// zlib takes its input through pointers to what it does not change.
Bytef* bytesOf(std::string_view text) {
    return reinterpret_cast<Bytef*>(const_cast<char*>(text.data()));
}

Bytef* optional(const std::string& field) {
    return field.empty() ? nullptr : bytesOf(field);
}

}  // namespace

std::string gzip(std::string_view text, const GzipFields& fields) {
    constexpr int kGzipWrapper = 16 + MAX_WBITS;
    z_stream zlib{};
    EXPECT_EQ(deflateInit2(&zlib, Z_BEST_SPEED, Z_DEFLATED, kGzipWrapper, 8, Z_DEFAULT_STRATEGY),
              Z_OK);
    gz_header header{};
    header.extra = optional(fields.extra);
    header.extra_len = static_cast<uInt>(fields.extra.size());
    header.name = optional(fields.name);
    header.comment = optional(fields.comment);
    header.hcrc = fields.headerCrc ? 1 : 0;
    deflateSetHeader(&zlib, &header);

    std::string member(deflateBound(&zlib, static_cast<uLong>(text.size())), '\0');
    zlib.next_in = bytesOf(text);
    zlib.avail_in = static_cast<uInt>(text.size());
    zlib.next_out = bytesOf(member);
    zlib.avail_out = static_cast<uInt>(member.size());
    EXPECT_EQ(deflate(&zlib, Z_FINISH), Z_STREAM_END);
    member.resize(zlib.total_out);
    deflateEnd(&zlib);
    return member;
}

}  // namespace test
