#include "fuzz/Input.h"

#include <sys/mman.h>
#include <unistd.h>

#include <cstdlib>

namespace fuzz {

MemoryFile::MemoryFile()
    : descriptor_(memfd_create("input", 0)), path_("/proc/self/fd/" + std::to_string(descriptor_)) {
    if (descriptor_ < 0) std::abort();
}

MemoryFile::~MemoryFile() {
    close(descriptor_);
}

void MemoryFile::hold(const std::uint8_t* bytes, std::size_t byteCount) {
    if (ftruncate(descriptor_, 0) != 0) std::abort();
    if (pwrite(descriptor_, bytes, byteCount, 0) != static_cast<ssize_t>(byteCount)) std::abort();
}

}  // namespace fuzz
