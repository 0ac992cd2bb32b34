#include "lut/SampleArray.h"

#include <algorithm>
#include <cstring>
#include <limits>
#include <new>
#include <stdexcept>
#include <type_traits>

namespace Orlith::LUT {

static_assert(std::is_trivially_copyable_v<RGB>, "samples are moved as bytes");

void SampleArray::resize(std::size_t sampleCount) {
    if (sampleCount == sampleCount_) return;
    if (sampleCount > std::numeric_limits<std::size_t>::max() / sizeof(RGB) / 2) {
        throw std::length_error("SampleArray::resize");
    }
    std::unique_ptr<RGB[], Free> grown;
    if (sampleCount > 0) {
        grown.reset(static_cast<RGB*>(std::calloc(sampleCount, sizeof(RGB))));
        if (!grown) throw std::bad_alloc();
        const std::size_t kept = std::min(sampleCount, sampleCount_);
        if (kept > 0) std::memcpy(grown.get(), samples_.get(), kept * sizeof(RGB));
    }
    samples_ = std::move(grown);
    sampleCount_ = sampleCount;
}

}  // namespace Orlith::LUT
