#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <string>
#include <utility>
#include <vector>

#include "report/Report.h"

namespace report {

/// A table on a page. Texts are in UTF-8; bytes that are none become replacement characters, and no
/// text can be markup.
struct PageTable {
    std::string name;
    std::vector<std::pair<std::string, std::string>> facts;  ///< name and value, in their order
    boost::shared_ptr<const Orlith::LUT::LUT> lut;           ///< two points or more on each axis
    Look look;
    Report report;  ///< on that look
};

/// A picture before and behind each table, as "data:" addresses.
struct PagePicture {
    std::string name;
    std::string caption;
    std::string before;
    std::vector<std::string> after;
};

/// A page for a browser that shows one table, or two and their difference: HTML in UTF-8 that needs
/// nothing else.
///
/// What is read off the curves is exact. The lattice has the table's own points, at most 65 a side,
/// or 51 of two tables, evenly chosen; 17 of a curve. Its colours are rounded to 16 bits of their
/// extent.
/// @param made  when and by what, for people
std::string pageOf(const std::vector<PageTable>& tables, const PagePicture& picture,
                   const std::string& made);

}  // namespace report
