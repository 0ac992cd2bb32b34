#include <fmt/format.h>
#include <CLI/CLI.hpp>

#include <algorithm>
#include <atomic>
#include <cmath>
#include <cstdint>
#include <filesystem>
#include <memory>
#include <optional>
#include <set>
#include <string>
#include <vector>

#include "host/Error.h"
#include "host/ImageChecks.h"
#include "host/ImageCodec.h"
#include "host/ProgressDisplay.h"
#include "lut/evaluation/Look.h"
#include "orlith/Command.h"
#include "orlith/Frames.h"
#include "orlith/ImageOptions.h"
#include "orlith/Messages.h"
#include "orlith/Options.h"
#include "orlith/OutputFile.h"
#include "orlith/table/ColourOptions.h"
#include "orlith/table/TableFile.h"

namespace orlith {
namespace {

struct ApplyOptions {
    std::string image;
    std::string output;
    std::vector<std::string> tables;
    ReadOptions reading;
    ColourOptions colours;
    host::ImageChoice choice;
    std::string sampleType;
    std::optional<Frames> frames;
    bool unpremultiplies = false;
    int threadCount = 0;
    bool isQuiet = false;
};

void expectUsable(const ApplyOptions& options) {
    if (options.output == "-") {
        throw UsageError("an image goes to a file whose name has its format's extension");
    }
    if (std::count(options.tables.begin(), options.tables.end(), "-") > 1) {
        throw UsageError("only one of the tables can come from standard input");
    }
    if (!options.frames) {
        std::error_code ignored;
        if (hasFrameNumber(options.image) && !std::filesystem::exists(options.image, ignored)) {
            throw UsageError(
                fmt::format("{}: --frames says which frames, such as 1-100", options.image));
        }
        return;
    }
    for (const std::string& pattern : {options.image, options.output}) {
        if (!hasFrameNumber(pattern)) {
            throw UsageError(fmt::format(
                "with --frames \"{}\" has to have a place for the number, such as #### or %04d",
                pattern));
        }
    }
}

std::uint64_t countNaN(const float* rgb, std::size_t colourCount) {
    std::uint64_t count = 0;
    for (const float* each = rgb; each != rgb + 3 * colourCount; each += 3)
        count += std::isnan(each[0]) || std::isnan(each[1]) || std::isnan(each[2]) ? 1 : 0;
    return count;
}

/// A table, and the colours that have come to it from outside its domain since it was last asked.
struct AppliedTable {
    std::string name;
    ColourWay way;
    Orlith::LUT::Range inputs;
    bool canGoOn;  // beyond its domain: a curve and a pre-LUT end there
    std::atomic<std::uint64_t> outsideCount{0};  // added to by all threads
    std::atomic<std::uint64_t> nanCount{0};      // of them, those with a channel that is no number

    void apply(float* rgb, std::size_t colourCount) {
        std::uint64_t outside = 0;
        for (const float* each = rgb; each != rgb + 3 * colourCount; each += 3) {
            int kept =
                0;  // channels within, which NaN is not; without branches, which would cost more
            for (unsigned c = 0; c < 3; ++c)
                kept += int(inputs.min[c] <= each[c]) & int(each[c] <= inputs.max[c]);
            outside += kept == 3 ? 0 : 1;
        }
        outsideCount += outside;
        if (outside > 0) nanCount += countNaN(rgb, colourCount);
        way(rgb, colourCount);
    }
};

/// The tables in their order.
std::vector<std::unique_ptr<AppliedTable>> readTables(const ApplyOptions& options) {
    std::vector<std::unique_ptr<AppliedTable>> tables;
    for (const std::string& path : options.tables) {
        const Table table = readTableForColours(path, readingAmong(path, options.reading));
        tables.push_back(std::make_unique<AppliedTable>());
        AppliedTable& applied = *tables.back();
        applied.name = table.name;
        applied.way = wayThrough(table.lut, options.colours, options.reading.isStrict);
        applied.inputs = inputRangeOf(*table.lut);
        applied.canGoOn =
            !table.lut->is1D() && table.lut->inputShaper.empty() && table.lut->outputShaper.empty();
    }
    return tables;
}

/// Sends images through the tables, with one bar for all of them.
class Application {
public:
    explicit Application(const ApplyOptions& options)
        : options_(options), tables_(readTables(options)) {}

    int run() {
        if (options_.frames) {
            applyToFrames(*options_.frames);
        } else {
            progress_.message(options_.output);
            apply(options_.image, options_.output);
        }
        return kDone;
    }

private:
    void applyToFrames(const Frames& frames) {
        imageCount_ = frames.count();
        // What is not there is told before hours have gone by.
        for (std::int64_t i = 0; i < imageCount_; ++i)
            host::expectReadableFile(frameName(options_.image, frames.number(i)));
        progress_.message(options_.output);
        for (; imagesDone_ < imageCount_; ++imagesDone_) {
            const int frame = frames.number(imagesDone_);
            apply(frameName(options_.image, frame), frameName(options_.output, frame));
        }
    }

    void apply(const std::string& image, const std::string& path) {
        OutputFile output(path);
        host::ImageCopy copy;
        copy.from = image;
        copy.to = output.stagedPath();
        copy.choice = options_.choice;
        copy.sampleType = options_.sampleType;
        copy.unpremultiplies = options_.unpremultiplies;
        copy.threadCount = options_.threadCount;
        copy.change = [this](float* rgb, std::size_t colourCount) {
            for (const auto& each : tables_)
                each->apply(rgb, colourCount);
        };
        copy.progress = [&](double done) {
            output.expectNotCancelled();
            progress_.fraction((static_cast<double>(imagesDone_) + done) /
                               static_cast<double>(imageCount_));
        };
        const host::CopiedImage copied = copyImage(copy, output);
        output.deliver();
        report(image, output, copied);
    }

    static host::CopiedImage copyImage(const host::ImageCopy& copy, const OutputFile& output) {
        output.expectNotCancelled();
        try {
            return host::imageCodec().copy(copy);
        } catch (const host::Error& error) {
            throw Failure(output.inWords(error.what()));
        }
    }

    void report(const std::string& image, const OutputFile& output,
                const host::CopiedImage& copied) {
        if (!copied.remark.empty()) {
            warnOnce(image, copied.remark + "; choose with --part or --layer");
        }
        for (const std::string& loss : copied.losses)
            warnOnce(output.name(), loss);
        if (options_.unpremultiplies && !copied.isPremultiplied) {
            warnOnce(image, "its colours are not multiplied by alpha, and not divided by it");
        }
        warnOfColoursOutside(image, copied);
        if (options_.isQuiet) return;
        progress_.clear();
        output.print(fmt::format("{}: {} x {} pixels, {}\n", printable(output.name()), copied.width,
                                 copied.height, copied.sampleType));
    }

    /// Colours that a table does not tell from those at its edge: a loss, though the usual one.
    void warnOfColoursOutside(const std::string& image, const host::CopiedImage& copied) {
        for (const auto& each : tables_) {
            const std::uint64_t count = each->outsideCount.exchange(0);
            const std::uint64_t nanCount = each->nanCount.exchange(0);
            const bool isHeld = !(options_.colours.extrapolates && each->canGoOn);
            if (count == 0 || options_.reading.isStrict || !isHeld ||
                !clampedTables_.insert(each.get()).second)
                continue;
            progress_.clear();
            const double all = static_cast<double>(copied.width) * copied.height;
            warn(fmt::format(
                "{}: {:.3g} % of its colours are outside the domain of {}, {} to {}, and"
                " held at its edge{}{}",
                image, 100.0 * static_cast<double>(count) / all, each->name,
                colourText(each->inputs.min.data_block()),
                colourText(each->inputs.max.data_block()),
                each->canGoOn ? " (--extrapolate goes on in straight lines)" : "",
                nanCount == 0 ? ""
                              : fmt::format("; {} are no numbers, which count as its first point",
                                            nanCount)));
        }
    }

    /// The frames of a sequence are alike: what is said of one is not said of the others again.
    void warnOnce(const std::string& file, const std::string& text) {
        if (!warnings_.insert(text).second) return;
        progress_.clear();
        warn(fmt::format("{}: {}", file, text));
    }

    const ApplyOptions& options_;
    const std::vector<std::unique_ptr<AppliedTable>> tables_;
    host::ProgressDisplay progress_;
    std::int64_t imageCount_ = 1;
    std::int64_t imagesDone_ = 0;
    std::set<std::string> warnings_;               // that were given
    std::set<const AppliedTable*> clampedTables_;  // that were warned of
};

int runApply(const ApplyOptions& options) {
    expectUsable(options);
    return Application(options).run();
}

}  // namespace

void addApply(CLI::App& program, int& status) {
    CLI::App* const command =
        addCommand(program, "apply", "Send the colours of images through tables");
    const auto options = std::make_shared<ApplyOptions>();
    command->add_option("IMAGE", options->image, "Image to read: EXR, TIFF, DPX, PNG, JPEG ...")
        ->required();
    command
        ->add_option("OUT_IMAGE", options->output, "Image to write; its extension names the format")
        ->required();
    command
        ->add_option("--lut", options->tables,
                     "Table; may be given again: colours go through one after the other")
        ->type_name("LUT")
        ->allow_extra_args(false)
        ->required();
    addFromOption(*command, options->reading);
    addReadOptions(*command, options->reading);
    addColourOptions(*command, options->colours);
    addImageChoice(*command, options->choice);
    addSampleType(*command, options->sampleType);
    command
        ->add_option_function<std::string>(
            "--frames",
            [options](const std::string& word) {
                options->frames = parseFrames(word);
                if (options->frames) return;
                throw CLI::ValidationError(
                    "--frames",
                    fmt::format(
                        "\"{}\" has to be one run of frames from A up to B, such as 1-100 or "
                        "1-100x2 for every second one",
                        word));
            },
            "Images of a sequence: their names have #### or %04d in place of the number")
        ->type_name("A-B");
    constexpr int kMostThreads = 1024;
    addInteger(*command, "--threads", 1, kMostThreads,
               "Threads that share an image; if not given, one for each processor",
               [options](int count) { options->threadCount = count; });
    command->add_flag("--unpremultiply", options->unpremultiplies,
                      "Divide colours by alpha before the tables, and multiply them behind");
    command->add_flag("--quiet", options->isQuiet, "Do not say what was written");
    command->callback([options, &status] { status = runApply(*options); });
}

}  // namespace orlith
