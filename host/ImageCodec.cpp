#include "host/ImageCodec.h"

#include <dlfcn.h>

#include "host/Bundles.h"
#include "host/Error.h"
#include "host/Text.h"

namespace host {
namespace {

[[noreturn]] void failLoading() {
    throw Error("the image library cannot be loaded: " + oneLine(dlerror()));
}

/// Never unloaded: the libraries beneath it have threads and clean up when the program ends.
const ImageCodec& loadCodec() {
    // In a folder of its own, since all that is in the bundles' folder is loaded at the start.
    const std::string path = bundleFolderOfProgram() + "/images/openimageio.so";
    void* const module = dlopen(path.c_str(), RTLD_NOW | RTLD_LOCAL);
    if (module == nullptr) failLoading();
    void* const entry = dlsym(module, "orlithImageCodec");
    if (entry == nullptr) failLoading();
    return *reinterpret_cast<decltype(&orlithImageCodec)>(entry)();
}

}  // namespace

const ImageCodec& imageCodec() {
    static const ImageCodec& codec = loadCodec();
    return codec;
}

}  // namespace host
