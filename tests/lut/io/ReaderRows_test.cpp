// What readers make of bytes: rows of tests/data/read, a file for each text format.

#include <gtest/gtest.h>

#include <algorithm>
#include <boost/algorithm/string.hpp>
#include <iomanip>
#include <locale>
#include <sstream>
#include <stdexcept>

#include "lut/io/Registry.h"
#include "tests/support/Files.h"
#include "tests/support/GermanLocale.h"
#include "tests/support/Tables.h"

namespace {

using namespace test;

/// Numbers, in groups.
std::string textOf(const float* numbers, std::size_t count, std::size_t group = 3) {
    std::ostringstream text;
    text.imbue(std::locale::classic());
    text << std::setprecision(9);
    for (std::size_t i = 0; i < count; ++i)
        text << (i == 0 ? "" : i % group == 0 ? ", " : " ") << numbers[i];
    return text.str();
}

std::string textOf(const char* name, const ol::Shaper& shaper) {
    if (shaper.counts == ol::RGB(0.0F, 0.0F, 0.0F)) return "";
    std::string text = name + (" of " + textOf(shaper.counts.data_block(), 3));
    for (const ol::RGB& entry : shaper.entries)
        text += ", " + textOf(entry.data_block(), 3);
    return text + "; ";
}

/// Size, transform if it is not that of 0 to 1, pre-LUT, samples up to the zeros at the end.
std::string textOf(const ol::LUT& lut) {
    const int width = lut.width();
    const int height = lut.is1D() ? width : lut.height();
    const int depth = lut.is1D() ? width : lut.depth();
    std::string text = std::to_string(width);
    if (!lut.is1D()) text += " " + std::to_string(height) + " " + std::to_string(depth);
    ol::LUT3D unit;
    ol::setUnitDomain(unit, width, height, depth);
    if (lut.transform != unit.transform) {
        text += "; transform " + textOf(lut.transform.data_block(), 16, 4);
    }
    text += "; " + textOf("input", lut.inputShaper) + textOf("output", lut.outputShaper);
    std::size_t count = lut.dataSize() / sizeof(float);
    while (count > 3 && std::all_of(lut.data() + count - 3, lut.data() + count,
                                    [](float number) { return number == 0.0F; }))
        count -= 3;
    const bool hasZeros = count < lut.dataSize() / sizeof(float);
    return text + textOf(lut.data(), count) + (hasZeros ? ", zeros" : "");
}

/// What comes of reading bytes: a message or the table, then how much was read and what was said.
std::string outcomeOf(ol::LUTFileReader& reader, const std::string& bytes) {
    const TempFolder folder;
    std::string outcome = "std::length_error";
    testing::internal::CaptureStderr();
    try {
        const std::string message =
            messageOf([&] { outcome = textOf(*reader.read(folder.write("file", bytes))); });
        if (message != "(no exception)") outcome = message;
    } catch (const std::length_error&) {
    }
    outcome += " (" + std::to_string(reader.sampleCount()) + " samples in " +
               std::to_string(reader.lineNumber()) + " lines)";
    const std::string said = testing::internal::GetCapturedStderr();
    return outcome + (said.empty() ? "" : " " + boost::trim_right_copy(said));
}

/// The fields of a row, in which \n, \r, \t, \f, \v and \\ are what they are in C++.
std::vector<std::string> fieldsOf(std::string row) {
    const std::pair<const char*, const char*> kEscapes[] = {
        {"\\\\", "\1"}, {"\\n", "\n"}, {"\\r", "\r"}, {"\\t", "\t"},
        {"\\f", "\f"},  {"\\v", "\v"}, {"\1", "\\"}};
    for (const auto& [escape, character] : kEscapes)
        boost::replace_all(row, escape, character);
    boost::replace_all(row, " | ", "\2");
    std::vector<std::string> fields;
    boost::split(fields, row, [](char c) { return c == '\2'; });
    return fields;
}

boost::shared_ptr<ol::LUTFileReader> makeReader(const std::string& format,
                                                const std::string& options) {
    std::string dialect;
    Reading3DL reading;
    std::istringstream(options) >> dialect >> reading.outputBits >> reading.normalizeOutput;
    reading.format = dialect.c_str();
    auto reader = ol::createReader("", true, "." + format);
    reading(*reader);
    return reader;
}

/// Reads what the rows of a format say, with one reader as far as its options allow.
void expectRows(const std::string& format) {
    std::istringstream rows(readFile(dataPath("read/" + format + ".txt")));
    auto reader = makeReader(format, "auto -2 0");
    std::string good;
    for (std::string row; std::getline(rows, row);) {
        if (row.front() == '#') continue;
        if (row.front() == '!') {
            reader = makeReader(format, row.substr(1));
            continue;
        }
        SCOPED_TRACE(row);
        const std::vector<std::string> fields = fieldsOf(row);
        const bool isGood = row.front() == '>';
        ASSERT_EQ(fields.size(), isGood ? 3U : 4U);
        if (isGood) {
            const bool isFile = boost::starts_with(fields[1], "@");
            good = isFile ? readFile(dataPath(fields[1].substr(1))) : fields[1];
        }
        std::string outcome =
            outcomeOf(*reader, isGood ? good : replaced(good, fields[1], fields[2]));
        // Of a long table only the beginning is given.
        if (boost::ends_with(fields.back(), "...")) {
            outcome = outcome.substr(0, fields.back().size() - 3) + "...";
        }
        EXPECT_EQ(outcome, fields.back());
    }
}

class ReadTest : public testing::TestWithParam<const char*> {};

TEST_P(ReadTest, MakesWhatItsRowsSayInEveryLocale) {
    expectRows(GetParam());
    const GermanLocale locale;
    expectRows(GetParam());
}

INSTANTIATE_TEST_SUITE_P(Formats, ReadTest,
                         testing::Values("3dl", "cms", "csp", "cub", "cube", "vf"),
                         [](const auto& format) { return std::string(format.param); });

}  // namespace
