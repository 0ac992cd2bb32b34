#pragma once

#include <iostream>

namespace Orlith::LUT {

/// Tells the user, at once and on a line of its own, of something that does not stop the work.
inline void warn(const char* text) {
    std::cerr << text << std::endl;
}

}  // namespace Orlith::LUT
