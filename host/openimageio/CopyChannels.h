#pragma once

#include "host/openimageio/CopyPlan.h"
#include "host/openimageio/CopyTarget.h"

namespace host::openimageio {

/// Chooses the channels that are written. All in their order where they have names; otherwise the
/// colours that change come first, then their alpha, then of the others as many as are held.
/// @param keepsOrder  all in their order, if all are held
void planChannels(PlannedImage& image, CopyTarget& target, bool keepsOrder);

/// Chooses the types of their samples. Each keeps its own where the format has such, and only the
/// colours that change and their alpha become what was asked for; otherwise one does for all.
void planTypes(PlannedImage& image, CopyTarget& target);

}  // namespace host::openimageio
