#include "host/BuiltInOps.h"

#include "zefra/Registration.h"

namespace host {

void registerBuiltInOps() {
    static const zefra::Description read("Read", "for " ZEFRA_HOST_VERSION, makeRead);
    static const zefra::Description pattern("CMSTestPattern", "for " ZEFRA_HOST_VERSION,
                                            makeTestPattern);
}

}  // namespace host
