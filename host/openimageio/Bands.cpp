#include "host/openimageio/Bands.h"

#include <algorithm>
#include <cstdint>
#include <iterator>
#include <utility>

namespace host::openimageio {
namespace {

constexpr std::int64_t kBandBytes = std::int64_t{2} << 20;  // stays in a processor's caches
constexpr std::int64_t kLeastLines = 16;
constexpr std::size_t kKeptCount = 2;  // for lines on both sides of a border, in turn

/// As many whole blocks as make a band.
int bandLinesOf(std::int64_t lineBytes, std::int64_t height, std::int64_t blockLines) {
    const std::int64_t wanted = std::max(kBandBytes / lineBytes, kLeastLines);
    const std::int64_t lines = (wanted + blockLines - 1) / blockLines * blockLines;
    return static_cast<int>(std::min(lines, height));
}

}  // namespace

Bands::Bands(int width, int height, int blockLines, Decode decode)
    : lineFloats_(std::size_t{3} * static_cast<std::size_t>(width)),
      height_(height),
      bandLines_(
          bandLinesOf(static_cast<std::int64_t>(lineFloats_ * sizeof(float)), height, blockLines)),
      bandCount_(height / bandLines_),
      decode_(std::move(decode)) {}

int Bands::linesIn(int index) const {
    return index == bandCount_ - 1 ? height_ - index * bandLines_ : bandLines_;
}

const Bands::Band& Bands::band(int index) {
    const auto found = std::find_if(bands_.begin(), bands_.end(),
                                    [&](const Band& each) { return each.index == index; });
    if (found != bands_.end()) {
        bands_.splice(bands_.begin(), bands_, found);
        return bands_.front();
    }
    if (bands_.size() < kKeptCount) {
        // Room for the highest one, since it takes another's place later.
        const auto lines = static_cast<std::size_t>(linesIn(bandCount_ - 1));
        bands_.push_front({-1, std::unique_ptr<float[]>(new float[lines * lineFloats_])});
    } else {
        bands_.splice(bands_.begin(), bands_, std::prev(bands_.end()));
    }
    Band& taken = bands_.front();
    taken.index = -1;  // until it is decoded
    const int first = index * bandLines_;
    decode_(first, first + linesIn(index), taken.rgb.get());
    taken.index = index;
    return taken;
}

const float* Bands::line(int line) {
    if (!isWhole_) {
        band(0);
        band(bandCount_ - 1);
        isWhole_ = true;
    }
    const int index = std::min(line / bandLines_, bandCount_ - 1);
    return band(index).rgb.get() +
           static_cast<std::size_t>(line - index * bandLines_) * lineFloats_;
}

}  // namespace host::openimageio
