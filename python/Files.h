#pragma once

#include <functional>
#include <optional>
#include <string>
#include <vector>

#include "lut/io/table/Options3DL.h"
#include "lut/io/table/Reading.h"

namespace python {

// Nothing here needs the lock of the interpreter. Paths are as the system takes them.

/// Reads a table that its file fills.
/// @throws FileError  with place and reason
Orlith::LUT::Table readFile(const std::string& path, const Orlith::LUT::ReadOptions& options);

/// How a table is written.
struct WriteOptions {
    std::string to;  ///< extension with its dot; empty: the path's
    int size = 0;    ///< points a side; 0: the table's own
    Orlith::LUT::Options3DL options3DL;
};

/// What became of a table that was written.
struct Written {
    std::string format;
    std::optional<double> deviation;  ///< largest, of the look; none where nothing is read back
    std::string whyResampled;         ///< empty: the table went in as it is
    std::vector<std::string> losses;  ///< what the format does not hold, in words
};

/// Writes a table with its look, reads the file back, and compares. The file is in place only when
/// all of this has gone well.
/// @param tell  hears of the losses before; what it throws stops the writing
/// @throws FileError  the format has no such table, or the file is not what was to be written
Written writeFile(const Orlith::LUT::Table& table, const std::string& path,
                  const WriteOptions& options,
                  const std::function<void(const std::vector<std::string>& losses)>& tell);

}  // namespace python
