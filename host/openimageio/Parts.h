#pragma once

#include <OpenImageIO/imageio.h>

#include <array>
#include <string>

#include "host/ImageCodec.h"

namespace host::openimageio {

/// More parts than anyone looks through are not counted: a film has one for each frame, and the
/// more there are before one, the longer it takes to find.
constexpr int kMostParts = 256;

/// The image that is taken of a file.
struct ChosenImage {
    int part = 0;
    OIIO::ImageSpec spec;                     // of that part
    std::array<int, 3> channels = {0, 1, 2};  // red, green and blue among the part's
    std::string remark;                       // as ImageReader::remark
};

/// Finds the image that was chosen, or else the one that is meant: the first part in colour, and in
/// it R, G and B, the first layer, or the first three channels.
/// @throws Error  nothing such, with path and what there is
ChosenImage chooseImage(OIIO::ImageInput& input, const ImageChoice& choice,
                        const std::string& path);

}  // namespace host::openimageio
