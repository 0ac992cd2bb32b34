#include "host/openimageio/CopyChannels.h"

#include <OpenImageIO/strutil.h>
#include <fmt/format.h>

#include <algorithm>
#include <map>
#include <string>
#include <utility>

namespace host::openimageio {
namespace {

const std::string& nameOfChannel(const OIIO::ImageSpec& spec, int channel) {
    return spec.channelnames[static_cast<std::size_t>(channel)];
}

/// The alpha that goes with colours: of their layer, or else of the image; -1: none.
int alphaOf(const OIIO::ImageSpec& spec, const std::array<int, 3>& rgb) {
    const std::string& red = nameOfChannel(spec, rgb[0]);
    const std::string layer = red.substr(0, red.rfind('.') + 1);  // with its dot; or empty
    for (int channel = 0; channel < spec.nchannels; ++channel) {
        const std::string& name = nameOfChannel(spec, channel);
        if (OIIO::Strutil::iequals(name, layer + "A") ||
            OIIO::Strutil::iequals(name, layer + "alpha")) {
            return channel;
        }
    }
    return layer.empty() ? spec.alpha_channel : -1;
}

/// The place of a channel in a list; -1: it is not there.
template <typename List>
int placeOf(int channel, const List& list) {
    const auto found = std::find(list.begin(), list.end(), channel);
    return found == list.end() ? -1 : static_cast<int>(found - list.begin());
}

void tellLostChannels(const PlannedImage& image, CopyTarget& target) {
    std::vector<std::string> lost;
    for (int channel = 0; channel < image.from.nchannels; ++channel) {
        if (placeOf(channel, image.channels) < 0) {
            lost.push_back(nameOfChannel(image.from, channel));
        }
    }
    if (lost.empty()) return;
    target.lose(fmt::format("holds no {} {}; left out", lost.size() == 1 ? "channel" : "channels",
                            fmt::join(lost, ", ")));
}

/// A line for each type that is not held, with the channels that had it.
void tellLostPrecision(const PlannedImage& image, const std::vector<SampleType>& types,
                       CopyTarget& target) {
    std::map<std::pair<std::string, std::string>, std::vector<std::string>> losses;
    for (std::size_t i = 0; i < types.size(); ++i) {
        const SampleType from = sampleTypeOf(image.from, image.channels[i]);
        if (holdsAllOf(types[i], from)) continue;
        const bool isLimited = from.type.is_floating_point() && !types[i].type.is_floating_point();
        losses[{nameOf(from), nameOf(types[i]) + (isLimited ? " from 0 to 1" : "")}].push_back(
            nameOfChannel(image.from, image.channels[i]));
    }
    for (const auto& [types_, channels] : losses) {
        target.lose(fmt::format("holds no {}: {} become {}", types_.first,
                                fmt::join(channels, ", "), types_.second));
    }
}

}  // namespace

void planChannels(PlannedImage& image, CopyTarget& target, bool keepsOrder) {
    const OIIO::ImageSpec& from = image.from;
    image.alpha = image.isChanged ? alphaOf(from, image.rgb) : from.alpha_channel;
    std::vector<int>& channels = image.channels;
    const bool isLimited = !target.supports("nchannels");
    if (image.isChanged && !target.holdsNamedChannels() && (isLimited || !keepsOrder)) {
        channels.assign(image.rgb.begin(), image.rgb.end());
        if (image.alpha >= 0) channels.push_back(image.alpha);
    }
    for (int channel = 0; channel < from.nchannels; ++channel) {
        if (placeOf(channel, channels) < 0) channels.push_back(channel);
    }
    if (isLimited) {
        const std::size_t most = target.supports("alpha") && image.alpha >= 0 ? 4 : 3;
        channels.resize(std::min(channels.size(), most));
        tellLostChannels(image, target);
    }

    OIIO::ImageSpec& to = image.to;
    to.nchannels = static_cast<int>(channels.size());
    to.channelnames.clear();
    for (const int channel : channels)
        to.channelnames.push_back(nameOfChannel(from, channel));
    for (std::size_t c = 0; c < image.rgb.size(); ++c)
        image.rgbTo[c] = placeOf(image.rgb[c], channels);
    to.alpha_channel = placeOf(image.alpha, channels);
    to.z_channel = placeOf(from.z_channel, channels);
}

void planTypes(PlannedImage& image, CopyTarget& target) {
    const bool holdsEach = target.holdsNamedChannels();
    const bool isWanted = image.isChanged && target.wantedType();
    const auto typeOf = [&](int channel) {
        const bool isColour = channel == image.alpha || placeOf(channel, image.rgb) >= 0;
        if (isWanted && (isColour || !holdsEach)) return *target.wantedType();
        return target.heldType(holdsEach ? sampleTypeOf(image.from, channel)
                                         : widestType(image.from));
    };
    std::vector<SampleType> types;
    for (const int channel : image.channels)
        types.push_back(typeOf(channel));
    if (!isWanted) tellLostPrecision(image, types, target);
    setSampleTypes(image.to, types);
}

}  // namespace host::openimageio
