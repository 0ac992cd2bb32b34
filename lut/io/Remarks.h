#pragma once

#include <cstdint>
#include <map>
#include <string>
#include <vector>

namespace Orlith::LUT {

/// What a reader forgave, did not use, or stumbled over.
struct Remark {
    std::uint64_t line;  ///< physical line, counted from 1; 0: the file as a whole
    std::string text;    ///< a sentence without its full stop: "the domain is not used"
};

/// The remarks of one reading, in their order. A file can give cause for millions: of each kind the
/// first five are kept, and the number of the others.
class Remarks {
public:
    /// @param kind  tells remarks of one kind from those of others
    void add(const std::string& kind, std::uint64_t line, const std::string& text);

    /// Adds a remark that is kept whatever came before it.
    void addLast(std::uint64_t line, const std::string& text);

    void clear();

    /// Behind the fifth of a kind stands how many more there were.
    std::vector<Remark> list() const;

private:
    struct Kept {
        Remark remark;
        std::string kind;
    };
    std::vector<Kept> kept_;
    std::map<std::string, std::uint64_t> counts_;  // of each kind
};

}  // namespace Orlith::LUT
