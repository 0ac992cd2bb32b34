#pragma once

#include <filesystem>
#include <string>

namespace orlith {

/// A folder that nobody else has, removed in the end with all that is in it by then.
class TemporaryFolder {
public:
    /// Makes it in the system's folder for such (TMPDIR, or /tmp).
    /// @throws Failure
    TemporaryFolder();
    TemporaryFolder(const TemporaryFolder&) = delete;
    TemporaryFolder& operator=(const TemporaryFolder&) = delete;
    /// What cannot be removed is a warning.
    ~TemporaryFolder();

    std::string path(const std::string& name) const { return (folder_ / name).string(); }

private:
    std::filesystem::path folder_;
};

}  // namespace orlith
