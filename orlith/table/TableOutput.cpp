#include "orlith/table/TableOutput.h"

#include <fmt/format.h>
#include <CLI/CLI.hpp>

#include <cerrno>
#include <stdexcept>

#include "lut/Exception.h"
#include "lut/evaluation/Deviation.h"
#include "lut/io/Registry.h"
#include "lut/io/table/Proof.h"
#include "orlith/Command.h"
#include "orlith/Messages.h"
#include "orlith/table/Verification.h"

namespace orlith {
namespace {

namespace ol = Orlith::LUT;

boost::shared_ptr<ol::LUTFileWriter> makeWriter(const std::string& path,
                                                const std::string& extension) {
    try {
        return ol::createWriter("", true, extension);
    } catch (const ol::Exception& exception) {
        throw Failure(
            fmt::format("{}: {}", path, formatProblem(exception.message(), extension, "--to")));
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

void setFlag(ol::LUTFileWriter& writer, const char* name, int value) {
    writer.setProperty(name, Orlith::Property::makeProperty<Orlith::Property::Int>(name, value));
}

}  // namespace

void addTableOutputOptions(CLI::App& command, TableOutputOptions& options) {
    command.add_option("OUT_LUT", options.path, "File to write; its extension names the format")
        ->required();
    command
        .add_option_function<std::string>(
            "--to", [&](const std::string& extension) { options.to = withDot(extension); },
            "Format to write where the name does not tell, such as 3dl")
        ->type_name("EXT");
    addWriteOptions(command, options.writing);
    command.add_flag("--no-verify", options.skipsVerification,
                     "Do not read the written file back to compare it");
    command.add_flag("--quiet", options.isQuiet, "Do not say what was written");
}

TableOutput::TableOutput(const TableOutputOptions& options, bool isStrict)
    : options_(options),
      isStrict_(isStrict),
      // A pre-LUT that is asked for is written by the book.
      isByBook_(isStrict || options.writing.hasPreLUT()),
      extension_(formatOf(options.path, options.to)),
      options3DL_(options.writing.options3DL()),
      writer_(makeWriter(options.path, extension_)) {
    setWriterProperties(*writer_, options3DL_);
    setFlag(*writer_, "flushLines", 0);
    setFlag(*writer_, "interchange", isByBook_ ? 0 : 1);
    if (options.writing.hasPreLUT() && !ol::takesRamp(extension_)) {
        throw UsageError("--lut1d and --style1d are for .cms and .cub files");
    }
}

ol::Fitted TableOutput::fit(const boost::shared_ptr<ol::LUT>& lut, int size) const {
    try {
        return ol::fit(lut, extension_, size);
    } catch (const std::invalid_argument& problem) {
        throw Failure(fmt::format("{}: {}", options_.path, problem.what()));
    }
}

void TableOutput::write(OutputFile& output, const ol::Fitted& fitted, const Origin& origin) const {
    addPreLUT(*fitted.lut, options_.writing);
    const std::string unreadable = whyUnreadable(extension_, *fitted.lut);
    const std::string clipping = clippingText(*fitted.lut, extension_, options3DL_);
    // Elsewhere the summary says it.
    if (options_.isQuiet && !clipping.empty()) warn(fmt::format("{}: {}", output.name(), clipping));

    output.interruptAtOnce();
    writeTable(output, fitted.lut);
    std::string words = output.whyNotReadBack(options_.skipsVerification);
    if (words.empty()) words = unreadable;
    if (!words.empty()) {
        words = "not verified: " + words;
    } else {
        words = "largest deviation " +
                deviationText(verify(output.stagedPath(), output.name(), extension_, *fitted.lut,
                                     options3DL_, isByBook_));
        if (!isStrict_) words = compareLooks(output, fitted, origin, clipping);
    }
    output.deliver();
    if (!options_.isQuiet) output.print(summary(output.name(), extension_, *fitted.lut, words));
}

void TableOutput::writeTable(const OutputFile& output,
                             const boost::shared_ptr<ol::LUT>& lut) const {
    try {
        errno = 0;
        writer_->write(output.stagedPath(), lut);
    } catch (const ol::Exception& exception) {
        throw Failure(fmt::format("{}: {}", output.name(), refusal(exception, extension_, *lut)));
    }
    if (!writer_->wroteAll()) {
        throw Failure(fmt::format("{}: not all of the file could be written{}", output.name(),
                                  writeFailureReason(errno)));
    }
}

/// Reads the file back as its format means it.
Table TableOutput::readBack(const OutputFile& output) const {
    try {
        return readTable(output.stagedPath(), readingOf(extension_, options3DL_), output.name());
    } catch (const Failure& failure) {
        throw Failure(fmt::format("{} (while reading back what was written)", failure.what()));
    }
}

/// Compares the looks of file and origin.
/// @return the summary's words
std::string TableOutput::compareLooks(const OutputFile& output, const ol::Fitted& fitted,
                                      const Origin& origin, const std::string& clipping) const {
    const Table back = readBack(output);
    const double deviation = ol::lookDeviation(origin.table, back.lut);
    std::string words = "largest deviation " + deviationText(deviation);
    std::vector<std::string> causes = origin.causes;
    if (!clipping.empty()) causes.push_back(clipping);
    if (options_.writing.hasPreLUT()) causes.emplace_back("the pre-LUT as asked for");
    if (options_.writing.scale || options_.writing.offset) causes.emplace_back("scale and offset");
    const bool isPrecise = deviation <= ol::precisionOf(extension_, options3DL_, *fitted.lut);
    if (!isPrecise && causes.empty()) {
        // A steep shaper or a tiny domain takes more digits than a line of text has.
        if (ol::whyNotHeld(*fitted.lut, ".vf").empty()) {
            throw Failure(fmt::format("{}: read back, its look is off by {}", output.name(),
                                      deviationText(deviation)));
        }
        causes.emplace_back("the format's digits");
    }
    if (!causes.empty()) words = fmt::format("{} ({})", words, fmt::join(causes, "; "));
    return origin.judge ? fmt::format("{}, {}", words, origin.judge(back.lut)) : words;
}

}  // namespace orlith
