#include "host/openimageio/HeldImage.h"

#include <OpenImageIO/imageio.h>

namespace host::openimageio {

HeldImage::HeldImage(int width, int height, const OIIO::TypeDesc& type, const Decode& decode)
    : type_(type),
      lineSamples_(std::size_t{3} * static_cast<std::size_t>(width)),
      samples_(new std::byte[lineSamples_ * static_cast<std::size_t>(height) * type.size()]),
      line_(new float[lineSamples_]) {
    decode(samples_.get());
}

const float* HeldImage::line(int line) {
    const std::byte* const samples =
        samples_.get() + static_cast<std::size_t>(line) * lineSamples_ * type_.size();
    OIIO::convert_pixel_values(type_, samples, OIIO::TypeFloat, line_.get(),
                               static_cast<int>(lineSamples_));
    return line_.get();
}

}  // namespace host::openimageio
