#include "lut/io/LUTFileReader.h"

#include <cerrno>
#include <cstring>

#include "lut/Exception.h"

namespace Orlith::LUT {

void LUTFileReader::failToOpen(const char* message) {
    remarks_.addLast(0, std::strerror(errno));
    throw Exception(message);
}

}  // namespace Orlith::LUT
