#include "tests/support/ForeignFiles.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <cstddef>
#include <cstring>
#include <sstream>

#include "lut/Evaluator.h"
#include "lut/io/Registry.h"
#include "tests/support/Files.h"
#include "tests/support/ThreeDL.h"

namespace test {

Outcome::Outcome(const char* text) {
    const bool isMessage = *text != '\0' && std::strstr(text, "->") == nullptr;
    if (isMessage) message = text;
    const std::string all = isMessage ? "" : text;
    std::istringstream words(all);
    std::string between;
    for (ol::RGB in, out; words >> in[0] >> in[1] >> in[2] >> between >> out[0] >> out[1] >> out[2];
         words >> between) {
        colours.emplace_back(in, out);
    }
    // A slip in a table may not make a row that expects nothing.
    EXPECT_EQ(std::count(all.begin(), all.end(), '>'), static_cast<std::ptrdiff_t>(colours.size()))
        << text;
}

ol::RGB evaluated(const boost::shared_ptr<const ol::LUT>& table, const ol::RGB& in) {
    ol::RGB out;
    ol::Evaluator(table).apply(in.data_block(), out.data_block(), 1);
    return out;
}

std::string withReturns(std::string text) {
    for (std::size_t at = 0; (at = text.find('\n', at)) != std::string::npos; at += 2)
        text.insert(at, "\r");
    return text;
}

void expectOutcomes(const std::string& extension, const std::vector<ForeignFile>& files) {
    const TempFolder folder;
    for (const ForeignFile& file : files) {
        SCOPED_TRACE(extension + ", " + file.name);
        const auto reader = ol::createReader("", true, extension);
        Reading3DL()(*reader);
        setProperty<Orlith::Property::Int>(*reader, "interchange", file.mode);
        boost::shared_ptr<ol::LUT> table;
        const std::string path = folder.write("table", file.text);
        EXPECT_EQ(messageOf([&] { table = reader->read(path); }), file.outcome.message);
        std::string remarks;
        for (const auto& [line, text] : reader->remarks())
            remarks += (remarks.empty() ? "" : " | ") + std::to_string(line) + ": " + text;
        EXPECT_EQ(remarks, file.remarks);
        if (!table) continue;
        for (const auto& [in, expected] : file.outcome.colours) {
            const ol::RGB out = evaluated(table, in);
            for (unsigned c = 0; c < 3; ++c) {
                EXPECT_NEAR(out[c], expected[c], 1e-6F * std::max(1.0F, std::fabs(expected[c])))
                    << "channel " << c << " of " << in;
            }
        }
    }
}

}  // namespace test
