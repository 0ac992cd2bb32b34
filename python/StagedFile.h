#pragma once

#include <filesystem>
#include <string>

namespace python {

/// A file that is written beside its place, and put there when it is whole; what stood there before
/// stays until then. A pipe or a device is written as it is.
class StagedFile {
public:
    /// @throws FileError  nothing can be written there, with the system's reason
    explicit StagedFile(const std::string& path);
    StagedFile(const StagedFile&) = delete;
    StagedFile& operator=(const StagedFile&) = delete;
    /// Removes what was not delivered.
    ~StagedFile();

    /// Where to write; it has the file's own name and extension.
    const std::string& stagedPath() const { return stagedPath_; }

    /// Whether nothing can be read back.
    bool isStream() const { return folder_.empty(); }

    /// @throws FileError
    void deliver();

private:
    [[noreturn]] void fail(int error) const;

    std::string name_;
    std::filesystem::path target_;  // behind links
    std::filesystem::path folder_;
    std::string stagedPath_;
};

}  // namespace python
