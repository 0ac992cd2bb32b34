#include <fmt/format.h>

#include <cerrno>
#include <cmath>

#include "lut/Exception.h"
#include "lut/io/Registry.h"
#include "orlith/Command.h"
#include "orlith/Messages.h"
#include "orlith/OutputFile.h"
#include "orlith/TableFile.h"
#include "orlith/Verification.h"
#include "orlith/WriteOptions.h"

namespace orlith {
namespace {

namespace ol = Orlith::LUT;

struct ConvertOptions {
    std::string input;
    std::string output;
    std::string to;
    ReadOptions reading;
    WriteOptions writing;
    bool skipsVerification = false;
    bool isQuiet = false;
};

/// Whether the domain is the one that a reader of the format gives to its tables.
bool keepsDomain(const ol::LUT& lut, const std::string& extension) {
    if (lut.is1D()) return true;
    if (extension == ".cub" && !lut.outputShaper.empty()) return true;
    const bool isVectorField = extension == ".vf" || extension == ".vfz" || extension == ".gz";
    const int sizes[] = {lut.width(), lut.height(), lut.depth()};
    for (unsigned c = 0; c < 3; ++c) {
        const float cells = static_cast<float>(isVectorField ? sizes[c] : sizes[c] - 1);
        const float reach = lut.transform[c][c] * cells;
        if (!(std::fabs(reach - 1.0F) < 1e-4F) || lut.transform[3][c] != 0.0F) return false;
    }
    return true;
}

/// Takes a pre-LUT away that changes nothing, such as the one that a .csp file has to have. A .cms
/// file has to have one too, and keeps its output side.
void dropIdentityPreLUT(ol::LUT& lut, const std::string& extension) {
    const ol::Shaper* const shapers[] = {&lut.inputShaper, &lut.outputShaper};
    for (const ol::Shaper* const shaper : shapers) {
        const auto& entries = shaper->entries;
        if (entries.size() != 2) return;
        for (unsigned c = 0; c < 3; ++c) {
            if (shaper->counts[c] != 2.0F || entries[0][c] != 0.0F || entries[1][c] != 1.0F) return;
        }
    }
    lut.inputShaper = {};
    if (extension != ".cms") lut.outputShaper = {};
}

/// Says what the format cannot hold of a table.
void warnOfLosses(const std::string& output, const std::string& extension, const ol::LUT& lut) {
    const bool hasPreLUT = !lut.inputShaper.empty() || !lut.outputShaper.empty();
    const bool keepsOutputShaper = extension == ".cub" || extension == ".cms";
    if (hasPreLUT && extension == ".csp") {
        warn(output + ": a .csp file does not give a pre-LUT back as it was");
    } else if (hasPreLUT && !keepsOutputShaper) {
        warn(fmt::format("{}: a {} file cannot hold the table's pre-LUT", output, extension));
    } else if (!lut.inputShaper.empty()) {
        warn(fmt::format("{}: a {} file cannot hold the input positions of the table's pre-LUT",
                         output, extension));
    }
    if (!keepsDomain(lut, extension)) {
        warn(fmt::format("{}: a {} file does not keep the table's domain", output, extension));
    }
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
        text += " (--lut1d 1024 --style1d linear gives it some)";
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

int runConvert(const ConvertOptions& options) {
    const std::string extension = formatOf(options.output, options.to);
    const Options3DL options3DL = options.writing.options3DL();
    const auto writer = makeWriter(options, extension);
    setWriterProperties(*writer, options3DL);
    writer->setProperty("flushLines",
                        Orlith::Property::makeProperty<Orlith::Property::Int>("flushLines", 0));

    const Table table = readWholeTable(options.input, options.reading);
    dropIdentityPreLUT(*table.lut, extension);
    addPreLUT(*table.lut, options.writing);
    const std::string unreadable = whyUnreadable(extension, *table.lut);
    if (!unreadable.empty() && !options.reading.isStrict) {
        throw Failure(fmt::format("{}: {}", options.output, unreadable));
    }
    OutputFile output(options.output);
    writeTable(*writer, output, extension, table.lut);
    warnOfLosses(output.name(), extension, *table.lut);

    Verification verification;
    verification.reason = output.whyNotReadBack(options.skipsVerification);
    if (verification.reason.empty()) verification.reason = unreadable;
    if (verification.reason.empty()) {
        verification =
            verify(output.stagedPath(), output.name(), extension, *table.lut, options3DL);
    }
    output.deliver();
    if (!options.isQuiet) {
        output.print(summary(output.name(), extension, *table.lut, verification));
    }
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
    addReadOptions(*command, options->reading);
    addWriteOptions(*command, options->writing);
    command->add_flag("--no-verify", options->skipsVerification,
                      "Do not read the written file back to compare it");
    command->add_flag("--quiet", options->isQuiet, "Do not say what was written");
    command->callback([options, &status] { status = runConvert(*options); });
}

}  // namespace orlith
