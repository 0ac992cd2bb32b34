#pragma once

#include <memory>
#include <string>
#include <vector>

namespace host {

/// A loaded bundle, which has registered its operators; unloaded at the end.
class Bundle {
public:
    /// @throws Error  with the loader's reason
    explicit Bundle(const std::string& path);

private:
    struct Close {
        void operator()(void* handle) const;
    };
    std::unique_ptr<void, Close> handle_;
};

/// The folder of operators that goes with the running program: orlith in the library folder (lib,
/// or what the system has) beside its bin.
std::string bundleFolderOfProgram();

/// Paths of the bundles in a folder, sorted.
/// @throws Error  the folder cannot be read
std::vector<std::string> bundlesIn(const std::string& folder);

}  // namespace host
