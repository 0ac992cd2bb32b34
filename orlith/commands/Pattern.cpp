#include <fmt/format.h>
#include <CLI/CLI.hpp>

#include "host/Error.h"
#include "host/Host.h"
#include "host/ImageFile.h"
#include "orlith/Command.h"
#include "orlith/ImageOptions.h"
#include "orlith/Messages.h"
#include "orlith/Options.h"
#include "orlith/OutputFile.h"
#include "zefra/PatternLayout.h"

namespace orlith {
namespace {

constexpr int kSmallest = 2;
constexpr int kLargest = 129;

struct PatternOptions {
    std::string path;
    int size = 33;
    std::string sampleType;
    bool isQuiet = false;
};

int runPattern(const PatternOptions& options) {
    if (options.path == "-") {
        throw UsageError("an image goes to a file whose name has its format's extension");
    }
    host::Host host;
    host::Node& node = host.createNode("CMSTestPattern");
    node.setValue("size", std::to_string(options.size));
    OutputFile output(options.path);
    try {
        host::writeImage(output.stagedPath(), *node.image(), options.sampleType);
    } catch (const host::Error& error) {
        throw Failure(output.inWords(error.what()));
    }
    output.deliver();
    if (!options.isQuiet) {
        const zefra::Box& box = node.image()->box();
        output.print(fmt::format("{}: {} x {} x {} test pattern, {} x {} pixels\n",
                                 printable(output.name()), options.size, options.size, options.size,
                                 box.width(), box.height()));
    }
    return kDone;
}

}  // namespace

void addPattern(CLI::App& program, int& status) {
    CLI::App* const command =
        addCommand(program, "pattern", "Write the test pattern of a colour cube as an image");
    const auto options = std::make_shared<PatternOptions>();
    command->add_option("OUT_IMAGE", options->path, "Image to write; EXR keeps every digit")
        ->required();
    addInteger(*command, "--size", kSmallest, kLargest, "Points on each side of the cube (33)",
               [options](int size) { options->size = size; });
    addSampleType(*command, options->sampleType);
    command->add_flag("--quiet", options->isQuiet, "Do not say what was written");
    command->callback([options, &status] { status = runPattern(*options); });
}

}  // namespace orlith
