#include "orlith/ImageOptions.h"

#include <CLI/CLI.hpp>
#include <limits>
#include <vector>

#include "orlith/Messages.h"
#include "orlith/Options.h"

namespace orlith {

void addImageChoice(CLI::App& command, host::ImageChoice& choice) {
    addInteger(command, "--part", 0, std::numeric_limits<int>::max(),
               "Image of a file that holds several, from 0; if not given, the first in colour",
               [&](int part) { choice.part = part; });
    command
        .add_option("--layer", choice.layer,
                    "Layer of an image: NAME of the channels NAME.R, NAME.G and NAME.B")
        ->type_name("NAME");
}

void addSampleType(CLI::App& command, std::string& type) {
    command
        .add_option("--type", type, "Type of the samples: uint8 uint10 uint12 uint16 half float")
        ->type_name("TYPE")
        ->check(CLI::IsMember(std::vector<std::string>(std::begin(host::kSampleTypes),
                                                       std::end(host::kSampleTypes))));
}

host::Node& createRead(host::Host& host, const std::string& path, const host::ImageChoice& choice) {
    host::Node& read = host.createNode("Read");
    read.setValue("file", path);
    read.setValue("part", std::to_string(choice.part));
    read.setValue("layer", choice.layer);
    return read;
}

zefra::Iop& openImage(host::Node& read) {
    zefra::Iop& image = *read.image();
    image.validate(true);
    for (const std::string& text : read.takeWarnings())
        warn(text + "; choose with --part or --layer");
    return image;
}

}  // namespace orlith
