#pragma once

#include <cstddef>

#include "lut/RGB.h"

namespace Orlith::LUT {

/// Contiguous samples, zero where nothing was stored.
///
/// Large arrays are made of the system's own pages, which are zero and cost address space only
/// until they are touched: a small file that claims a huge lattice stays small in memory.
class SampleArray {
public:
    SampleArray() = default;
    SampleArray(const SampleArray&) = delete;
    SampleArray& operator=(const SampleArray&) = delete;
    ~SampleArray();

    std::size_t size() const noexcept { return sampleCount_; }
    bool empty() const noexcept { return sampleCount_ == 0; }

    RGB& operator[](std::size_t element) noexcept { return samples_[element]; }
    const RGB& operator[](std::size_t element) const noexcept { return samples_[element]; }

    /// The first float, or null when there are no samples.
    float* data() noexcept { return empty() ? nullptr : samples_[0].data_block(); }
    const float* data() const noexcept { return empty() ? nullptr : samples_[0].data_block(); }

    /// Keeps the first samples in place; new ones are zero. Touches no page that was not touched
    /// before, however often the size changes.
    /// @throws std::length_error  the byte count does not fit the address space
    /// @throws std::bad_alloc     no memory; the array stays as it was
    void resize(std::size_t sampleCount);

private:
    RGB* samples_ = nullptr;
    std::size_t sampleCount_ = 0;
};

}  // namespace Orlith::LUT
