#pragma once

#include <CLI/CLI.hpp>
#include <boost/smart_ptr/shared_ptr.hpp>
#include <cstdint>
#include <string>
#include <vector>

#include "lut/LUT.h"
#include "lut/io/Remarks.h"

namespace orlith {

/// How a table file is read: --from, --strict, and the options of .3dl files, which others ignore.
struct ReadOptions {
    std::string from;       ///< extension with its dot; empty: the file's own
    bool isStrict = false;  ///< by the book, not as other programs mean their files
    std::string format3DL = "auto";
    int outputBitDepth = kDetect;
    bool normalizeOutput = false;

    static constexpr int kDetect = -2;
    static constexpr int kAsInput = -1;
};

void addFromOption(CLI::App& command, ReadOptions& options);
void addReadOptions(CLI::App& command, ReadOptions& options);

/// Of several tables, --from is for those whose names do not tell their formats.
ReadOptions readingAmong(const std::string& path, const ReadOptions& options);

/// A table and what its file said of it.
struct Table {
    boost::shared_ptr<Orlith::LUT::LUT> lut;
    std::string name;  ///< of the file, for people
    std::string extension;
    std::uint64_t samplesRead = 0;
    std::uint64_t pointCount = 0;  ///< of the table
    std::vector<Orlith::LUT::Remark> remarks;

    bool isFilled() const { return samplesRead >= pointCount; }
};

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

/// An extension as the library wants it: with its dot.
std::string withDot(const std::string& extension);

/// The format of a path: its own extension in small letters, unless one is given.
std::string formatOf(const std::string& path, const std::string& givenExtension);

/// Whether there is a reader for a format.
bool isReadable(const std::string& extension);

/// The library's text about an unknown extension, with the extension in it.
/// @param option  names the format where the file's name does not
std::string formatProblem(const char* message, const std::string& extension, const char* option);

}  // namespace orlith
