#pragma once

#include <cstddef>
#include <cstdlib>
#include <memory>

#include "lut/RGB.h"

namespace Orlith::LUT {

/// Contiguous samples, zero where nothing was stored.
///
/// The memory comes zeroed from the system, so that samples nobody touches cost address space only:
/// a small file that claims a huge lattice stays small in resident memory.
class SampleArray {
public:
    SampleArray() = default;
    SampleArray(const SampleArray&) = delete;
    SampleArray& operator=(const SampleArray&) = delete;

    std::size_t size() const noexcept { return sampleCount_; }
    bool empty() const noexcept { return sampleCount_ == 0; }

    RGB& operator[](std::size_t element) noexcept {
        mayHoldValues_ = true;
        return samples_[element];
    }
    const RGB& operator[](std::size_t element) const noexcept { return samples_[element]; }

    /// The first float, or null when there are no samples.
    float* data() noexcept { return empty() ? nullptr : (*this)[0].data_block(); }
    const float* data() const noexcept { return empty() ? nullptr : samples_[0].data_block(); }

    /// Keeps the first samples in place; new ones are zero. Pages that hold nothing but zeros stay
    /// untouched, however often the size changes.
    /// @throws std::length_error  the byte count does not fit the address space
    /// @throws std::bad_alloc     no memory; the array stays as it was
    void resize(std::size_t sampleCount);

private:
    struct Free {
        void operator()(RGB* samples) const noexcept { std::free(samples); }
    };

    std::unique_ptr<RGB[], Free> samples_;
    std::size_t sampleCount_ = 0;
    bool mayHoldValues_ = false;  // the samples were given out for writing
};

}  // namespace Orlith::LUT
