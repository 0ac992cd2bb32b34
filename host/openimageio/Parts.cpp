#include "host/openimageio/Parts.h"

#include <OpenImageIO/strutil.h>
#include <fmt/format.h>

#include <algorithm>
#include <functional>
#include <map>
#include <optional>
#include <string_view>
#include <vector>

#include "host/Error.h"

namespace host::openimageio {
namespace {

/// Red, green and blue of each layer; the one without a name first.
using Layers = std::map<std::string, std::array<int, 3>>;

struct Part {
    int index = 0;
    std::string name;
    bool hasThreeChannels = false;
    Layers layers;

    std::string text() const {
        return name.empty() ? std::to_string(index) : fmt::format("{} \"{}\"", index, name);
    }
};

void expectPlainImage(const OIIO::ImageSpec& spec, const std::string& path) {
    if (spec.nchannels < 3) {
        throw Error(path, fmt::format("needs red, green and blue channels, has {}",
                                      std::max(spec.nchannels, 0)));
    }
    if (spec.deep || spec.depth > 1) throw Error(path, "is not a flat image");
}

/// 0, 1 or 2 for a channel that is called by its colour's letter or word; otherwise -1.
int colourOf(std::string_view word) {
    constexpr const char* kNames[][2] = {{"r", "red"}, {"g", "green"}, {"b", "blue"}};
    for (int colour = 0; colour < 3; ++colour) {
        for (const char* const name : kNames[colour]) {
            if (OIIO::Strutil::iequals(word, name)) return colour;
        }
    }
    return -1;
}

Layers layersOf(const OIIO::ImageSpec& spec) {
    Layers layers;
    for (std::size_t i = 0; i < spec.channelnames.size(); ++i) {
        const std::string& channel = spec.channelnames[i];
        const std::size_t dot = channel.rfind('.');
        const std::size_t start = dot == std::string::npos ? 0 : dot + 1;
        const int colour = colourOf(std::string_view(channel).substr(start));
        if (colour < 0) continue;
        auto& channels = layers
                             .try_emplace(channel.substr(0, std::max<std::size_t>(start, 1) - 1),
                                          std::array<int, 3>{-1, -1, -1})
                             .first->second;
        int& place = channels[static_cast<std::size_t>(colour)];
        if (place < 0) place = static_cast<int>(i);
    }
    for (auto each = layers.begin(); each != layers.end();) {
        const bool isWhole = *std::min_element(each->second.begin(), each->second.end()) >= 0;
        each = isWhole ? std::next(each) : layers.erase(each);
    }
    return layers;
}

/// A part of the file, if there is one of that index.
std::optional<Part> findPart(OIIO::ImageInput& input, int index) {
    if (!input.seek_subimage(index, 0)) {
        input.geterror();  // says what the caller knows now
        return {};
    }
    const OIIO::ImageSpec& spec = input.spec();
    Part part;
    part.index = index;
    part.name = spec.get_string_attribute("oiio:subimagename");
    part.hasThreeChannels = spec.nchannels >= 3 && !spec.deep && spec.depth <= 1;
    if (part.hasThreeChannels) part.layers = layersOf(spec);
    return part;
}

/// The parts of a file, or the first kMostParts.
std::vector<Part> partsOf(OIIO::ImageInput& input) {
    std::vector<Part> parts;
    while (parts.size() < kMostParts) {
        std::optional<Part> part = findPart(input, static_cast<int>(parts.size()));
        if (!part) break;
        parts.push_back(std::move(*part));
    }
    return parts;
}

[[noreturn]] void failWithoutPart(const std::vector<Part>& parts, int index,
                                  const std::string& path) {
    std::vector<std::string> texts;
    texts.reserve(parts.size());
    for (const Part& each : parts)
        texts.push_back(each.text());
    throw Error(path, fmt::format("has no part {}; it has {}", index, fmt::join(texts, ", ")));
}

[[noreturn]] void failWithoutLayer(const std::vector<Part>& parts, const std::string& layer,
                                   const std::string& path) {
    std::vector<std::string> texts;
    for (const Part& each : parts) {
        for (const auto& [name, channels] : each.layers) {
            if (!name.empty()) texts.push_back('"' + name + '"');
        }
    }
    throw Error(path, fmt::format("has no layer \"{}\"; it has {}", layer,
                                  texts.empty() ? "none" : fmt::to_string(fmt::join(texts, ", "))));
}

/// The first part that fits; a remark if there are more.
const Part* firstOf(const std::vector<Part>& parts, const std::function<bool(const Part&)>& fits,
                    std::string& remark) {
    const auto found = std::find_if(parts.begin(), parts.end(), fits);
    if (found == parts.end()) return nullptr;
    if (std::any_of(found + 1, parts.end(), fits)) {
        remark = fmt::format("holds {} parts{}: took part {}", parts.size(),
                             parts.size() == kMostParts ? " or more" : "", found->text());
    }
    return &*found;
}

Part choosePart(const std::vector<Part>& parts, const std::string& layer, std::string& remark) {
    const Part* part = firstOf(
        parts,
        [&](const Part& each) {
            return layer.empty() ? !each.layers.empty() : each.layers.count(layer) > 0;
        },
        remark);
    if (part == nullptr && layer.empty()) {
        part = firstOf(
            parts, [](const Part& each) { return each.hasThreeChannels; }, remark);
    }
    return part != nullptr ? *part : parts.front();  // which is refused
}

/// What is taken of a part where no layer was asked for.
std::array<int, 3> firstLayer(const Part& part, int channelCount, std::string& remark) {
    constexpr int kMostWithoutDoubt = 4;  // such as X, Y, Z and alpha
    if (part.layers.empty()) {
        if (channelCount > kMostWithoutDoubt) {
            remark = fmt::format("names none of {} channels red, green and blue: took the first",
                                 channelCount);
        }
        return {0, 1, 2};
    }
    const auto& [name, channels] = *part.layers.begin();
    if (!name.empty() && part.layers.size() > 1) {
        remark = fmt::format("holds {} layers: took \"{}\"", part.layers.size(), name);
    }
    return channels;
}

}  // namespace

ChosenImage chooseImage(OIIO::ImageInput& input, const ImageChoice& choice,
                        const std::string& path) {
    std::string partRemark;
    std::string layerRemark;
    std::vector<Part> parts;
    if (choice.part >= 0) {
        const std::optional<Part> part = findPart(input, choice.part);
        if (!part) failWithoutPart(partsOf(input), choice.part, path);
        parts.push_back(*part);
    } else {
        parts = partsOf(input);
        if (parts.empty()) throw Error(path, "has no pixels");
    }
    const Part part = choosePart(parts, choice.layer, partRemark);

    ChosenImage chosen;
    chosen.part = part.index;
    chosen.spec = input.spec(part.index);
    if (choice.layer.empty()) {
        expectPlainImage(chosen.spec, path);
        chosen.channels = firstLayer(part, chosen.spec.nchannels, layerRemark);
    } else {
        const auto layer = part.layers.find(choice.layer);
        if (layer == part.layers.end()) failWithoutLayer(parts, choice.layer, path);
        chosen.channels = layer->second;
    }
    chosen.remark =
        partRemark + (partRemark.empty() || layerRemark.empty() ? "" : "; ") + layerRemark;
    return chosen;
}

}  // namespace host::openimageio
