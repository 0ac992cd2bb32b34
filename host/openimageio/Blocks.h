#pragma once

#include <OpenImageIO/imageio.h>

#include <string_view>

namespace host::openimageio {

/// How many lines of an image, from its first line on, its file and the library decode together; 0
/// where the image is better held whole: the library decodes all that stands before a line, or a
/// few blocks are as large as the image.
int blockLinesOf(const OIIO::ImageSpec& spec, std::string_view formatName);

}  // namespace host::openimageio
