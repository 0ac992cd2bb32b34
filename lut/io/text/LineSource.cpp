#include "lut/io/text/LineSource.h"

#include <algorithm>
#include <cstring>

#include "lut/io/text/Numbers.h"

namespace Orlith::LUT {
namespace {

constexpr std::size_t kBlockBytes = std::size_t{256} << 10;

}  // namespace

LineSource::LineSource(std::istream& text, std::uint64_t& lineNumber, LineFilter* filter)
    : text_(text), lineNumber_(lineNumber), filter_(filter) {
    lineNumber_ = 0;
}

bool LineSource::next(std::string_view& line) {
    if (filter_ == nullptr) return nextPhysical(line);
    while (nextPhysical(line)) {
        isTriple_ = parsePlainTriple(line, triple_);
        if (isTriple_ && !filter_->wantsPlainTriples()) return true;
        if (!filter_->pass(line)) continue;
        isTriple_ = parsePlainTriple(line, triple_);
        return true;
    }
    filter_->end();
    isTriple_ = false;
    return false;
}

bool LineSource::parseTriple(std::string_view line, RGB& rgb) const {
    if (filter_ == nullptr) return parsePlainTriple(line, rgb);
    if (isTriple_) rgb = triple_;
    return isTriple_;
}

bool LineSource::nextPhysical(std::string_view& line) {
    std::size_t searched = 0;  // bytes after begin_ that hold no line end
    for (;;) {
        const char* start = buffer_.data() + begin_;
        const std::size_t available = end_ - begin_;
        const void* lineEnd = available > searched
                                  ? std::memchr(start + searched, '\n', available - searched)
                                  : nullptr;
        if (lineEnd != nullptr) {
            const auto length = static_cast<std::size_t>(static_cast<const char*>(lineEnd) - start);
            line = {start, length};
            begin_ += length + 1;
            ++lineNumber_;
            return true;
        }
        searched = available;
        if (available < kLongestLine && fill()) continue;

        line = {buffer_.data() + begin_, available};
        begin_ = end_;
        finished_ = true;
        if (available == 0) return false;
        ++lineNumber_;
        return true;
    }
}

/// Moves what is left to the front and reads a block behind it.
bool LineSource::fill() {
    if (finished_) return false;
    std::copy(buffer_.begin() + static_cast<std::ptrdiff_t>(begin_),
              buffer_.begin() + static_cast<std::ptrdiff_t>(end_), buffer_.begin());
    end_ -= begin_;
    begin_ = 0;
    // A long line doubles the buffer, so that its bytes are not moved over and over.
    const std::size_t wanted = std::clamp(2 * end_, kBlockBytes, kLongestLine);
    if (buffer_.size() < wanted) buffer_.resize(wanted);
    text_.read(buffer_.data() + end_, static_cast<std::streamsize>(buffer_.size() - end_));
    const auto byteCount = static_cast<std::size_t>(text_.gcount());
    finished_ = byteCount == 0;
    end_ += byteCount;
    return byteCount > 0;
}

}  // namespace Orlith::LUT
