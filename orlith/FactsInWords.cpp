#include "orlith/FactsInWords.h"

#include <fmt/format.h>

#include "lut/evaluation/Look.h"
#include "orlith/Messages.h"

namespace orlith {
namespace {

namespace ol = Orlith::LUT;

std::string triple(const ol::RGB& rgb) {
    return colourText(rgb.data_block());
}

}  // namespace

std::vector<std::pair<std::string, std::string>> factsInWords(const Table& table,
                                                              const report::Report* report) {
    const ol::LUT& lut = *table.lut;
    const ol::Range domain = inputRangeOf(lut);
    std::vector<std::pair<std::string, std::string>> facts = {
        {"file", printable(table.name)},
        {"format", table.extension},
        {"table", fmt::format("{}, {}", lut.is1D() ? "1D" : "3D", sizeText(lut))},
        {"samples read", fmt::format("{}", table.samplesRead)},
        {"domain", fmt::format("{} to {}", triple(domain.min), triple(domain.max))}};
    const auto addShaper = [&](const char* name, const ol::Shaper& shaper) {
        if (shaper.empty()) return;
        facts.emplace_back(
            name, fmt::format("{} entries, counts {}, from {} to {}", shaper.entries.size(),
                              triple(shaper.counts), triple(shaper.entries.front()),
                              triple(shaper.entries.back())));
    };
    addShaper("input shaper", lut.inputShaper);
    addShaper("output shaper", lut.outputShaper);
    if (report == nullptr) {
        facts.emplace_back("range", "unknown: the file does not fill the table");
        return facts;
    }
    const report::Facts& found = report->facts;
    const auto yesNo = [](bool yes) { return yes ? "yes" : "no"; };
    facts.emplace_back("range", fmt::format("{} to {}", triple(found.min), triple(found.max)));
    facts.emplace_back("from identity", fmt::format("{:.6g} at most", report->identityDeviation));
    facts.emplace_back("monotone",
                       fmt::format("red {}, green {}, blue {}", yesNo(found.isMonotone[0]),
                                   yesNo(found.isMonotone[1]), yesNo(found.isMonotone[2])));
    return facts;
}

}  // namespace orlith
