#pragma once

#include <cstddef>
#include <cstdint>
#include <istream>
#include <string_view>
#include <vector>

#include "lut/RGB.h"

namespace Orlith::LUT {

/// Stands between the lines of a text and their reader.
class LineFilter {
public:
    virtual ~LineFilter() = default;

    /// Sees each line before the reader does, three plain decimals excepted unless it asks for
    /// them.
    /// @param line  may be replaced; what it then shows is good until the next call
    /// @return false to keep it from the reader
    virtual bool pass(std::string_view& line) = 0;

    /// Whether lines of three plain decimals are to be seen too. Most of a file are, and they are
    /// read twice as fast without being looked at.
    virtual bool wantsPlainTriples() const { return false; }

    /// The text has ended.
    virtual void end() {}
};

/// The physical lines of a text, and the only place that counts them.
class LineSource {
public:
    /// Longest line in bytes, its end included: a small compressed file can hold an enormous one.
    /// Of a longer line this much is delivered, and nothing after it.
    static constexpr std::size_t kLongestLine = std::size_t{16} << 20;

    /// @param text        read from where it stands, in large blocks; outlives this object
    /// @param lineNumber  set to 0, then kept at the number of the line delivered last
    /// @param filter      null: every line is delivered as it is
    LineSource(std::istream& text, std::uint64_t& lineNumber, LineFilter* filter = nullptr);
    LineSource(const LineSource&) = delete;
    LineSource& operator=(const LineSource&) = delete;

    /// Delivers the next line without its "\n"; a last line may lack it.
    /// @param line  good until the next call
    /// @return false at the end of the text, line is then empty
    bool next(std::string_view& line);

    /// As parsePlainTriple for the line that was delivered last, which it may have been seen to be
    /// already.
    bool parseTriple(std::string_view line, RGB& rgb) const;

private:
    bool nextPhysical(std::string_view& line);
    bool fill();

    std::istream& text_;
    std::uint64_t& lineNumber_;
    LineFilter* filter_;
    bool isTriple_ = false;  // with a filter: the line delivered last is triple_
    RGB triple_;
    std::vector<char> buffer_;
    std::size_t begin_ = 0;  // the undelivered bytes of buffer_
    std::size_t end_ = 0;
    bool finished_ = false;  // nothing more to be had from text_
};

}  // namespace Orlith::LUT
