#include "orlith/bake/TemporaryFolder.h"

#include <fmt/format.h>
#include <unistd.h>

#include <cerrno>
#include <system_error>

#include "orlith/Command.h"
#include "orlith/Messages.h"

namespace orlith {
namespace {

namespace fs = std::filesystem;

/// Of folders that were left read-only, from which nothing can be removed.
void allowRemoval(const fs::path& folder) {
    std::error_code ignored;
    fs::permissions(folder, fs::perms::owner_all, fs::perm_options::add, ignored);
    for (auto each = fs::recursive_directory_iterator(folder, ignored);
         each != fs::recursive_directory_iterator(); each.increment(ignored)) {
        if (fs::is_directory(each->symlink_status(ignored))) {
            fs::permissions(each->path(), fs::perms::owner_all, fs::perm_options::add, ignored);
        }
    }
}

}  // namespace

TemporaryFolder::TemporaryFolder() {
    std::error_code failure;
    const fs::path parent = fs::temp_directory_path(failure);
    if (failure) throw Failure("the folder for temporary files: " + failure.message());
    // Letters, digits and hyphens, which no program takes for more than a name.
    std::string pattern = (parent / "orlith-bake-XXXXXX").string();
    if (mkdtemp(pattern.data()) == nullptr) {
        throw Failure(
            fmt::format("{}: {}", parent.string(), std::generic_category().message(errno)));
    }
    folder_ = pattern;
}

TemporaryFolder::~TemporaryFolder() {
    std::error_code failure;
    fs::remove_all(folder_, failure);
    if (!failure) return;
    allowRemoval(folder_);
    fs::remove_all(folder_, failure);
    if (failure) {
        warn(fmt::format("{}: cannot be removed: {}", folder_.string(), failure.message()));
    }
}

}  // namespace orlith
