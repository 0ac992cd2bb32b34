#pragma once

#include <cstddef>
#include <string>

namespace Orlith::LUT {

/// A file that is being written; nothing is buffered here.
///
/// Failure  what the system does not take is no exception, but remembered. After it nothing more is
///          written, so that the file holds a beginning of what it should.
class OutputFile {
public:
    /// Creates the file, or empties it.
    /// @param wroteAll  set to false, and, when the file is closed, to whether the system took
    /// every
    ///                  byte, the closing included; outlives this object
    /// @throws Exception "unable to open file for writing"
    OutputFile(const std::string& filename, bool& wroteAll);
    OutputFile(const OutputFile&) = delete;
    OutputFile& operator=(const OutputFile&) = delete;
    /// Closes the file.
    ~OutputFile();

    void write(const char* bytes, std::size_t byteCount);

private:
    bool& wroteAll_;
    int descriptor_;
    bool isWhole_ = true;  // so far
};

}  // namespace Orlith::LUT
