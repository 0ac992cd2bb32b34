#include "tests/support/ForeignFiles.h"

#include <gtest/gtest.h>

#include "lut/Evaluator.h"
#include "lut/Exception.h"
#include "lut/io/Registry.h"
#include "lut/property/PropertySet.h"
#include "tests/support/Files.h"

namespace test {
namespace {

namespace ol = Orlith::LUT;
namespace property = Orlith::Property;

struct Result {
    boost::shared_ptr<ol::LUT> table;  // null: refused
    std::vector<std::string> remarks;
};

Result readFile(const std::string& extension, Mode mode, const std::string& text) {
    const TempFolder folder;
    const auto reader = ol::createReader("", true, extension);
    const int isMeant = mode == Mode::Meant ? 1 : 0;
    reader->setProperty("interchange",
                        property::makeProperty<property::Int>("interchange", isMeant));
    Result result;
    try {
        result.table = reader->read(folder.write("table", text));
    } catch (const ol::Exception&) {
    }
    for (const ol::Remark& remark : reader->remarks()) {
        result.remarks.push_back(std::to_string(remark.line) + ": " + remark.text);
    }
    return result;
}

}  // namespace

void expectLooks(const std::string& extension, const std::vector<ForeignFile>& files) {
    for (const ForeignFile& file : files) {
        SCOPED_TRACE(file.name);
        const Result result = readFile(extension, Mode::Meant, file.text);
        EXPECT_EQ(result.remarks, file.remarks);
        ASSERT_TRUE(result.table);
        const ol::Evaluator evaluator(result.table);
        for (const auto& [in, expected] : file.colours) {
            ol::RGB out;
            evaluator.apply(in.data_block(), out.data_block(), 1);
            for (unsigned c = 0; c < 3; ++c) {
                EXPECT_NEAR(out[c], expected[c], 1e-6F) << "channel " << c << " of " << in;
            }
        }
    }
}

void expectReasons(const std::string& extension, Mode mode,
                   const std::vector<UnreadableFile>& files) {
    for (const UnreadableFile& file : files) {
        SCOPED_TRACE(file.name);
        const Result result = readFile(extension, mode, file.text);
        EXPECT_FALSE(result.table);
        ASSERT_FALSE(result.remarks.empty());
        EXPECT_EQ(result.remarks.back(), file.reason);
    }
}

std::vector<std::string> remarksOn(const std::string& extension, Mode mode,
                                   const std::string& text) {
    return readFile(extension, mode, text).remarks;
}

}  // namespace test
