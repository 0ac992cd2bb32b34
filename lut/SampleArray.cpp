#include "lut/SampleArray.h"

#include <algorithm>
#include <cstring>
#include <limits>
#include <new>
#include <stdexcept>
#include <type_traits>
#include <utility>

namespace Orlith::LUT {

static_assert(std::is_trivially_copyable_v<RGB>, "samples are moved as bytes");

namespace {

/// Copies to memory that is zero, without touching its pages where there are only zeros to copy.
void copyValues(unsigned char* to, const unsigned char* from, std::size_t byteCount) {
    static constexpr unsigned char kZeros[4096] = {};
    for (std::size_t at = 0; at < byteCount; at += sizeof(kZeros)) {
        const std::size_t length = std::min(sizeof(kZeros), byteCount - at);
        if (std::memcmp(from + at, kZeros, length) != 0) std::memcpy(to + at, from + at, length);
    }
}

}  // namespace

void SampleArray::resize(std::size_t sampleCount) {
    if (sampleCount == sampleCount_) return;
    if (sampleCount > std::numeric_limits<std::size_t>::max() / sizeof(RGB) / 2) {
        throw std::length_error("SampleArray::resize");
    }
    std::unique_ptr<RGB[], Free> grown;
    if (sampleCount > 0) {
        grown.reset(static_cast<RGB*>(std::calloc(sampleCount, sizeof(RGB))));
        if (!grown) throw std::bad_alloc();
        if (mayHoldValues_) {
            copyValues(reinterpret_cast<unsigned char*>(grown.get()),
                       reinterpret_cast<const unsigned char*>(samples_.get()),
                       std::min(sampleCount, sampleCount_) * sizeof(RGB));
        }
    }
    samples_ = std::move(grown);
    sampleCount_ = sampleCount;
}

}  // namespace Orlith::LUT
