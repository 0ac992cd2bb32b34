#include "lut/io/table/Replacement.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>

#include <cerrno>
#include <system_error>

namespace Orlith::LUT {

namespace fs = std::filesystem;

int whyNotReplaceable(const fs::path& target) {
    std::error_code ignored;
    if (!target.has_filename() || fs::is_directory(target, ignored)) return EISDIR;
    if (!fs::exists(target, ignored)) return 0;
    // Else a folder that may be written would let a file be replaced that may not.
    return access(target.c_str(), W_OK) == 0 ? 0 : errno;
}

int prepareReplacement(const fs::path& finished, const fs::path& target) {
    struct stat before {};
    if (stat(target.c_str(), &before) != 0) return 0;
    const int file = ::open(finished.c_str(), O_RDONLY | O_CLOEXEC);
    if (file < 0) return errno;
    fchmod(file, before.st_mode & 07777U);
    // Where that is not allowed the new file is the user's own.
    static_cast<void>(fchown(file, before.st_uid, before.st_gid) == 0);
    const int error = fsync(file) != 0 && errno != EINVAL ? errno : 0;
    ::close(file);
    return error;
}

}  // namespace Orlith::LUT
