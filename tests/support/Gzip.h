#pragma once

#include <string>
#include <string_view>

namespace test {

/// The optional fields of a gzip header; those left empty are not there.
struct GzipFields {
    std::string extra;
    std::string name;
    std::string comment;
    bool headerCrc = false;
};

/// One gzip member, as zlib's own compressor makes it.
std::string gzip(std::string_view text, const GzipFields& fields = {});

}  // namespace test
