#pragma once

#include <string_view>

namespace report {

/// page/page.html with its style sheet, its scripts and the libraries that they use, put together
/// when the program is built. Left open: "{{title}}", twice, and then "{{data}}".
std::string_view pageTemplate();

}  // namespace report
