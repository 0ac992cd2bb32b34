#pragma once

#include <cstdint>
#include <optional>
#include <string>

namespace orlith {

/// Numbers of images that make a sequence: first, first + step, ..., not beyond last.
struct Frames {
    int first = 0;
    int last = 0;
    int step = 1;

    std::int64_t count() const { return (std::int64_t{last} - first) / step + 1; }
    int number(std::int64_t index) const { return static_cast<int>(first + index * step); }
};

/// "1-100", "1-100x2", or one number; at least one frame, none below 0.
std::optional<Frames> parseFrames(const std::string& word);

/// Whether a file name has a place for a number: "%04d", "%d", "####".
bool hasFrameNumber(const std::string& pattern);

/// The name of a frame's file, with its number in all such places, and as many zeros before it as
/// they say.
std::string frameName(const std::string& pattern, int frame);

}  // namespace orlith
