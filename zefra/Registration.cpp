#include "zefra/Registration.h"

#include <algorithm>

namespace zefra {
namespace {

// Made on first use, since bundles register from static initialisers; never destroyed, since they
// unregister from static destructors.
std::vector<const Description*>& descriptions() {
    static auto* const registered = new std::vector<const Description*>;
    return *registered;
}

}  // namespace

Description::Description(const char* className, const char* buildStamp, Make make)
    : className_(className), buildStamp_(buildStamp), make_(make) {
    descriptions().push_back(this);
}

Description::~Description() {
    auto& registered = descriptions();
    registered.erase(std::remove(registered.begin(), registered.end(), this), registered.end());
}

const Description* Description::find(const std::string& className) {
    const auto& registered = descriptions();
    const auto found =
        std::find_if(registered.rbegin(), registered.rend(),
                     [&](const Description* each) { return className == each->className(); });
    return found == registered.rend() ? nullptr : *found;
}

const std::vector<const Description*>& Description::all() {
    return descriptions();
}

}  // namespace zefra
