#pragma once

#include <cstddef>
#include <deque>
#include <string>
#include <vector>

#include "lut/SampleArray.h"
#include "lut/io/Header3DL.h"
#include "lut/io/interchange/TextInterchange.h"

namespace Orlith::LUT {

/// Samples that wait for their table, first in, first out. Memory goes back as they leave.
class HeldSamples {
public:
    std::size_t size() const { return added_ - taken_; }
    void add(const RGB& sample);

    /// @return false if there is none
    bool take(RGB& sample);

private:
    std::deque<SampleArray> blocks_;
    std::size_t added_ = 0;
    std::size_t taken_ = 0;
};

/// What other programs' .3dl files are, beside their book.
///
///   Mesh 4 12               tells the size where there is no input grid
///   0 100 1020              a grid that is not evenly spaced is a shaper; its first code is taken
///   # comment                 for 0, its last one for 1, whatever its bits
///   0 0 0
///   ...                     the size of a file that states none is the cube root of its samples
///   LUT8                    words mean nothing here
class ThreeDLInterchange final : public TextInterchange {
public:
    using TextInterchange::TextInterchange;

    /// As meant: whether a line that is none of the header's, nor of numbers, can be left out.
    bool passesOver(std::string_view line);

    /// Looks at the line that the reader takes for the input grid.
    void watchGrid(std::string_view line, const Header3DL& header);

    /// As meant: the grid of the file, its own or the one that it has to have. Where that hangs on
    /// the number of samples they are all read and held.
    /// @param line  the first one below the header
    /// @throws Exception  it is neither a grid nor a sample, or the samples fill no cube
    Grid3DL findGrid(std::string_view line, const Header3DL& header, LineSource& lines);

    /// Takes the next of the samples that findGrid read.
    /// @return false if there is none
    bool takeHeld(RGB& rgb) { return held_.take(rgb); }

    /// Looks at the table that the reader has made.
    /// @throws Exception  it is not what the file says
    void finish(LUT& lut, LineSource& lines);

protected:
    const char* dataError() const override;
    bool isVerbatim(std::string_view line) override;
    bool takeComment(std::string_view line) override;
    bool takeKeyword(std::string_view) override { return !isBelowHeader_; }
    std::string reasonOf(std::string_view message, std::string_view lastLine) override;

private:
    Grid3DL gridOf(std::string_view line, const Header3DL& header);
    int countPoints();
    void hold(std::string_view line, const LineSource& lines);

    bool isBelowHeader_ = false;
    std::vector<float> shaper_;  // of all channels: the grid, if it is not evenly spaced
    HeldSamples held_;

    // What the reader found, for its failures.
    std::string gridEnds_;
    std::size_t gridSize_ = 0;
    int statedSize_ = 0;
};

}  // namespace Orlith::LUT
