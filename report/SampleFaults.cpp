#include "report/SampleFaults.h"

#include <algorithm>
#include <cmath>
#include <limits>

#include "report/Facts.h"
#include "report/JumpFaults.h"
#include "report/Lines.h"
#include "report/PointInputs.h"

namespace report {
namespace {

namespace ol = Orlith::LUT;

// Two codes of 10 bits, the coarsest that tables are usually kept in: what is less may be left of
// the noise of a measured look, or of a resampled one.
constexpr double kFoldLimit = 2.0 / 1023.0;

// Samples that are not finite

void addNotFinite(const ol::LUT& lut, const PointInputs& inputs, std::vector<Fault>& faults) {
    Fault fault;
    fault.count = 0;
    fault.amount = std::numeric_limits<double>::infinity();
    forEachLine(lut, 0, [&](const Line& line) {
        for (int i = 0; i < line.pointCount; ++i) {
            bool isFinite = true;
            for (unsigned c = 0; c < 3; ++c) {
                if (std::isfinite(line.value(i, c))) continue;
                isFinite = false;
                fault.channels[c] = true;
            }
            if (isFinite) continue;
            if (fault.count++ == 0) fault.from = fault.to = inputs.at(line.point(i));
        }
    });
    if (fault.count > 0) faults.push_back(fault);
}

// Folds

struct Fold {
    double amount = 0.0;
    int from = 0;
    int to = 0;
};

/// The largest way back of a channel along a line, against the direction from its first to its last
/// sample.
Fold largestFold(const Line& line, unsigned channel) {
    Fold fold;
    const float whole = line.value(line.pointCount - 1, channel) - line.value(0, channel);
    const float direction = whole < 0.0F ? -1.0F : 1.0F;
    int crest = 0;
    for (int i = 0; i < line.pointCount; ++i) {
        const float back = (line.value(crest, channel) - line.value(i, channel)) * direction;
        if (!(back > 0.0F)) {
            if (!std::isnan(back) || std::isnan(line.value(crest, channel))) crest = i;
        } else if (std::isfinite(back) && static_cast<double>(back) > fold.amount) {
            fold = {static_cast<double>(back), crest, i};
        }
    }
    return fold;
}

void addFolds(const ol::LUT& lut, const PointInputs& inputs, double extent,
              std::vector<Fault>& faults) {
    for (unsigned c = 0; c < 3; ++c) {
        Fault fault;
        fault.kind = FaultKind::Fold;
        fault.channels[c] = true;
        fault.count = 0;
        forEachLine(lut, c, [&](const Line& line) {
            const Fold fold = largestFold(line, c);
            if (!(fold.amount > kFoldLimit * extent)) return;
            ++fault.count;
            if (fold.amount <= fault.amount) return;
            fault.amount = fold.amount;
            fault.from = inputs.at(line.point(fold.from));
            fault.to = inputs.at(line.point(fold.to));
        });
        if (fault.count == 0) continue;
        // The channels of a curve that are alike.
        const auto same = std::find_if(faults.begin(), faults.end(), [&](const Fault& other) {
            return other.kind == FaultKind::Fold && other.from == fault.from &&
                   other.to == fault.to;
        });
        if (same == faults.end()) {
            faults.push_back(fault);
        } else {
            same->channels[c] = true;
            same->amount = std::max(same->amount, fault.amount);
        }
    }
}

}  // namespace

std::vector<Fault> sampleFaults(const ol::LUT& lut) {
    std::vector<Fault> faults;
    const PointInputs inputs(lut);
    const FiniteRange range = finiteRange(lut);
    addNotFinite(lut, inputs, faults);
    addFolds(lut, inputs, range.extent(), faults);
    const std::vector<Fault> jumps = jumpFaults(lut, inputs, range);
    faults.insert(faults.end(), jumps.begin(), jumps.end());
    return faults;
}

}  // namespace report
