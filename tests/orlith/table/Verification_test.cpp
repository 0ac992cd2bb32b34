#include "orlith/table/Verification.h"

#include <gtest/gtest.h>

#include <cmath>

#include "lut/io/Registry.h"
#include "orlith/Command.h"
#include "tests/support/Files.h"
#include "tests/support/Tables.h"

namespace {

TEST(Verification, MeasuresEveryChannelByTheDigitsOfTheFormat) {
    const struct {
        const char* extension;
        float written;
        float near;  // by less than half a unit of the last digit
        float far;   // by more
    } kCases[] = {
        {".cube", 0.5F, 0.5000005F, 0.5000007F},
        {".csp", -2.0F, -2.0000005F, -2.000001F},
        {".3dl", 512.0F / 1023.0F, 512.45F / 1023.0F, 512.55F / 1023.0F},
        {".blut", 0.5F, 0.5F, std::nextafter(0.5F, 1.0F)},
    };
    const test::TempFolder folder;
    const orlith::Options3DL options;
    for (const auto& each : kCases) {
        for (unsigned channel = 0; channel < 3; ++channel) {
            SCOPED_TRACE(each.extension + std::to_string(channel));
            const auto lut = test::markedLattice(3, 3, 3);
            float& number = lut->get(1, 2, 2)[channel];
            number = each.written;
            const std::string path = folder.path(std::string("file") + each.extension);
            const auto writer = Orlith::LUT::createWriter(path, false, "");
            setWriterProperties(*writer, options);
            writer->write(path, lut);

            const auto verified = [&] {
                return orlith::verify(path, "FILE", each.extension, *lut, options);
            };
            number = each.near;
            EXPECT_GE(verified(), static_cast<double>(0.9F * std::fabs(each.near - each.written)));
            number = each.far;
            try {
                verified();
                ADD_FAILURE() << "what is far passes";
            } catch (const orlith::Failure& failure) {
                const std::string start = "FILE: read back, sample 25 is ";
                EXPECT_EQ(std::string(failure.what()).substr(0, start.size()), start);
            }
        }
    }
}

TEST(Verification, TellsNoDeviationBelowTheTrueOne) {
    const struct {
        double deviation;
        const char* text;
    } kCases[] = {{0.0, "0"},           {0.5, "0.5"},      {0.000112, "0.00012"},
                  {4.01e-7, "4.1e-07"}, {0.00999, "0.01"}, {9.91e-6, "1e-05"},
                  {12.3, "13"},         {HUGE_VAL, "inf"}};
    for (const auto& [deviation, text] : kCases)
        EXPECT_EQ(orlith::deviationText(deviation), text);
}

}  // namespace
