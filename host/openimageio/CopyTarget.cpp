#include "host/openimageio/CopyTarget.h"

#include <algorithm>
#include <string_view>

namespace host::openimageio {

CopyTarget::CopyTarget(const OIIO::ImageOutput& format, std::string path,
                       const std::string& sampleType)
    : format_(format), path_(std::move(path)) {
    if (sampleType.empty()) return;
    wantedType_ = namedSampleType(sampleType);
    expectFormatHolds(path_, *wantedType_);
}

bool CopyTarget::supports(const char* feature) const {
    // The elements of a DPX file share one size and one set of channels: colours, and alpha.
    const std::string_view name = feature;
    const bool isOfOthers = name == "multiimage" || name == "nchannels";
    if (isOfOthers && std::string_view(formatName()) == "dpx") return false;
    return format_.supports(feature) != 0;
}

SampleType CopyTarget::heldType(const SampleType& type) {
    const auto found = std::find_if(heldTypes_.begin(), heldTypes_.end(),
                                    [&](const auto& each) { return each.first == type; });
    if (found != heldTypes_.end()) return found->second;
    return heldTypes_.emplace_back(type, nearestHeld(path_, type)).second;
}

void CopyTarget::lose(const std::string& text) {
    if (std::find(losses_.begin(), losses_.end(), text) == losses_.end()) losses_.push_back(text);
}

}  // namespace host::openimageio
