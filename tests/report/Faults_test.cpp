// Clean looks have no faults; each fault that is planted into one is found, where it is.

#include <gtest/gtest.h>

#include <algorithm>
#include <boost/smart_ptr/make_shared.hpp>
#include <cmath>
#include <functional>
#include <limits>

#include "lut/LUT1D.h"
#include "lut/LUT3D.h"
#include "report/Report.h"

namespace {

namespace ol = Orlith::LUT;
using report::FaultKind;

constexpr float kNaN = std::numeric_limits<float>::quiet_NaN();

using Look = std::function<ol::RGB(const ol::RGB&)>;

boost::shared_ptr<ol::LUT> lattice(int points, const Look& look) {
    auto lut = boost::make_shared<ol::LUT3D>();
    lut->resize(points);
    ol::setUnitDomain(*lut, points, points, points);
    const auto place = [&](int i) {
        return static_cast<float>(i) / static_cast<float>(points - 1);
    };
    for (int b = 0; b < points; ++b) {
        for (int g = 0; g < points; ++g) {
            for (int r = 0; r < points; ++r)
                lut->get(r, g, b) = look(ol::RGB(place(r), place(g), place(b)));
        }
    }
    return lut;
}

boost::shared_ptr<ol::LUT> curve(int entries, const Look& look) {
    auto lut = boost::make_shared<ol::LUT1D>();
    lut->resize(entries);
    ol::setUnitDomain(*lut, entries, 1, 1);
    lut->transform[1][1] = lut->transform[2][2] = lut->transform[0][0];
    for (int i = 0; i < entries; ++i) {
        const float place = static_cast<float>(i) / static_cast<float>(std::max(entries - 1, 1));
        lut->get(i) = look(ol::RGB(place, place, place));
    }
    return lut;
}

template <class Change>
ol::RGB eachChannel(const ol::RGB& colour, Change&& change) {
    return {change(colour[0]), change(colour[1]), change(colour[2])};
}

ol::RGB identity(const ol::RGB& colour) {
    return colour;
}

/// Log footage, black at 0.093, to a display: its wide gamut is clipped at 0 before the power, so
/// that saturated colours begin with a steep step.
ol::RGB cameraLook(const ol::RGB& colour) {
    const ol::RGB scene = eachChannel(colour, [](float code) {
        return 0.18F * (std::exp2((code - 0.4F) * 12.0F) - std::exp2((0.093F - 0.4F) * 12.0F));
    });
    const ol::RGB display(1.7F * scene[0] - 0.6F * scene[1] - 0.1F * scene[2],
                          -0.15F * scene[0] + 1.3F * scene[1] - 0.15F * scene[2],
                          -0.02F * scene[0] - 0.2F * scene[1] + 1.22F * scene[2]);
    return eachChannel(display, [](float light) {
        const float positive = std::max(light, 0.0F);
        return std::pow(positive / (positive + 0.6F), 1.0F / 2.4F);
    });
}

/// Layers of dye that see a little of each other, each with its own toe and shoulder.
ol::RGB filmLook(const ol::RGB& colour) {
    const float grey = (colour[0] + colour[1] + colour[2]) / 3.0F;
    const auto layer = [&](float value, float gamma) {
        const float exposure = 0.85F * value + 0.15F * grey;
        return 0.02F + 0.94F / (1.0F + std::exp(-gamma * (exposure - 0.45F)));
    };
    return {layer(colour[0], 7.0F), layer(colour[1], 7.1F), layer(colour[2], 6.9F)};
}

/// Three curves, nearly alike.
ol::RGB curvesLook(const ol::RGB& colour) {
    return {std::pow(colour[0], 0.45F), std::pow(colour[1], 0.455F), std::pow(colour[2], 0.46F)};
}

std::string texts(const std::vector<report::Fault>& faults) {
    std::string all;
    for (const report::Fault& fault : faults)
        all += textOf(fault) + "\n";
    return all;
}

TEST(FaultsTest, CleanLooksHaveNone) {
    const struct {
        const char* name;
        boost::shared_ptr<ol::LUT> lut;
    } kCases[] = {
        {"identity", lattice(33, identity)},
        {"two points", lattice(2, identity)},
        {"camera, 17", lattice(17, cameraLook)},
        {"camera, 33", lattice(33, cameraLook)},
        {"camera, 65", lattice(65, cameraLook)},
        {"film", lattice(33, filmLook)},
        {"curves in a lattice", lattice(33, curvesLook)},
        {"rounded to 8 bits", lattice(33,
                                      [](const ol::RGB& colour) {
                                          return eachChannel(filmLook(colour), [](float value) {
                                              return std::round(value * 255.0F) / 255.0F;
                                          });
                                      })},
        {"black and white", lattice(17,
                                    [](const ol::RGB& colour) {
                                        const float grey =
                                            0.2F * colour[0] + 0.7F * colour[1] + 0.1F * colour[2];
                                        return ol::RGB(grey, grey, grey);
                                    })},
        {"curve", curve(1024, cameraLook)},
        {"long curve", curve(65536, filmLook)},
    };
    for (const auto& each : kCases)
        EXPECT_EQ(texts(report::reportOn(each.lut).faults), "") << each.name;
}

/// A lattice of 33 points with one sample changed.
boost::shared_ptr<ol::LUT> damaged(const Look& look, int r, int g, int b, const ol::RGB& change) {
    auto lut = lattice(33, look);
    lut->get(r, g, b) += change;
    return lut;
}

/// An identity whose points lie behind a pre-LUT: index 32 sqrt(input) of 32.
boost::shared_ptr<ol::LUT> damagedBehindShaper() {
    auto lut = damaged(identity, 16, 24, 8, {0.0F, 0.3F, 0.0F});
    for (int i = 0; i <= 1024; ++i) {
        const float root = std::sqrt(static_cast<float>(i) / 1024.0F);
        lut->outputShaper.entries.emplace_back(root, root, root);
    }
    lut->outputShaper.counts.fill(1025.0F);
    return lut;
}

TEST(FaultsTest, ThosePlantedAreFoundWhereTheyAre) {
    const auto damagedCurve = curve(1024, cameraLook);
    damagedCurve->get(700) -= ol::RGB(0.1F, 0.1F, 0.1F);
    const auto wide = damaged(identity, 8, 16, 24, {0.0F, 0.0F, 0.3F});
    for (unsigned c = 0; c < 3; ++c) {
        wide->transform[c][c] = 0.125F;  // -1 to 3
        wide->transform[3][c] = -1.0F;
    }
    const struct {
        const char* name;
        boost::shared_ptr<ol::LUT> lut;
        FaultKind kind;
        std::size_t faultCount;
        ol::RGB from, to;
        double amount;
        const char* text;
    } kCases[] = {
        {"a damaged sample",
         damaged(filmLook, 10, 20, 12, {0.2F, 0.0F, 0.0F}),
         FaultKind::Jump,
         2,
         {0.3125F, 0.625F, 0.375F},
         {0.3125F, 0.625F, 0.375F},
         0.2,
         "red jumps by 0.2 at 0.3125 0.625 0.375, in 3 rows of points"},
        {"a damaged entry",
         damagedCurve,
         FaultKind::Jump,
         2,
         {0.684262F, 0.684262F, 0.684262F},
         {0.684262F, 0.684262F, 0.684262F},
         0.1,
         "red, green, blue jump by 0.1 at 0.684262 0.684262 0.684262"},
        {"within a domain",
         wide,
         FaultKind::Jump,
         2,
         {0.0F, 1.0F, 2.0F},
         {0.0F, 1.0F, 2.0F},
         0.3,
         "blue jumps by 0.3 at 0 1 2"},
        {"behind a pre-LUT",
         damagedBehindShaper(),
         FaultKind::Jump,
         2,
         {0.25F, 0.5625F, 0.0625F},
         {0.25F, 0.5625F, 0.0625F},
         0.3,
         "green jumps by 0.3 at 0.25"},
        {"an edge in a ramp",
         lattice(33,
                 [](const ol::RGB& colour) {
                     return ol::RGB(colour[0], colour[1],
                                    colour[2] * 0.9F + (colour[2] < 0.5F ? 0.0F : 0.1F));
                 }),
         FaultKind::Jump,
         2,
         {0.0F, 0.0F, 0.46875F},
         {0.0F, 0.0F, 0.5F},
         0.1,
         "blue jumps by 0.1 from 0 0 0.46875 to 0 0 0.5, in 1089 rows of points"},
        {"a fold",
         lattice(33,
                 [](const ol::RGB& colour) {
                     const float green = colour[1] < 0.5F    ? colour[1]
                                         : colour[1] < 0.75F ? 0.7F - 0.4F * colour[1]
                                                             : 2.4F * colour[1] - 1.4F;
                     return ol::RGB(colour[0], green, colour[2]);
                 }),
         FaultKind::Fold,
         2,
         {0.0F, 0.5F, 0.0F},
         {0.0F, 0.75F, 0.0F},
         0.1,
         "green folds back by 0.1 from 0 0.5 0 to 0 0.75 0, in 1089 rows of points"},
        {"clipped white",
         lattice(33,
                 [](const ol::RGB& colour) {
                     return eachChannel(colour,
                                        [](float value) { return std::min(1.25F * value, 1.0F); });
                 }),
         FaultKind::Clip,
         1,
         {0.8125F, 0.8125F, 0.8125F},
         {1.0F, 1.0F, 1.0F},
         0.1875,
         "red, green, blue clip at 1 from 0.8125 0.8125 0.8125 to 1 1 1"},
        {"clipped black",
         lattice(33,
                 [](const ol::RGB& colour) {
                     return eachChannel(colour, [](float value) { return std::max(value, 0.25F); });
                 }),
         FaultKind::Clip,
         1,
         {0.0F, 0.0F, 0.0F},
         {0.25F, 0.25F, 0.25F},
         0.25,
         "red, green, blue clip at 0.25 from 0 0 0 to 0.25 0.25 0.25"},
        {"a clipped primary",
         lattice(33,
                 [](const ol::RGB& colour) {
                     return ol::RGB(std::clamp(1.5F * colour[0] - 0.5F * colour[1], 0.0F, 1.0F),
                                    colour[1], colour[2]);
                 }),
         FaultKind::Clip,
         1,
         {0.6875F, 0.0F, 0.0F},
         {1.0F, 0.0F, 0.0F},
         0.3125,
         "red clips at 1 from 0.6875 0 0 to 1 0 0"},
        {"a tint",
         lattice(33,
                 [](const ol::RGB& colour) {
                     return ol::RGB(colour[0], colour[1], colour[2] * (0.8F + 0.2F * colour[2]));
                 }),
         FaultKind::Tint,
         1,
         {0.5F, 0.5F, 0.5F},
         {0.5F, 0.5F, 0.5F},
         0.05,
         "neutrals lean to yellow by 0.05 at most, at 0.5 0.5 0.5"},
        {"no number",
         damaged(cameraLook, 4, 16, 32, {0.0F, kNaN, 0.0F}),
         FaultKind::NotFinite,
         1,
         {0.125F, 0.5F, 1.0F},
         {0.125F, 0.5F, 1.0F},
         std::numeric_limits<double>::infinity(),
         "1 sample is not finite, at 0.125 0.5 1"},
    };
    for (const auto& each : kCases) {
        SCOPED_TRACE(each.name);
        const std::vector<report::Fault> faults = report::reportOn(each.lut).faults;
        EXPECT_EQ(faults.size(), each.faultCount) << texts(faults);
        const auto fault = std::find_if(faults.begin(), faults.end(),
                                        [&](const auto& any) { return any.kind == each.kind; });
        if (fault == faults.end()) {
            ADD_FAILURE() << "not found in\n" << texts(faults);
            continue;
        }
        EXPECT_TRUE(fault->amount == each.amount || std::fabs(fault->amount - each.amount) < 2e-3)
            << fault->amount;
        for (unsigned c = 0; c < 3; ++c) {
            EXPECT_NEAR(fault->from[c], each.from[c], 1e-4F);
            EXPECT_NEAR(fault->to[c], each.to[c], 1e-4F);
        }
        EXPECT_EQ(textOf(*fault).rfind(each.text, 0), 0U) << textOf(*fault);
    }
}

TEST(FaultsTest, TablesOfAllKindsAreLookedAt) {
    const auto empty = boost::make_shared<ol::LUT3D>();
    const auto none = lattice(3, [](const ol::RGB&) { return ol::RGB(kNaN, kNaN, kNaN); });
    EXPECT_EQ(texts(report::reportOn(empty).faults), "");
    EXPECT_EQ(texts(report::reportOn(curve(1, identity)).faults), "");
    EXPECT_EQ(texts(report::reportOn(none).faults),
              "27 samples are not finite, the first at 0 0 0\n");
    // Places far apart, more than a person looks at one by one: all rows are counted.
    auto lut = lattice(33, identity);
    for (int i = 0; i < 10; ++i)
        lut->get(4 + 6 * (i % 5), 4 + 20 * (i / 5), 16) += ol::RGB(0.3F, 0.0F, 0.0F);
    std::size_t jumpCount = 0;
    std::uint64_t rowCount = 0;
    for (const report::Fault& fault : report::reportOn(lut).faults) {
        if (fault.kind != FaultKind::Jump) continue;
        ++jumpCount;
        rowCount += fault.count;
    }
    EXPECT_EQ(jumpCount, 8U);
    EXPECT_EQ(rowCount, 2U + 5U + 10U);  // along red, green and blue
}

TEST(CurveTest, HasSlopesAndTheTablesOwnPoints) {
    const report::Report report = report::reportOn(lattice(3, [](const ol::RGB& colour) {
        return ol::RGB(colour[0] * colour[0], 2.0F * colour[1], colour[2] + colour[0]);
    }));
    ASSERT_EQ(report.neutral.outputs.size(), 257U);
    EXPECT_EQ(report.neutral.inputs[128], ol::RGB(0.5F, 0.5F, 0.5F));
    EXPECT_EQ(report.neutral.outputs[128], ol::RGB(0.25F, 1.0F, 1.0F));
    EXPECT_EQ(report.neutral.slopes[128], ol::RGB(1.0F, 2.0F, 2.0F));
    EXPECT_EQ(report.neutral.slopes[0], ol::RGB(0.5F, 2.0F, 2.0F));
    EXPECT_EQ(report.channels[2].outputs[64], ol::RGB(0.0F, 0.0F, 0.25F));
    EXPECT_EQ(report.channels[2].slopes[256], ol::RGB(0.0F, 0.0F, 1.0F));
}

}  // namespace
