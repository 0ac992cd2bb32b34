#pragma once

#include <memory>
#include <string>

#include "host/ImageCodec.h"

namespace host::openimageio {

std::unique_ptr<ImageReader> openImage(const std::string& path, const ImageChoice& choice);
std::unique_ptr<ImageWriter> createImage(const std::string& path, const ImageFrame& frame,
                                         const std::string& sampleType);
CopiedImage copyImage(const ImageCopy& copy);

/// @param reason       the library's words, which may be many lines or none
/// @param unexplained  the text where there are none
[[noreturn]] void fail(const std::string& path, const std::string& reason, const char* unexplained);

}  // namespace host::openimageio
