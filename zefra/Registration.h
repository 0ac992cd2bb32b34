#pragma once

#include <string>
#include <vector>

#include "zefra/Export.h"
#include "zefra/Op.h"

/// The version of this interface, for build stamps.
#define ZEFRA_HOST_VERSION "Zefra 1.0"

namespace zefra {

/// Registers an operator class for as long as it lives. A bundle holds one as a static object, so
/// that loading the bundle registers its operators and does nothing else.
class ZEFRA_EXPORT Description {
public:
    using Make = Op* (*)(Node& node);

    /// @param className   the name that nodes are made by
    /// @param buildStamp  build date and the host version that the bundle was built for
    /// @param make        makes an operator on a node; the caller owns it
    Description(const char* className, const char* buildStamp, Make make);
    Description(const Description&) = delete;
    Description& operator=(const Description&) = delete;
    ~Description();

    const char* className() const { return className_; }
    const char* buildStamp() const { return buildStamp_; }
    Op* makeOp(Node& node) const { return make_(node); }

    /// The class of that name, the one registered last where there are several; null for none.
    static const Description* find(const std::string& className);

    /// All that are registered now, in the order of registration.
    static const std::vector<const Description*>& all();

private:
    const char* className_;
    const char* buildStamp_;
    Make make_;
};

}  // namespace zefra
