#include "lut/io/ShaperEntries.h"

#include <algorithm>

namespace Orlith::LUT {

void ShaperEntries::grow(std::size_t count) {
    // At least doubled, so that entries which come one by one are cheap; what is not used yet costs
    // no memory.
    if (count > samples_.size()) samples_.resize(std::max({count, 2 * count_, std::size_t{256}}));
    count_ = std::max(count_, count);
}

void ShaperEntries::push_back(const RGB& entry) {
    grow(count_ + 1);
    samples_[count_ - 1] = entry;
}

void ShaperEntries::moveTo(Shaper& shaper) {
    // From the end, whose memory goes back to the system block by block.
    constexpr std::size_t kBlock = 65536;
    shaper.entries.clear();
    shaper.entries.reserve(count_);
    while (count_ > 0) {
        const std::size_t kept = count_ - std::min(count_, kBlock);
        while (count_ > kept)
            shaper.entries.push_back(samples_[--count_]);
        samples_.resize(kept);
    }
    std::reverse(shaper.entries.begin(), shaper.entries.end());
}

}  // namespace Orlith::LUT
