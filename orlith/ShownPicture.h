#pragma once

#include <string>

#include "host/ImageCodec.h"
#include "report/TestChart.h"

namespace orlith {

/// An image for a page: red, green and blue, made smaller by averaging where it is larger than a
/// screen needs.
/// @throws host::Error  it cannot be read
report::Picture readForPage(const std::string& path, const host::ImageChoice& choice);

/// A picture as the "data:" address of a JPEG file; what is beyond 0 to 1 is cut off.
/// @param folder       a file is made there for as long as it takes
/// @throws host::Error
std::string dataAddress(const report::Picture& picture, const std::string& folder);

}  // namespace orlith
