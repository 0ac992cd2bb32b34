#include "report/Report.h"

#include <iterator>

#include "lut/evaluation/Look.h"
#include "report/CurveFaults.h"
#include "report/SampleFaults.h"

namespace report {

namespace ol = Orlith::LUT;

Report reportOn(const ol::LUT& lut, const Look& look) {
    Report report;
    report.domain = inputRangeOf(lut);
    report.facts = factsOf(lut);
    report.identityDeviation = identityDeviation(lut, look);
    report.neutral = neutralAxis(lut, look);
    for (unsigned c = 0; c < 3; ++c)
        report.channels[c] = channelAxis(lut, look, c);
    report.faults = sampleFaults(lut);
    const std::vector<Fault> ofCurves =
        curveFaults(report.neutral, report.channels, finiteRange(lut));
    report.faults.insert(report.faults.end(), ofCurves.begin(), ofCurves.end());
    return report;
}

Report reportOn(const boost::shared_ptr<const ol::LUT>& lut) {
    const ol::Evaluator evaluator(lut);
    return reportOn(
        *lut, [&](float* rgb, std::size_t colourCount) { evaluator.apply(rgb, rgb, colourCount); });
}

}  // namespace report
