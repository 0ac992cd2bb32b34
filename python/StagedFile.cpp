#include "python/StagedFile.h"

#include <cerrno>
#include <cstdio>
#include <cstdlib>
#include <system_error>

#include "lut/io/table/FileError.h"
#include "lut/io/table/Replacement.h"

namespace python {

namespace fs = std::filesystem;

StagedFile::StagedFile(const std::string& path) : name_(path), stagedPath_(path) {
    std::error_code failure;
    target_ = fs::weakly_canonical(path, failure);
    if (failure) fail(failure.value());
    if (path.empty()) fail(ENOENT);
    // A folder's name may end in a slash, which the target's does not.
    if (!fs::path(path).has_filename()) fail(EISDIR);
    if (const int error = Orlith::LUT::whyNotReplaceable(target_); error != 0) fail(error);
    const fs::file_status status = fs::status(target_, failure);
    if (fs::exists(status) && !fs::is_regular_file(status)) return;

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
    const int error = Orlith::LUT::prepareReplacement(stagedPath_, target_);
    if (error != 0) fail(error);
    if (std::rename(stagedPath_.c_str(), target_.c_str()) != 0) fail(errno);
}

void StagedFile::fail(int error) const {
    throw Orlith::LUT::FileError(name_, 0, std::generic_category().message(error));
}

}  // namespace python
