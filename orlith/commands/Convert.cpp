#include <fmt/format.h>

#include <cerrno>
#include <cmath>
#include <stdexcept>

#include "lut/Exception.h"
#include "lut/evaluation/Look.h"
#include "lut/io/Registry.h"
#include "lut/io/interchange/Fitting.h"
#include "orlith/Command.h"
#include "orlith/Messages.h"
#include "orlith/Options.h"
#include "orlith/OutputFile.h"
#include "orlith/table/TableFile.h"
#include "orlith/table/Verification.h"
#include "orlith/table/WriteOptions.h"

namespace orlith {
namespace {

namespace ol = Orlith::LUT;

struct ConvertOptions {
    std::string input;
    std::string output;
    std::string to;
    int size = 0;  // 0: the table's own
    ReadOptions reading;
    WriteOptions writing;
    bool skipsVerification = false;
    bool isQuiet = false;
};

/// Takes a pre-LUT away that changes nothing, such as the one that a .csp file has to have.
void dropIdentityPreLUT(ol::LUT& lut) {
    const ol::Shaper* const shapers[] = {&lut.inputShaper, &lut.outputShaper};
    for (const ol::Shaper* const shaper : shapers) {
        const auto& entries = shaper->entries;
        if (entries.size() != 2) return;
        for (unsigned c = 0; c < 3; ++c) {
            if (shaper->counts[c] != 2.0F || entries[0][c] != 0.0F || entries[1][c] != 1.0F) return;
        }
    }
    lut.inputShaper = {};
    lut.outputShaper = {};
}

boost::shared_ptr<ol::LUTFileWriter> makeWriter(const ConvertOptions& options,
                                                const std::string& extension) {
    try {
        return ol::createWriter("", true, extension);
    } catch (const ol::Exception& exception) {
        throw Failure(fmt::format("{}: {}", options.output,
                                  formatProblem(exception.message(), extension, "--to")));
    }
}

/// The library's text, and what to do about it.
std::string refusal(const ol::Exception& exception, const std::string& extension,
                    const ol::LUT& lut) {
    if (extension == ".blut" && lut.is1D()) return "a .blut file is written of lattices only";
    std::string text = exception.message();
    if (extension == ".cms" && !lut.is1D() && lut.outputShaper.empty()) {
        text += " (without --strict and --lut1d it gets some that change nothing)";
    }
    return text;
}

void writeTable(ol::LUTFileWriter& writer, const OutputFile& output, const std::string& extension,
                const boost::shared_ptr<ol::LUT>& lut) {
    try {
        errno = 0;
        writer.write(output.stagedPath(), lut);
    } catch (const ol::Exception& exception) {
        throw Failure(fmt::format("{}: {}", output.name(), refusal(exception, extension, *lut)));
    }
    if (!writer.wroteAll()) {
        throw Failure(fmt::format("{}: not all of the file could be written{}", output.name(),
                                  writeFailureReason(errno)));
    }
}

std::string rangeText(const ol::Range& range) {
    return fmt::format("{:.6g} {:.6g} {:.6g} to {:.6g} {:.6g} {:.6g}", range.min[0], range.min[1],
                       range.min[2], range.max[0], range.max[1], range.max[2]);
}

/// How far the file's look is from that of the table that it was made of: at the points of both,
/// half-way between the file's, and at random colours, within the domain that both have.
double lookDeviation(const boost::shared_ptr<ol::LUT>& source,
                     const boost::shared_ptr<ol::LUT>& written) {
    const ol::Range domain = intersection(inputRangeOf(*source), inputRangeOf(*written));
    const auto isInside = [&](const ol::RGB& colour) {
        for (unsigned c = 0; c < 3; ++c) {
            if (!(colour[c] >= domain.min[c] && colour[c] <= domain.max[c])) return false;
        }
        return true;
    };
    const ol::Evaluator a(source);
    const ol::Evaluator b(written);
    ol::LookComparison comparison(a, b);
    const auto addInside = [&](const ol::RGB& colour) {
        if (isInside(colour)) comparison.add(colour);
    };
    forEachInput(*written, true, addInside);
    // A resampled look is furthest off where the source has its bends.
    forEachInput(*source, false, addInside);
    for (const ol::RGB& entry : source->inputShaper.entries)
        addInside(entry);
    forEachRandom(domain, ol::kRandomColours,
                  [&](const ol::RGB& colour) { comparison.add(colour); });
    return largestOf(comparison.finish());
}

/// What half a unit of the format's last digit, and single precision, leave of a look.
double precisionOf(const std::string& extension, const Options3DL& options, const ol::LUT& lut) {
    float largest = 1.0F;
    const float* const samples = lut.data();
    for (std::uint64_t i = 0; i < 3 * pointCount(lut); ++i) {
        if (std::isfinite(samples[i])) largest = std::max(largest, std::fabs(samples[i]));
    }
    // A pre-LUT's six digits are multiplied by the slope of what is behind it.
    const double steepness = lut.inputShaper.empty() && lut.outputShaper.empty()
                                 ? 1.0
                                 : static_cast<double>(std::max(lut.width(), 2));
    const double relative = 1e-6 * static_cast<double>(largest) * steepness;
    if (extension != ".3dl") return 2e-6 + relative;
    return 0.6 / (std::ldexp(1.0, options.outputBits) - 1.0) /
               static_cast<double>(std::fabs(options.scale)) +
           relative;
}

/// Reads the file back as its format means it, and compares looks.
/// @return the summary's words
std::string compareLooks(const OutputFile& output, const std::string& extension,
                         const ConvertOptions& options, const Options3DL& options3DL,
                         const boost::shared_ptr<ol::LUT>& source, const ol::Fitted& fitted,
                         const std::string& clipping) {
    const Table back =
        readTable(output.stagedPath(), readingOf(extension, options3DL), output.name());
    const double deviation = lookDeviation(source, back.lut);
    std::string words = "largest deviation " + deviationText(deviation);
    std::vector<std::string> causes;
    if (!fitted.whyResampled.empty()) causes.push_back("resampled for " + fitted.whyResampled);
    if (fitted.whyResampled == "a shaper") causes.emplace_back("a .csp file keeps it");
    if (!clipping.empty()) causes.push_back(clipping);
    if (options.writing.hasPreLUT()) causes.emplace_back("the pre-LUT as asked for");
    if (options.writing.scale || options.writing.offset) causes.emplace_back("scale and offset");
    const bool isPrecise = deviation <= precisionOf(extension, options3DL, *fitted.lut);
    if (!isPrecise && causes.empty()) {
        // A steep shaper or a tiny domain takes more digits than a line of text has.
        if (ol::whyNotHeld(*fitted.lut, ".vf").empty()) {
            throw Failure(fmt::format("{}: read back, its look is off by {}", output.name(),
                                      deviationText(deviation)));
        }
        causes.emplace_back("the format's digits");
    }
    if (causes.empty()) return words;
    return fmt::format("{} ({})", words, fmt::join(causes, "; "));
}

ol::Fitted fitTo(const ConvertOptions& options, const boost::shared_ptr<ol::LUT>& lut,
                 const std::string& extension) {
    try {
        return fit(lut, extension, options.size);
    } catch (const std::invalid_argument& problem) {
        throw Failure(fmt::format("{}: {}", options.output, problem.what()));
    }
}

/// By the book only samples are sure to be written.
void warnOfLosses(const std::string& name, const std::string& extension, const ol::LUT& lut) {
    const std::string lost = ol::whyNotHeld(lut, extension);
    if (lost != "a shaper" && lost != "its domain") return;
    warn(fmt::format("{}: a {} file does not hold the table's {}", name, extension,
                     lost == "a shaper" ? "pre-LUT" : "domain"));
}

void setFlag(ol::LUTFileWriter& writer, const char* name, int value) {
    writer.setProperty(name, Orlith::Property::makeProperty<Orlith::Property::Int>(name, value));
}

int runConvert(const ConvertOptions& options) {
    const std::string extension = formatOf(options.output, options.to);
    const Options3DL options3DL = options.writing.options3DL();
    const auto writer = makeWriter(options, extension);
    setWriterProperties(*writer, options3DL);
    setFlag(*writer, "flushLines", 0);
    // A pre-LUT that is asked for is written by the book.
    const bool isByBook = options.reading.isStrict || options.writing.hasPreLUT();
    setFlag(*writer, "interchange", isByBook ? 0 : 1);

    if (options.writing.hasPreLUT() && !ol::takesRamp(extension)) {
        throw UsageError("--lut1d and --style1d are for .cms and .cub files");
    }
    const Table table = readWholeTable(options.input, options.reading);
    dropIdentityPreLUT(*table.lut);
    ol::Fitted fitted{table.lut, "", false};
    if (options.reading.isStrict) {
        warnOfLosses(options.output, extension, *table.lut);
    } else {
        fitted = fitTo(options, table.lut, extension);
    }
    addPreLUT(*fitted.lut, options.writing);
    const std::string unreadable = whyUnreadable(extension, *fitted.lut);
    const std::string clipping = clippingText(*fitted.lut, extension, options3DL);

    OutputFile output(options.output);
    output.interruptAtOnce();
    writeTable(*writer, output, extension, fitted.lut);
    if (fitted.losesInputs) {
        warn(fmt::format("{}: its domain changes from {}, to {}", output.name(),
                         rangeText(inputRangeOf(*table.lut)),
                         rangeText(inputRangeOf(*fitted.lut))));
    }
    std::string words = output.whyNotReadBack(options.skipsVerification);
    if (words.empty()) words = unreadable;
    if (!words.empty()) {
        words = "not verified: " + words;
    } else {
        words = "largest deviation " +
                deviationText(verify(output.stagedPath(), output.name(), extension, *fitted.lut,
                                     options3DL, isByBook));
        if (!options.reading.isStrict) {
            words =
                compareLooks(output, extension, options, options3DL, table.lut, fitted, clipping);
        }
    }
    output.deliver();
    if (!options.isQuiet) output.print(summary(output.name(), extension, *fitted.lut, words));
    return kDone;
}

}  // namespace

void addConvert(CLI::App& program, int& status) {
    CLI::App* const command = program.add_subcommand("convert", "Write a table in another format");
    const auto options = std::make_shared<ConvertOptions>();
    command->add_option("IN_LUT", options->input, "Table to read")->required();
    command->add_option("OUT_LUT", options->output, "File to write; its extension names the format")
        ->required();
    addFromOption(*command, options->reading);
    command
        ->add_option_function<std::string>(
            "--to", [options](const std::string& extension) { options->to = withDot(extension); },
            "Format to write where the name does not tell, such as 3dl")
        ->type_name("EXT");
    addInteger(*command, "--size", 2, 256, "Points a side; resamples a table of another size",
               [options](int size) { options->size = size; });
    addReadOptions(*command, options->reading);
    addWriteOptions(*command, options->writing);
    command->add_flag("--no-verify", options->skipsVerification,
                      "Do not read the written file back to compare it");
    command->add_flag("--quiet", options->isQuiet, "Do not say what was written");
    command->callback([options, &status] { status = runConvert(*options); });
}

}  // namespace orlith
