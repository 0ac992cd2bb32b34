#pragma once

#include <cstddef>

#include "lut/LUT.h"
#include "lut/SampleArray.h"

namespace Orlith::LUT {

/// A shaper's entries while they are read. They grow without being copied: a file may have
/// millions, which are never held twice.
class ShaperEntries {
public:
    std::size_t size() const { return count_; }
    bool empty() const { return count_ == 0; }
    RGB& operator[](std::size_t entry) { return samples_[entry]; }

    /// Grows to so many entries, the new ones zero.
    void grow(std::size_t count);
    void push_back(const RGB& entry);

    /// Puts the entries into a shaper, in place of those it has; none are left here.
    void moveTo(Shaper& shaper);

private:
    SampleArray samples_;  // the first count_ count
    std::size_t count_ = 0;
};

}  // namespace Orlith::LUT
