// What is written as meant, other programs read as the table's look: here, by our own readers.

#include <gtest/gtest.h>

#include <filesystem>

#include "lut/io/Registry.h"
#include "tests/support/Files.h"
#include "tests/support/ForeignFiles.h"
#include "tests/support/ThreeDL.h"

namespace {

using namespace test;

constexpr char kNoPlace[] = "unable to write: the format has no place for the pre-LUT";
constexpr char kNoDomain[] = "unable to write: the format has no place for a domain but 0 to 1";
constexpr char kNoCurve[] = "unable to write: must be a 3D lut";
constexpr char kUnlike[] = "unable to write: must have the same dimension in r, g and b";
constexpr char kNoHeight[] = "height: not available";
constexpr char kFalls[] = "unable to write: the domain does not rise";

void writeAsMeant(const std::string& extension, const std::string& file,
                  const boost::shared_ptr<ol::LUT>& table) {
    const auto writer = ol::createWriter("", true, extension);
    setProperty<Orlith::Property::Int>(*writer, "interchange", 1);
    writer->write(file, table);
}

/// Writes a table and compares the look of the file with its own, between -0.5 and 2.5 and far off
/// on blue.
/// @return the message of a refusal, which leaves no file, or ""
std::string keepsTheLook(const std::string& extension, const boost::shared_ptr<ol::LUT>& table) {
    const TempFolder folder;
    const std::string file = folder.path("table");
    std::string refusal = messageOf([&] { writeAsMeant(extension, file, table); });
    if (refusal != "(no exception)") {
        EXPECT_FALSE(std::filesystem::exists(file));
        return refusal;
    }
    const auto reader = ol::createReader("", true, extension);
    setProperty<Orlith::Property::Int>(*reader, "interchange", 1);
    const auto read = reader->read(file);
    // A .csp file says where a table ends.
    for (const ol::Remark& remark : reader->remarks())
        EXPECT_NE(remark.text.find("leads beyond 0 to 1"), std::string::npos) << remark.text;
    for (int i = 0; i < 100; ++i) {
        const int pair = i / 2;
        const auto step = static_cast<float>(pair);
        const float far = i % 2 == 0 ? 1.0F : 60000.0F;
        const ol::RGB in(-.5F + step * .06F, 2.5F - step * .06F, step * .02F * far);
        const ol::RGB expected = evaluated(table, in);
        const ol::RGB out = evaluated(read, in);
        for (unsigned c = 0; c < 3; ++c)
            EXPECT_NEAR(out[c], expected[c], 2e-6F) << "channel " << c << " of " << in;
    }
    return "";
}

/// A table to which a change has happened.
boost::shared_ptr<ol::LUT> changed(const boost::shared_ptr<ol::LUT>& table,
                                   void (*change)(ol::LUT&)) {
    change(*table);
    return table;
}

boost::shared_ptr<ol::LUT> lattice(int height = 5, int depth = 5) {
    const auto table = markedLattice(5, height, depth, 1000.0F);
    ol::setUnitDomain(*table, 5, height, depth);
    return table;
}

void widenDomain(ol::LUT& table) {
    for (unsigned c = 0; c < 3; ++c) {
        table.transform[c][c] = .3F + .1F * static_cast<float>(c);
        table.transform[3][c] = -.1F * static_cast<float>(c);
    }
}

void setRamps(ol::LUT& table) {
    table.inputShaper = {{{0, 0, 0}, {.5F, .5F, .5F}, {1, 1, 1}}, {3, 3, 3}};
    table.outputShaper = table.inputShaper;
}

void bendOutput(ol::LUT& table) {
    table.outputShaper = {{{0, 0, 0}, {.2F, .5F, .7F}, {1, .9F, 1.1F}}, {3, 3, 3}};
}

/// Blue has a step, and ends far away.
void setInput(ol::LUT& table) {
    table.inputShaper = {{{-1, 0, 0}, {2, .75F, 0}, {9, 1, 65504}}, {2, 3, 3}};
}

void setOutput(ol::LUT& table) {
    table.outputShaper = {{{0, 1, -.25F}, {.5F, 0, .25F}, {.625F, 0, .5F}, {1, 0, 1.5F}},
                          {4, 2, 4}};
}

void setEverything(ol::LUT& table) {
    widenDomain(table);
    setInput(table);
    setOutput(table);
}

void turnGreen(ol::LUT& table) {
    table.transform[1][1] = -1.0F;
}

TEST(WrittenAsMeant, KeepsTheLookOrSaysWhyNot) {
    const struct {
        const char* name;
        boost::shared_ptr<ol::LUT> table;
        const char* cube;  // its refusal; "" where the format holds the table
        const char *blut, *cms, *cub, *vf, *csp;
    } kinds[] = {
        {"lattice", lattice(), "", "", "", "", "", ""},
        {"domain", changed(lattice(), widenDomain), "", "", kNoDomain, kNoDomain, kNoDomain, ""},
        {"falling", changed(lattice(), turnGreen), kFalls, kFalls, kFalls, kFalls, kFalls,
         "unable to write: the inputs of the table do not rise"},
        {"pre-LUT", changed(lattice(), bendOutput), kNoPlace, kNoPlace, "", "", kNoPlace, ""},
        {"pre-LUT that changes nothing", changed(lattice(), setRamps), "", "", "", "", "", ""},
        {"pre-LUT into a domain", changed(changed(lattice(), bendOutput), widenDomain), kNoPlace,
         kNoPlace, "", "", kNoPlace, ""},
        {"uneven inputs", changed(lattice(), setInput), kNoPlace, kNoPlace, kNoPlace, kNoPlace,
         kNoPlace, ""},
        {"channels of their own", changed(lattice(), setOutput), kNoPlace, kNoPlace, kNoPlace,
         kNoPlace, kNoPlace, ""},
        {"everything on unlike sides", changed(lattice(4, 2), setEverything), kUnlike, kUnlike,
         kUnlike, kNoPlace, kUnlike, ""},
        {"curve", changed(markedCurve(5), widenDomain), "", kNoHeight, kNoCurve, kNoCurve, kNoCurve,
         ""},
        {"curve with everything", changed(markedCurve(5), setEverything), kNoPlace, kNoHeight,
         kNoCurve, kNoCurve, kNoCurve, ""},
    };
    for (const auto& [name, table, cube, blut, cms, cub, vf, csp] : kinds) {
        SCOPED_TRACE(name);
        EXPECT_EQ(keepsTheLook(".cube", table), cube);
        EXPECT_EQ(keepsTheLook(".blut", table), blut);
        EXPECT_EQ(keepsTheLook(".cms", table), cms);
        EXPECT_EQ(keepsTheLook(".cub", table), cub);
        EXPECT_EQ(keepsTheLook(".vf", table), vf);
        EXPECT_EQ(keepsTheLook(".csp", table), csp);
    }
}

TEST(WrittenAsMeant, HasTheDomainBehindTheSize) {
    const auto curve = markedCurve(2);
    curve->transform[0][0] = .1F;
    curve->transform[3][1] = -1e-7F;
    const TempFolder folder;
    writeAsMeant(".cube", folder.path("table"), curve);
    EXPECT_EQ(readFile(folder.path("table")),
              "TITLE \"Generated by Orlith::LUT\"\nLUT_1D_SIZE 2\nDOMAIN_MIN 0 -0.0000001 0\n"
              "DOMAIN_MAX 0.1 0.9999999 1\n0.000000 0.100000 0.200000\n"
              "0.000100 0.100100 0.200100\n");
}

TEST(WrittenAsMeant, HasPreLUTsInUnitsOfTheLattice) {
    const auto table = lattice();
    table->outputShaper.entries = {{0, 0, 0}, {1, 1, .5F}};
    table->outputShaper.counts.fill(2.0F);
    const TempFolder folder;
    const auto linesOf = [&](const char* extension, const char* first) {
        writeAsMeant(extension, folder.path("table"), table);
        const std::string text = readFile(folder.path("table"));
        return text.substr(text.find(first), 55 + std::string(first).size());
    };
    EXPECT_EQ(linesOf(".cub", "# InputLUT\n"),
              "# InputLUT\n0.000000 0.000000 0.000000\n4.000000 4.000000 2.000000\n\n");
    EXPECT_EQ(linesOf(".cms", "LUT_3D_SIZE 5\n"),
              "LUT_3D_SIZE 5\n0.000000 0.000000 0.000000\n5.000000 5.000000 2.500000\n\n");
}

}  // namespace
