#pragma once

#include <filesystem>

namespace Orlith::LUT {

/// Why no finished file may take the place of what stands at a path, as the system's error number;
/// 0 when one may, or nothing stands there.
int whyNotReplaceable(const std::filesystem::path& target);

/// Makes a finished file ready to take the place of another: it gets that one's permissions, and
/// its owner where that is allowed, and is on the disk before the other goes.
/// @return 0 or the system's error number
int prepareReplacement(const std::filesystem::path& finished, const std::filesystem::path& target);

}  // namespace Orlith::LUT
