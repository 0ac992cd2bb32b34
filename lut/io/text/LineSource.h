#pragma once

#include <cstddef>
#include <cstdint>
#include <istream>
#include <string_view>
#include <vector>

namespace Orlith::LUT {

/// The physical lines of a text, and the only place that counts them.
class LineSource {
public:
    /// Longest line in bytes, its end included: a small compressed file can hold an enormous one.
    /// Of a longer line this much is delivered, and nothing after it.
    static constexpr std::size_t kLongestLine = std::size_t{16} << 20;

    /// @param text        read from where it stands, in large blocks; outlives this object
    /// @param lineNumber  set to 0, then kept at the number of the line delivered last
    LineSource(std::istream& text, std::uint64_t& lineNumber);
    LineSource(const LineSource&) = delete;
    LineSource& operator=(const LineSource&) = delete;

    /// Delivers the next line without its "\n"; a last line may lack it.
    /// @param line  good until the next call
    /// @return false at the end of the text, line is then empty
    bool next(std::string_view& line);

private:
    bool fill();

    std::istream& text_;
    std::uint64_t& lineNumber_;
    std::vector<char> buffer_;
    std::size_t begin_ = 0;  // the undelivered bytes of buffer_
    std::size_t end_ = 0;
    bool finished_ = false;  // nothing more to be had from text_
};

}  // namespace Orlith::LUT
