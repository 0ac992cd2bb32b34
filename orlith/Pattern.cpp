#include <fmt/format.h>

#include "host/Host.h"
#include "host/ImageFile.h"
#include "orlith/Cancellation.h"
#include "orlith/Command.h"
#include "orlith/ImageOptions.h"
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
    host::Host host;
    host::Node& node = host.createNode("CMSTestPattern");
    node.setValue("size", std::to_string(options.size));
    const CancellableOutput output(options.path);
    host::writeImage(options.path, *node.image(), options.sampleType);
    output.expectNotCancelled();
    if (!options.isQuiet) {
        const zefra::Box& box = node.image()->box();
        fmt::print("{}: {} x {} x {} test pattern, {} x {} pixels\n", options.path, options.size,
                   options.size, options.size, box.width(), box.height());
    }
    return kDone;
}

}  // namespace

void addPattern(CLI::App& program, int& status) {
    CLI::App* const command =
        program.add_subcommand("pattern", "Write the test pattern of a colour cube as an image");
    const auto options = std::make_shared<PatternOptions>();
    command->add_option("OUT_IMAGE", options->path, "Image to write; EXR keeps every digit")
        ->required();
    command->add_option("--size", options->size, "Points on each side of the cube")
        ->check(CLI::Range(kSmallest, kLargest))
        ->capture_default_str();
    addSampleType(*command, options->sampleType);
    command->add_flag("--quiet", options->isQuiet, "Do not say what was written");
    command->callback([options, &status] { status = runPattern(*options); });
}

}  // namespace orlith
