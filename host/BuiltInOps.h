#pragma once

#include "zefra/Op.h"

namespace host {

// The operators that the host brings itself.

/// "Read": an image file, whose path is the control "file".
zefra::Op* makeRead(zefra::Node& node);

/// "CMSTestPattern": the test pattern of a cube of "size" points a side.
zefra::Op* makeTestPattern(zefra::Node& node);

/// Makes them known to the registry, once.
void registerBuiltInOps();

}  // namespace host
