#pragma once

#include <string>
#include <utility>
#include <vector>

#include "orlith/table/TableFile.h"
#include "report/Report.h"

namespace orlith {

/// What a table file holds, for a person: name and value, such as "range" and "0 0 0 to 1 1 1".
/// @param report  null where the file did not fill the table
std::vector<std::pair<std::string, std::string>> factsInWords(const Table& table,
                                                              const report::Report* report);

}  // namespace orlith
