#pragma once

#include <cstddef>
#include <cstdint>
#include <string>

namespace fuzz {

/// A file in memory that holds one input at a time. Readers open files by name; this one has a name
/// and touches no disk.
class MemoryFile {
public:
    MemoryFile();
    MemoryFile(const MemoryFile&) = delete;
    MemoryFile& operator=(const MemoryFile&) = delete;
    ~MemoryFile();

    const std::string& path() const { return path_; }
    void hold(const std::uint8_t* bytes, std::size_t byteCount);

private:
    int descriptor_;
    std::string path_;
};

}  // namespace fuzz
