#include "orlith/bake/ProgramLook.h"

#include <fmt/format.h>

#include <boost/algorithm/string/replace.hpp>
#include <filesystem>
#include <set>
#include <system_error>

#include "host/Error.h"
#include "host/Host.h"
#include "host/ImageFile.h"
#include "orlith/Command.h"
#include "orlith/ImageOptions.h"
#include "orlith/Messages.h"
#include "orlith/Signals.h"
#include "orlith/bake/ImageProgram.h"
#include "orlith/bake/LookOp.h"
#include "orlith/bake/TemporaryFolder.h"
#include "orlith/pattern/PatternReading.h"

namespace orlith {
namespace {

namespace fs = std::filesystem;
namespace ol = Orlith::LUT;

void writePattern(const std::string& path, const ProgramLook& program, const ol::ColourWay& before,
                  int size) {
    host::Host host;
    host::Node& pattern = host.createNode("CMSTestPattern");
    pattern.setValue("size", std::to_string(size));
    const std::string sampleType = program.clips() ? "uint16" : "";
    if (before) {
        LookOp graded(pattern, *pattern.image(), before);
        host::writeImage(path, graded, sampleType);
    } else {
        host::writeImage(path, *pattern.image(), sampleType);
    }
}

void expectImage(const std::string& path, const std::string& programName) {
    std::error_code failure;
    if (!fs::is_regular_file(path, failure)) {
        throw Failure(programName + ": has left no image at {out}");
    }
    if (fs::file_size(path, failure) == 0) {
        throw Failure(programName + ": has left an empty file at {out}");
    }
}

/// A program may hold less of a number than the images do that it is given.
void warnOfCoarseness(const std::string& path, const std::string& name, bool isFloatSent) {
    const std::string type = host::ImageFile(path).sampleType();
    const std::set<std::string> coarseTypes = {"uint8", "uint10", "uint12", "half"};
    if (coarseTypes.count(type) == 0 && !(type == "uint16" && isFloatSent)) return;
    warn(fmt::format("{}: has {} samples, {{in}} has {}: the table's colours are as coarse", name,
                     type, isFloatSent ? "float" : "uint16"));
}

boost::shared_ptr<ol::LUT3D> readResult(const std::string& path, const std::string& name,
                                        const ProgramLook& program, int size) {
    host::Host host;
    host::Node& read = createRead(host, path, {});
    zefra::Iop& image = *read.image();
    image.validate(true);
    for (const std::string& text : read.takeWarnings())
        warn(boost::replace_all_copy(text, path, name));
    warnOfCoarseness(path, name, !program.clips());
    const PatternReading reading = readPattern(name, image, program.isForced);
    const int found = reading.table->width();
    if (found != size) {
        const std::string text =
            fmt::format("{}: holds a pattern of {} points a side instead of {}", name, found, size);
        if (!program.isForced) throw Failure(text);
        warn(text);
    }
    for (const std::string& text : reading.warnings)
        warn(text);
    ol::setUnitDomain(*reading.table, found, found, found);
    return reading.table;
}

}  // namespace

boost::shared_ptr<ol::LUT3D> bakeProgram(const ProgramLook& program, const ol::ColourWay& before,
                                         int size) {
    const OrderlyEnd inOrder;  // of the folder, which is gone before it
    const TemporaryFolder folder;
    const std::string in = folder.path("in." + program.imageType);
    const std::string out = folder.path("out." + program.imageType);
    const std::string& programName = program.words[0];
    const std::string outName = "{out} of " + programName;
    try {
        writePattern(in, program, before, size);
        runImageProgram(program.words, in, out);
        expectImage(out, programName);
        return readResult(out, outName, program, size);
    } catch (const host::Error& error) {
        throw Failure(boost::replace_all_copy(std::string(error.what()), out, outName));
    }
}

}  // namespace orlith
