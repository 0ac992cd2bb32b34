#pragma once

#include <cstddef>
#include <string>

namespace report {

/// Bytes as text, for "data:" addresses and JSON. Numbers are little-endian, as browsers have them
/// on every processor that they run on.
std::string base64(const void* bytes, std::size_t byteCount);

}  // namespace report
