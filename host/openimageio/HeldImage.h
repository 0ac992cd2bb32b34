#pragma once

#include <OpenImageIO/typedesc.h>

#include <cstddef>
#include <functional>
#include <memory>

#include "host/openimageio/Lines.h"

namespace host::openimageio {

/// An image that is decoded once and held in its own type of samples.
class HeldImage final : public Lines {
public:
    /// Fills the image with samples of that type, three a pixel.
    using Decode = std::function<void(void* rgb)>;

    HeldImage(int width, int height, const OIIO::TypeDesc& type, const Decode& decode);

    const float* line(int line) override;

private:
    const OIIO::TypeDesc type_;
    const std::size_t lineSamples_;
    const std::unique_ptr<std::byte[]> samples_;
    const std::unique_ptr<float[]> line_;
};

}  // namespace host::openimageio
