#include "python/StagedFile.h"

#include <unistd.h>

#include <cerrno>
#include <cstdio>
#include <cstdlib>
#include <system_error>

#include "lut/io/table/FileError.h"

namespace python {

namespace fs = std::filesystem;

StagedFile::StagedFile(const std::string& path) : name_(path), stagedPath_(path) {
    std::error_code failure;
    target_ = fs::weakly_canonical(path, failure);
    if (failure) fail(failure.value());
    const fs::file_status status = fs::status(target_, failure);
    const bool isThere = fs::exists(status);
    if (path.empty()) fail(ENOENT);
    if (fs::is_directory(status) || !fs::path(path).has_filename()) fail(EISDIR);
    // Else a folder that may be written would let a file be replaced that may not.
    if (isThere && access(target_.c_str(), W_OK) != 0) fail(errno);
    if (isThere && !fs::is_regular_file(status)) return;

    std::string folder = (target_.parent_path() / ".orlith-XXXXXX").string();
    if (mkdtemp(folder.data()) == nullptr) fail(errno);
    folder_ = folder;
    stagedPath_ = (folder_ / target_.filename()).string();
}

StagedFile::~StagedFile() {
    std::error_code ignored;
    if (!isStream()) fs::remove_all(folder_, ignored);
}

void StagedFile::deliver() {
    if (isStream()) return;
    std::error_code failure;
    const fs::file_status before = fs::status(target_, failure);
    if (fs::exists(before)) fs::permissions(stagedPath_, before.permissions(), failure);
    if (std::rename(stagedPath_.c_str(), target_.c_str()) != 0) fail(errno);
}

void StagedFile::fail(int error) const {
    throw Orlith::LUT::FileError(name_, 0, std::generic_category().message(error));
}

}  // namespace python
