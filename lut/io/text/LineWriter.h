#pragma once

#include <cstdio>
#include <memory>
#include <string>
#include <string_view>

namespace Orlith::LUT {

/// A text file that is written line by line: each line is put together in memory and handed to the
/// file whole.
class LineWriter {
public:
    /// Creates the file, or empties it.
    /// @param flushLines  true: every line goes to the system when it is complete;
    ///                    false: lines are gathered into large blocks
    /// @throws Exception "unable to open file for writing"
    LineWriter(const std::string& filename, bool flushLines);
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

    void endLine();

private:
    struct Close {
        void operator()(std::FILE* file) const noexcept { std::fclose(file); }
    };

    /// Room for that many characters more; pointer to the first.
    char* reserve(std::size_t length);
    void handOver();

    std::unique_ptr<std::FILE, Close> file_;
    std::size_t handOverAt_;  // gathered bytes that are worth a call
    std::string gathered_;    // fixed size; the first length_ characters count
    std::size_t length_ = 0;
};

}  // namespace Orlith::LUT
