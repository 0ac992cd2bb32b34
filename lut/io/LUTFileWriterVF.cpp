// Vector field (.vf): header, parameters, then one sample a line, blue fastest. See the reader for
// a drawing.

#include "lut/io/LUTFileWriterVF.h"

#include "lut/Exception.h"
#include "lut/io/Lattice.h"
#include "lut/io/interchange/WriteChecks.h"
#include "lut/io/text/LineWriter.h"

namespace Orlith::LUT {
namespace {

void writeHeader(LineWriter& file) {
    file.text("#Inventor V2.1 ascii").endLine();
    file.text("SoVectorField {").endLine();
}

void writeParameters(LineWriter& file, int pointsPerSide) {
    const int gridSize[] = {pointsPerSide, pointsPerSide, pointsPerSide};
    file.text("parameters").endLine();
    file.text("grid_size ").integerTriple(gridSize).endLine();

    // Deliberate: steps of 1/N, not 1/(N - 1), so that files stay byte for byte what they always
    // were; reading one back gives this matrix, not the table's own transform. Held by
    // VFWriter.PlacesGridInStepsOfOneOverN.
    Transform global;
    global.set_identity();
    for (unsigned c = 0; c < 3; ++c)
        global[c][c] = 1.0F / static_cast<float>(pointsPerSide);
    file.text("global_transform");
    for (unsigned i = 0; i < 16; ++i)
        file.text(" ").fixed(global[i / 4][i % 4]);
    file.endLine();
}

void writeSamples(LineWriter& file, const LUT& lut) {
    file.text("data").endLine();
    const float* const samples = lut.data();
    forEachBlueFastest(LatticeSize::of(lut), [&](std::size_t element) {
        file.fixedTriple(samples + 3 * element).endLine();
    });
    file.text("}").endLine();
}

}  // namespace

void LUTFileWriterVF::write(const std::string& filename, const boost::shared_ptr<LUT>& lut) {
    if (lut->is1D()) throw Exception("unable to write: must be a 3D lut");
    if (!LatticeSize::of(*lut).isCube()) {
        throw Exception("unable to write: must have the same dimension in r, g and b");
    }
    if (isInterchange()) {
        expectDomain(*lut);
        expectNoPreLUT(*lut);
        expectUnitDomain(*lut);
    }
    LineWriter file(filename, flushesLines(), wroteAll_);
    writeHeader(file);
    writeParameters(file, lut->width());
    writeSamples(file, *lut);
}

}  // namespace Orlith::LUT
