#include "tests/support/Meant.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>

#include "lut/Evaluator.h"
#include "lut/io/Registry.h"
#include "lut/property/PropertySet.h"
#include "tests/support/Files.h"
#include "tests/support/ThreeDL.h"

namespace test {

ol::RGB evaluated(const boost::shared_ptr<const ol::LUT>& lut, const ol::RGB& input) {
    ol::RGB output;
    ol::Evaluator(lut).apply(input.data_block(), output.data_block(), 1);
    return output;
}

void expectMeant(const std::string& extension, const ol::RGB& input,
                 const std::vector<MeantFile>& files, const Reading3DL& prepare) {
    const TempFolder folder;
    for (const MeantFile& file : files) {
        SCOPED_TRACE(file.name);
        const auto reader = ol::createReader("", true, extension);
        prepare(*reader);
        setProperty<Orlith::Property::Int>(*reader, "interchange", file.isMeant ? 1 : 0);
        boost::shared_ptr<ol::LUT> lut;
        const std::string message =
            messageOf([&] { lut = reader->read(folder.write("table", file.text)); });
        EXPECT_EQ(message, file.message.empty() ? "(no exception)" : file.message);
        const auto remarks = reader->remarks();
        EXPECT_EQ(remarks.empty() ? "" : remarks.back().text, file.remark);
        if (!lut) continue;
        const ol::RGB output = evaluated(lut, input);
        for (unsigned c = 0; c < 3; ++c)
            EXPECT_NEAR(output[c], file.output[c], 1e-6F * std::max(1.0F, std::fabs(output[c])))
                << "channel " << c;
    }
}

}  // namespace test
