#pragma once

#include <string>
#include <string_view>

#include "lut/io/OutputFile.h"

namespace Orlith::LUT {

/// A text file that is written line by line: each line is put together in memory and handed to the
/// file whole.
class LineWriter {
public:
    /// Creates the file, or empties it.
    /// @param flushLines  true: every line goes to the system when it is complete;
    ///                    false: lines are gathered into large blocks
    /// @param wroteAll    set, when the file is closed, to whether the system took every byte;
    ///                    outlives this object
    /// @throws Exception "unable to open file for writing"
    LineWriter(const std::string& filename, bool flushLines, bool& wroteAll);
    LineWriter(const LineWriter&) = delete;
    LineWriter& operator=(const LineWriter&) = delete;
    ~LineWriter();

    /// Adds to the line in hand.
    LineWriter& text(std::string_view text);
    LineWriter& integer(int number);
    LineWriter& fixed(float number);
    /// Three numbers separated by single blanks.
    LineWriter& fixedTriple(const float* rgb);
    LineWriter& integerTriple(const int* rgb);
    /// The same with all the digits that the numbers have.
    LineWriter& shortestTriple(const float* rgb);

    void endLine();

private:
    /// Room for that many characters more; pointer to the first.
    char* reserve(std::size_t length);
    void handOver();

    OutputFile file_;
    std::size_t handOverAt_;  // gathered bytes that are worth a call
    std::string gathered_;    // fixed size; the first length_ characters count
    std::size_t length_ = 0;
};

}  // namespace Orlith::LUT
