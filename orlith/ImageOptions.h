#pragma once

#include <string>

#include "host/Host.h"
#include "host/ImageCodec.h"
#include "zefra/Iop.h"

namespace CLI {
class App;
}  // namespace CLI

namespace orlith {

/// Adds --part and --layer, which choose an image of a file that holds several.
void addImageChoice(CLI::App& command, host::ImageChoice& choice);

/// Adds --type, the type of the samples that are written; empty if not given.
void addSampleType(CLI::App& command, std::string& type);

/// Makes a node that reads an image file.
host::Node& createRead(host::Host& host, const std::string& path, const host::ImageChoice& choice);

/// Opens the image of such a node; a warning says what was taken where that was not clear.
/// @throws host::Error
zefra::Iop& openImage(host::Node& read);

}  // namespace orlith
