#include "host/Bundles.h"

#include <dlfcn.h>

#include <algorithm>
#include <filesystem>
#include <system_error>
#ifdef __APPLE__
#include <mach-o/dyld.h>
#endif

#include "host/Error.h"
#include "host/Text.h"

namespace host {
namespace {

namespace fs = std::filesystem;

fs::path programPath() {
#ifdef __APPLE__
    std::uint32_t byteCount = 0;
    _NSGetExecutablePath(nullptr, &byteCount);
    std::string path(byteCount, '\0');
    _NSGetExecutablePath(path.data(), &byteCount);
    return fs::canonical(path.c_str());
#else
    return fs::canonical("/proc/self/exe");
#endif
}

}  // namespace

Bundle::Bundle(const std::string& path)
    // Absolute, since a bare file name would be looked for in the library path.
    : handle_(dlopen(fs::absolute(path).c_str(), RTLD_NOW | RTLD_LOCAL)) {
    if (handle_ == nullptr) throw Error(oneLine(dlerror()));
}

void Bundle::Close::operator()(void* handle) const {
    dlclose(handle);
}

std::string bundleFolderOfProgram() {
    return (programPath().parent_path().parent_path() / ORLITH_BUNDLE_FOLDER).string();
}

std::vector<std::string> bundlesIn(const std::string& folder) {
    std::vector<std::string> paths;
    try {
        for (const auto& entry : fs::directory_iterator(folder)) {
            if (entry.path().extension() == ".so") paths.push_back(entry.path().string());
        }
    } catch (const fs::filesystem_error& failure) {
        throw Error(folder + ": " + failure.code().message());
    }
    std::sort(paths.begin(), paths.end());
    return paths;
}

}  // namespace host
