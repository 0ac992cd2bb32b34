#pragma once

#include <string>
#include <string_view>

namespace orlith {

/// A text that keeps to its line and does nothing to a terminal: control characters, which may
/// stand in file names, become "\n", "\x1b" and the like.
std::string printable(std::string_view text);

/// One line "orlith: error: ..." on standard error. Where nothing can be written the exit status
/// has to do.
void printError(const std::string& text);

/// One line "orlith: warning: ...".
void warn(const std::string& text);

}  // namespace orlith
