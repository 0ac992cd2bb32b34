#pragma once

#include <OpenImageIO/imageio.h>

#include <optional>
#include <string>
#include <utility>
#include <vector>

#include "host/openimageio/SampleType.h"

namespace host::openimageio {

/// What the format of a copy holds, and what the copy has to do without.
class CopyTarget {
public:
    /// @param sampleType  one of kSampleTypes, or empty
    /// @throws Error      a type that the format does not hold
    CopyTarget(const OIIO::ImageOutput& format, std::string path, const std::string& sampleType);

    const char* formatName() const { return format_.format_name(); }

    /// Whether the format has a feature, of the library's list.
    bool supports(const char* feature) const;

    /// Whether channels have names and types of their own.
    bool holdsNamedChannels() const { return supports("channelformats"); }

    /// The type that was asked for.
    const std::optional<SampleType>& wantedType() const { return wantedType_; }

    /// The nearest type that the format holds.
    SampleType heldType(const SampleType& type);

    /// Notes what cannot be kept, in words behind the name of the file; once.
    void lose(const std::string& text);
    const std::vector<std::string>& losses() const { return losses_; }

private:
    const OIIO::ImageOutput& format_;
    const std::string path_;
    std::optional<SampleType> wantedType_;
    std::vector<std::pair<SampleType, SampleType>> heldTypes_;  // what was asked for so far
    std::vector<std::string> losses_;
};

}  // namespace host::openimageio
