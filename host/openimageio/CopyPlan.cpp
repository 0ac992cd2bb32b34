#include "host/openimageio/CopyPlan.h"

#include <fmt/format.h>

#include <string_view>
#include <utility>

#include "host/Error.h"
#include "host/ImageChecks.h"
#include "host/openimageio/CopyChannels.h"
#include "host/openimageio/Parts.h"

namespace host::openimageio {
namespace {

/// What is about the old colours.
constexpr const char* kAboutColours[] = {
    "oiio:SHA-1",       "oiio:ConstantColor",  "oiio:AverageColor", "thumbnail_width",
    "thumbnail_height", "thumbnail_nchannels", "thumbnail_image"};

/// What the library takes for granted of a format, and would write down in another.
constexpr const char* kAboutFormat[] = {"oiio:ColorSpace", "oiio:Gamma"};

/// @param level  of smaller copies; 0: the part itself
bool hasImage(OIIO::ImageInput& input, int part, int level) {
    const bool has = input.seek_subimage(part, level);
    input.geterror();  // says that it has not
    return has;
}

void expectFlat(const OIIO::ImageSpec& spec, int part, const std::string& path) {
    if (spec.deep || spec.depth > 1) {
        throw Error(path, fmt::format("its part {} is not a flat image", part));
    }
    expectCredibleSize({spec.x, spec.y, spec.width, spec.height}, path);
}

/// The data window, where the format has such; otherwise its pixels are the whole picture.
void placeWindow(OIIO::ImageSpec& spec, CopyTarget& target) {
    const bool isWhole = spec.x == spec.full_x && spec.y == spec.full_y &&
                         spec.width == spec.full_width && spec.height == spec.full_height;
    const bool isAtOrigin = spec.x == 0 && spec.y == 0;
    const bool isNegative = spec.x < 0 || spec.y < 0 || spec.full_x < 0 || spec.full_y < 0;
    if ((isWhole || target.supports("displaywindow")) &&
        (isAtOrigin || target.supports("origin")) &&
        (!isNegative || target.supports("negativeorigin"))) {
        return;
    }
    target.lose("holds no such data window; its pixels become the whole picture");
    spec.x = spec.y = spec.full_x = spec.full_y = 0;
    spec.full_width = spec.width;
    spec.full_height = spec.height;
}

/// Alpha as the format has it. Colours that are not multiplied by it are in OpenEXR files.
void placeAlpha(PlannedImage& image, CopyTarget& target) {
    const bool isUnassociated = image.from.get_int_attribute("oiio:UnassociatedAlpha") != 0;
    image.isPremultiplied = image.alpha >= 0 && !isUnassociated;
    const bool isOpenEXR = std::string_view(target.formatName()) == "openexr";
    if (!isOpenEXR || !isUnassociated) return;
    image.to.erase_attribute("oiio:UnassociatedAlpha");
    if (image.alpha < 0) return;
    image.isAssociated = true;
    target.lose("holds colours multiplied by alpha; they are multiplied");
}

PlannedImage planImage(OIIO::ImageInput& input, int part, const ChosenImage& chosen,
                       const std::string& path, CopyTarget& target) {
    PlannedImage image;
    image.part = part;
    image.from = input.spec(part);
    expectFlat(image.from, part, path);
    image.to = image.from;
    image.isChanged = part == chosen.part;
    if (image.isChanged) image.rgb = chosen.channels;
    const bool keepsOrder = std::string_view(input.format_name()) == target.formatName();
    planChannels(image, target, keepsOrder);
    planTypes(image, target);
    placeWindow(image.to, target);
    placeAlpha(image, target);
    if (image.isChanged) {
        for (const char* const name : kAboutColours)
            image.to.erase_attribute(name);
    }
    if (std::string_view(input.format_name()) != target.formatName()) {
        for (const char* const name : kAboutFormat)
            image.to.erase_attribute(name);
    }
    if (hasImage(input, part, 1)) {
        target.lose("gets no smaller copies of the image (MIP levels)");
        image.to.erase_attribute("textureformat");  // which would promise them
    }
    if (!target.supports("tiles")) image.to.tile_width = image.to.tile_height = 0;
    return image;
}

}  // namespace

CopyPlan planCopy(OIIO::ImageInput& input, const ImageCopy& copy, CopyTarget& target) {
    const ChosenImage chosen = chooseImage(input, copy.choice, copy.from);
    CopyPlan plan;
    plan.remark = chosen.remark;
    const bool takesAll = target.supports("multiimage");
    for (int part = takesAll ? 0 : chosen.part; hasImage(input, part, 0); ++part) {
        if (!takesAll && part != chosen.part) break;
        if (takesAll && part == kMostParts) {
            throw Error(copy.from, fmt::format("holds more than {} parts", kMostParts));
        }
        plan.images.push_back(planImage(input, part, chosen, copy.from, target));
    }
    if (!takesAll && hasImage(input, chosen.part == 0 ? 1 : 0, 0)) {
        target.lose("holds one image; the other parts are left out");
    }
    return plan;
}

}  // namespace host::openimageio
