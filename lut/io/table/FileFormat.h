#pragma once

#include <string>

namespace Orlith::LUT {

/// An extension as the registry wants it: with its dot.
std::string withDot(const std::string& extension);

/// The format of a path: its own extension in small letters, unless one is given.
std::string formatOf(const std::string& path, const std::string& givenExtension);

/// The registry's text about an unknown extension, with the extension in it.
/// @param option  names the format where the file's name does not
std::string formatProblem(const char* message, const std::string& extension,
                          const std::string& option);

}  // namespace Orlith::LUT
