// Files and texts are the same whatever locale the process has set.

#include <gtest/gtest.h>

#include <clocale>
#include <cstdio>
#include <locale>
#include <sstream>
#include <string>

#include "lut/io/Registry.h"
#include "lut/property/Property.h"
#include "tests/support/Files.h"
#include "tests/support/Tables.h"
#include "tests/support/ThreeDL.h"

namespace {

using namespace test;

/// A German process, in C and in C++: comma before the fraction, points between thousands.
class GermanLocale {
public:
    GermanLocale() : cLocale_(std::setlocale(LC_ALL, nullptr)) {
        std::locale::global(std::locale(kName));  // throws where the locale is not installed
        if (std::setlocale(LC_ALL, kName) == nullptr) throw std::runtime_error("no German locale");
    }
    GermanLocale(const GermanLocale&) = delete;
    GermanLocale& operator=(const GermanLocale&) = delete;
    ~GermanLocale() {
        std::locale::global(cppLocale_);
        std::setlocale(LC_ALL, cLocale_.c_str());
    }

private:
    static constexpr char kName[] = "de_DE.UTF-8";
    std::locale cppLocale_;  // the global one, as it was
    std::string cLocale_;
};

void expectGermanNumbers() {
    char text[16];
    std::snprintf(text, sizeof(text), "%.1f", 0.5);
    ASSERT_STREQ(text, "0,5");
    std::ostringstream stream;
    stream << 1234.5;
    ASSERT_EQ(stream.str(), "1.234,5");
}

/// A lattice with large and small numbers, and a pre-LUT for the formats that hold one.
boost::shared_ptr<ol::LUT3D> makeTable() {
    auto lut = markedLattice(3, 3, 3);
    lut->get(1, 0, 2) = ol::RGB(1234567.5F, -0.0625F, 1e-5F);
    for (int i = 0; i < 3; ++i)
        lut->outputShaper.entries.push_back(markedSample(i, i, i));
    lut->outputShaper.counts.fill(3.0F);
    return lut;
}

TEST(Locale, DoesNotShowInTextFiles) {
    const TempFolder folder;
    for (const std::string extension : {".3dl", ".cms", ".csp", ".cub", ".cube", ".vf"}) {
        SCOPED_TRACE(extension);
        const std::string plain = folder.path("plain" + extension);
        const std::string german = folder.path("german" + extension);
        const auto write = [](const std::string& path) {
            const auto writer = ol::createWriter(path, false, "");
            Writing3DL{"lustre"}(*writer);  // options that other formats do not look at
            writer->write(path, makeTable());
        };
        const auto read = [](const std::string& path) {
            const auto reader = ol::createReader(path, false, "");
            Reading3DL{}(*reader);
            return reader->read(path);
        };
        write(plain);
        const auto expected = read(plain);

        const GermanLocale locale;
        expectGermanNumbers();
        write(german);
        EXPECT_EQ(readFile(german), readFile(plain));
        expectSamplesNear(*read(plain), *expected, 0.0F);
    }
}

TEST(Locale, DoesNotShowInConversions) {
    const std::string text = "LUT_3D_SIZE 1\n+1.5 1e-1 0x1.8p0\n";  // none of them plain
    const auto expected = readBytes(".cube", text);
    const GermanLocale locale;
    expectGermanNumbers();
    expectRGB(readBytes(".cube", text)->get(0, 0, 0), 1.5F, 0.1F, 1.5F);
    expectRGB(expected->get(0, 0, 0), 1.5F, 0.1F, 1.5F);
}

TEST(Locale, DoesNotShowInPropertyTexts) {
    const GermanLocale locale;
    expectGermanNumbers();
    Orlith::Property::Int integer("i", 1);
    integer.values = {1234567};
    EXPECT_EQ(integer.toString(), "1234567");
    Orlith::Property::Double number("d", 2);
    number.values = {0.5, 12345.5};
    EXPECT_EQ(number.toString(), "0.5,12345.5");
}

}  // namespace
