#pragma once

#include <OpenImageIO/imageio.h>

#include <array>
#include <string>
#include <vector>

#include "host/ImageCodec.h"
#include "host/openimageio/CopyTarget.h"

namespace host::openimageio {

/// An image of a file, and what becomes of it. Channels are numbered as they are read.
struct PlannedImage {
    int part = 0;
    OIIO::ImageSpec from;
    OIIO::ImageSpec to;
    std::vector<int> channels;      // for each that is written
    bool isChanged = false;         // whether it is of the part whose colours change
    std::array<int, 3> rgb = {};    // of that part
    std::array<int, 3> rgbTo = {};  // their places among those written
    int alpha = -1;                 // that goes with them; -1: none
    bool isPremultiplied = false;   // the colours are multiplied by it
    bool isAssociated = false;      // they are to be
};

struct CopyPlan {
    std::vector<PlannedImage> images;  // in the order of the file
    std::string remark;                // as ImageCopied::remark
};

/// Decides what is written, and how: all that the target holds.
/// @throws Error  what cannot be copied, such as deep images
CopyPlan planCopy(OIIO::ImageInput& input, const ImageCopy& copy, CopyTarget& target);

}  // namespace host::openimageio
