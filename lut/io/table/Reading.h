#pragma once

#include <boost/smart_ptr/shared_ptr.hpp>
#include <cstdint>
#include <string>
#include <vector>

#include "lut/io/LUTFileReader.h"

namespace Orlith::LUT {

/// How a table file is read. The options of .3dl files do nothing to others.
struct ReadOptions {
    std::string from;       ///< extension with its dot; empty: the file's own
    bool isStrict = false;  ///< by the book, not as other programs mean their files
    std::string format3DL = "auto";
    int outputBitDepth = kDetect;
    bool normalizeOutput = false;
    bool placesFewSamples = true;  ///< also those of a table that the file does not fill

    static constexpr int kDetect = -2;
    static constexpr int kAsInput = -1;
};

/// A table and what its file said of it.
struct Table {
    boost::shared_ptr<LUT> lut;
    std::string name;  ///< of the file, for people
    std::string extension;
    std::uint64_t samplesRead = 0;
    std::uint64_t pointCount = 0;  ///< of the table
    std::vector<Remark> remarks;

    bool isFilled() const { return samplesRead >= pointCount; }
};

/// Answers for the commonest mistakes in the system's words.
/// @throws FileError
void expectReadableFile(const std::string& path, const std::string& name);

/// Reads a table, whether its file fills it or not.
/// @param reader      a new one of the format
/// @param name        what a failure calls the file
/// @throws FileError  the name, the line, and the library's message with its reason in words
Table readTable(LUTFileReader& reader, const std::string& path, const std::string& name,
                const ReadOptions& options);

/// What speaks of a file that holds fewer or more samples than its table has points.
std::string sampleCounts(const Table& table);

}  // namespace Orlith::LUT
