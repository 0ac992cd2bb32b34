#pragma once

#include <cstdint>
#include <stdexcept>
#include <string>
#include <utility>
#include <vector>

#include "lut/io/Remarks.h"

namespace Orlith::LUT {

/// What is wrong with a file, for people: "grade.cube:17: reason".
class FileError : public std::runtime_error {
public:
    /// @param file     its name, as people know it
    /// @param line     physical line, counted from 1; 0: the file as a whole
    /// @param remarks  what its reader had to say before
    FileError(const std::string& file, std::uint64_t line, const std::string& reason,
              std::vector<Remark> remarks = {})
        : std::runtime_error(file + (line == 0 ? "" : ":" + std::to_string(line)) + ": " + reason),
          file_(file),
          line_(line),
          reason_(reason),
          remarks_(std::move(remarks)) {}

    const std::string& file() const noexcept { return file_; }
    std::uint64_t line() const noexcept { return line_; }
    const std::string& reason() const noexcept { return reason_; }
    const std::vector<Remark>& remarks() const noexcept { return remarks_; }

private:
    std::string file_;
    std::uint64_t line_;
    std::string reason_;
    std::vector<Remark> remarks_;
};

}  // namespace Orlith::LUT
