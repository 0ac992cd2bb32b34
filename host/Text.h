#pragma once

#include <string>
#include <string_view>

namespace host {

/// Without the blanks, tabs and line ends at both ends.
std::string_view trimmed(std::string_view text);

/// A text of several lines in one: line ends, and the blanks around them, become single blanks.
std::string oneLine(std::string_view text);

/// The first line of a text that says anything.
std::string firstLine(std::string_view text);

}  // namespace host
