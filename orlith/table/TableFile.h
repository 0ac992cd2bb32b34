#pragma once

#include <string>

#include "lut/LUT.h"
#include "lut/io/table/FileFormat.h"
#include "lut/io/table/Reading.h"

namespace CLI {
class App;
}  // namespace CLI

namespace orlith {

using Orlith::LUT::formatOf;
using Orlith::LUT::formatProblem;
using Orlith::LUT::ReadOptions;
using Orlith::LUT::Table;
using Orlith::LUT::withDot;

/// --from
void addFromOption(CLI::App& command, ReadOptions& options);
/// --strict, and the options of .3dl files.
void addReadOptions(CLI::App& command, ReadOptions& options);

/// Of several tables, --from is for those whose names do not tell their formats.
ReadOptions readingAmong(const std::string& path, const ReadOptions& options);

/// Reads a table without a word about what the file lacks.
/// @param path      "-": standard input
/// @param name      what failures call the file; empty: its path
/// @throws Failure  the file's name, the line, and the library's message
Table readTable(const std::string& path, const ReadOptions& options, const std::string& name = "");

/// Reads a table, and warns of what its reader remarked, and where its file held fewer or more
/// samples than it has points.
Table readTableAndWarn(const std::string& path, const ReadOptions& options);

/// Likewise, but fewer samples are a failure: what is missing is no black.
Table readWholeTable(const std::string& path, const ReadOptions& options);

/// Reads a table to send colours through: a whole one; by the book, one as the format says.
Table readTableForColours(const std::string& path, const ReadOptions& options);

/// Size as people write it: "33 x 33 x 33 points", or "1024 entries".
std::string sizeText(const Orlith::LUT::LUT& lut);

/// Three floats with the digits that give the same ones again; NaN has no sign.
std::string colourText(const float* rgb);

/// Whether there is a reader for a format.
bool isReadable(const std::string& extension);

}  // namespace orlith
