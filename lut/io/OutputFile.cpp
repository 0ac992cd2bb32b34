#include "lut/io/OutputFile.h"

#include <fcntl.h>
#include <unistd.h>

#include <cerrno>

#include "lut/Exception.h"

namespace Orlith::LUT {

OutputFile::OutputFile(const std::string& filename, bool& wroteAll)
    : wroteAll_(wroteAll),
      descriptor_(::open(filename.c_str(), O_WRONLY | O_CREAT | O_TRUNC | O_CLOEXEC, 0666)) {
    wroteAll_ = false;
    if (descriptor_ < 0) throw Exception("unable to open file for writing");
}

OutputFile::~OutputFile() {
    // Some file systems tell of a full disk or a lost server only now. An interrupted call is not
    // repeated: the descriptor is gone, and nobody can say where the bytes are.
    const bool isClosed = ::close(descriptor_) == 0;
    wroteAll_ = isWhole_ && isClosed;
}

void OutputFile::write(const char* bytes, std::size_t byteCount) {
    while (isWhole_ && byteCount > 0) {
        const ssize_t written = ::write(descriptor_, bytes, byteCount);
        if (written < 0 && errno == EINTR) continue;
        if (written <= 0) {
            isWhole_ = false;
            return;
        }
        bytes += written;
        byteCount -= static_cast<std::size_t>(written);
    }
}

}  // namespace Orlith::LUT
