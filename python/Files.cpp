#include "python/Files.h"

#include <boost/smart_ptr/shared_ptr.hpp>
#include <sstream>
#include <stdexcept>
#include <utility>

#include "lut/Exception.h"
#include "lut/evaluation/Deviation.h"
#include "lut/evaluation/Look.h"
#include "lut/io/Registry.h"
#include "lut/io/interchange/Fitting.h"
#include "lut/io/table/FileError.h"
#include "lut/io/table/FileFormat.h"
#include "lut/io/table/Proof.h"
#include "python/StagedFile.h"

namespace python {
namespace {

namespace ol = Orlith::LUT;

/// A reader or a writer for a format.
template <class Make>
auto make(Make create, const std::string& path, const std::string& extension) {
    try {
        return create("", true, extension);
    } catch (const ol::Exception& exception) {
        throw ol::FileError(path, 0, ol::formatProblem(exception.message(), extension, "format="));
    }
}

void setFlag(ol::LUTFileWriter& writer, const char* name, int value) {
    writer.setProperty(name, Orlith::Property::makeProperty<Orlith::Property::Int>(name, value));
}

/// Numbers as people write them, in six digits and one behind the other.
template <class... Numbers>
std::string text(Numbers... numbers) {
    std::ostringstream stream;
    stream.imbue(std::locale::classic());
    const char* blank = "";
    ((stream << std::exchange(blank, " ") << numbers), ...);
    return stream.str();
}

std::string rangeText(const ol::Range& range) {
    return text(range.min[0], range.min[1], range.min[2], "to", range.max[0], range.max[1],
                range.max[2]);
}

ol::Fitted fitTo(const std::string& path, const boost::shared_ptr<ol::LUT>& lut,
                 const std::string& extension, int size) {
    try {
        return ol::fit(lut, extension, size);
    } catch (const std::invalid_argument& problem) {
        throw ol::FileError(path, 0, problem.what());
    }
}

std::vector<std::string> lossesOf(const ol::Table& table, const ol::Fitted& fitted,
                                  const ol::Clipping& clipping) {
    std::vector<std::string> losses;
    if (fitted.losesInputs) {
        losses.push_back("its domain changes from " + rangeText(ol::inputRangeOf(*table.lut)) +
                         ", to " + rangeText(ol::inputRangeOf(*fitted.lut)));
    }
    if (clipping.numberCount > 0) {
        losses.push_back(std::to_string(clipping.numberCount) +
                         " numbers are clipped, the farthest " + text(clipping.farthest));
    }
    return losses;
}

void writeTo(const StagedFile& staged, ol::LUTFileWriter& writer, const std::string& path,
             const boost::shared_ptr<ol::LUT>& lut) {
    try {
        writer.write(staged.stagedPath(), lut);
    } catch (const ol::Exception& exception) {
        throw ol::FileError(path, 0, exception.message());
    }
    if (!writer.wroteAll()) {
        throw ol::FileError(path, 0, "not all of the file could be written");
    }
}

/// Reads the file as other programs do.
boost::shared_ptr<ol::LUT> readBack(const StagedFile& staged, const std::string& path,
                                    const std::string& extension,
                                    const ol::Options3DL& options3DL) {
    const auto reader = make(ol::createReader, path, extension);
    try {
        const ol::ReadOptions reading = ol::readingOf(extension, options3DL);
        return ol::readTable(*reader, staged.stagedPath(), path, reading).lut;
    } catch (const ol::FileError& error) {
        throw ol::FileError(path, error.line(),
                            error.reason() + " (while reading back what was written)");
    }
}

/// A steep shaper or a tiny domain takes more digits than a line of text has.
bool isHeldToTheDigit(const ol::Fitted& fitted, const Written& written,
                      const ol::Options3DL& options3DL) {
    const std::string& dialect = options3DL.dialect;
    return fitted.whyResampled.empty() && written.losses.empty() &&
           options3DL.scale == static_cast<float>(ol::ownScale(dialect)) &&
           options3DL.offset == static_cast<float>(ol::ownOffset(dialect)) &&
           ol::whyNotHeld(*fitted.lut, ".vf").empty();
}

}  // namespace

ol::Table readFile(const std::string& path, const ol::ReadOptions& options) {
    const std::string extension = ol::formatOf(path, options.from);
    ol::Table table = readTable(*make(ol::createReader, path, extension), path, path, options);
    table.extension = extension;
    // What is missing is no black.
    if (table.pointCount == 0 || !table.isFilled()) {
        throw ol::FileError(path, 0, sampleCounts(table));
    }
    if (table.samplesRead > table.pointCount) table.remarks.push_back({0, sampleCounts(table)});
    if (!options.isStrict) ol::foldStraightPreLUT(*table.lut);
    return table;
}

Written writeFile(const ol::Table& table, const std::string& path, const WriteOptions& options,
                  const std::function<void(const std::vector<std::string>& losses)>& tell) {
    Written written;
    written.format = ol::formatOf(path, options.to);
    const auto writer = make(ol::createWriter, path, written.format);
    setWriterProperties(*writer, options.options3DL);
    setFlag(*writer, "interchange", 1);
    setFlag(*writer, "flushLines", 0);

    const ol::Fitted fitted = fitTo(path, table.lut, written.format, options.size);
    written.whyResampled = fitted.whyResampled;
    written.losses =
        lossesOf(table, fitted, ol::clippingOf(*fitted.lut, written.format, options.options3DL));

    StagedFile staged(path);
    writeTo(staged, *writer, path, fitted.lut);
    if (!staged.isStream()) {
        const auto back = readBack(staged, path, written.format, options.options3DL);
        written.deviation = ol::lookDeviation(table.lut, back);
        const double precision = ol::precisionOf(written.format, options.options3DL, *fitted.lut);
        if (!(*written.deviation <= precision) &&
            isHeldToTheDigit(fitted, written, options.options3DL)) {
            throw ol::FileError(path, 0,
                                "read back, its look is off by " + text(*written.deviation));
        }
    }
    tell(written.losses);
    staged.deliver();
    return written;
}

}  // namespace python
