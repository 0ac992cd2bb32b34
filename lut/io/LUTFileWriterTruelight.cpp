// Truelight cube (.cub): header, input LUT, then one sample a line, red fastest. See the reader for
// a drawing.

#include "lut/io/LUTFileWriterTruelight.h"

#include "lut/Exception.h"
#include "lut/io/Lattice.h"
#include "lut/io/interchange/LatticeUnits.h"
#include "lut/io/text/LineWriter.h"

namespace Orlith::LUT {
namespace {

void writeHeader(LineWriter& file, const LatticeSize& size) {
    file.text("# Truelight Cube v2.0").endLine();
    file.text("# iDims 3").endLine();
    file.text("# oDims 3").endLine();
    const int points[] = {size.width, size.height, size.depth};
    file.text("# width ").integerTriple(points).endLine();
}

void writeInputLUT(LineWriter& file, const Shaper& shaper) {
    if (shaper.empty()) return;
    file.text("# lutLength ").integer(static_cast<int>(shaper.entries.size())).endLine();
    file.text("# InputLUT").endLine();
    for (const RGB& entry : shaper.entries)
        file.fixedTriple(entry.data_block()).endLine();
}

void writeCube(LineWriter& file, const LUT& lut, const LatticeSize& size) {
    file.endLine();
    file.text("# Cube").endLine();
    const float* const samples = lut.data();
    forEachRedFastest(
        size, [&](std::size_t element) { file.fixedTriple(samples + 3 * element).endLine(); });
}

}  // namespace

void LUTFileWriterTruelight::write(const std::string& filename, const boost::shared_ptr<LUT>& lut) {
    if (lut->is1D()) throw Exception("unable to write: must be a 3D lut");
    const LatticeSize size = LatticeSize::of(*lut);
    const Shaper inputLUT = isInterchange() ? preLUTOfTruelight(*lut) : lut->outputShaper;
    LineWriter file(filename, flushesLines(), wroteAll_);
    writeHeader(file, size);
    writeInputLUT(file, inputLUT);
    writeCube(file, *lut, size);
}

}  // namespace Orlith::LUT
