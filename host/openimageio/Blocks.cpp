#include "host/openimageio/Blocks.h"

#include <algorithm>
#include <cstdint>
#include <string>

namespace host::openimageio {
namespace {

/// Lines that a compression of OpenEXR puts together.
int linesOfOpenEXRBlock(const OIIO::ImageSpec& spec) {
    const std::string compression = spec.get_string_attribute("compression");
    if (compression == "none" || compression == "rle" || compression == "zips") return 1;
    if (compression == "zip" || compression == "pxr24") return 16;
    if (compression == "piz" || compression == "b44" || compression == "b44a") return 32;
    if (compression.compare(0, 4, "dwaa") == 0) return 32;
    return 256;  // dwab; a multiple of all the others
}

/// 0 where the library decodes from the first line on, whatever line is asked for.
int linesOfTIFFStrip(const OIIO::ImageSpec& spec) {
    const std::string compression = spec.get_string_attribute("compression");
    const bool isRandom = compression == "none" || compression == "zip";
    return isRandom ? spec.get_int_attribute("tiff:RowsPerStrip", spec.height) : 0;
}

/// 0 where a line cannot be decoded without those before it.
int linesDecodedTogether(const OIIO::ImageSpec& spec, std::string_view formatName) {
    if (formatName == "dpx") return 1;
    if (formatName != "openexr" && formatName != "tiff") return 0;
    if (spec.tile_height > 0) return spec.tile_height;
    return formatName == "tiff" ? linesOfTIFFStrip(spec) : linesOfOpenEXRBlock(spec);
}

/// Whether two blocks, decoded to float, take less than the image in its own sample type.
bool areBlocksSmaller(int blockLines, const OIIO::ImageSpec& spec) {
    const auto blockBytes = std::uint64_t{sizeof(float)} * static_cast<std::uint64_t>(blockLines);
    const auto imageBytes = spec.format.size() * static_cast<std::uint64_t>(spec.height);
    return 2 * blockBytes < imageBytes;  // for each column and channel
}

}  // namespace

int blockLinesOf(const OIIO::ImageSpec& spec, std::string_view formatName) {
    const int lines = std::clamp(linesDecodedTogether(spec, formatName), 0, spec.height);
    return areBlocksSmaller(lines, spec) ? lines : 0;
}

}  // namespace host::openimageio
