// The command view, but for what a browser makes of its pages.

#include "tests/orlith/Program.h"

namespace {

using ViewTest = test::ProgramTest;

constexpr char kCurve[] = "LUT_1D_SIZE 2\n0 0 0\n1 1 1\n";

TEST_F(ViewTest, NamesThePageForTheTableInTheCurrentFolder) {
    std::filesystem::create_directory(folder_.path("looks"));
    folder_.write("looks/film.look.cube", kCurve);
    const std::string out = output("view looks/film.look.cube");
    EXPECT_EQ(out.rfind("wrote film.look.html, ", 0), 0U) << out;
    test::expectIn(read("film.look.html"), "<title>film.look.cube</title>");
    EXPECT_FALSE(exists("looks/film.look.html"));
    EXPECT_EQ(run("view - --from cube --output -", kCurve).out.rfind("<!DOCTYPE html>", 0), 0U);
}

TEST_F(ViewTest, WhatCannotBeShownIsOneLine) {
    folder_.write("a.cube", kCurve);
    folder_.write(
        "one.csp",
        "CSPLUTV100\n3D\n\n2\n0 1\n0 1\n2\n0 1\n0 1\n2\n0 1\n0 1\n\n1 1 2\n0 0 0\n1 1 1\n");
    folder_.write("noise.png", "this is no picture");
    folder_.write("old.html", "old");
    const struct {
        const char *command, *about;
    } kCases[] = {
        {"view none.cube", "none.cube: No such file or directory"},
        {"view a.cube none.cube", "none.cube: No such file or directory"},
        {"view one.csp --strict", "one.csp: 1 x 1 x 2 points have no curves"},
        {"view a.cube --output missing/page.html", "missing/page.html: there is no folder missing"},
        {"view a.cube --image none.png --output old.html", "none.png: No such file or directory"},
        {"view a.cube --image noise.png --output old.html", "noise.png"},
    };
    for (const auto& each : kCases) {
        const test::Outcome outcome = run(each.command);
        EXPECT_EQ(outcome.status, 1) << each.command;
        EXPECT_EQ(outcome.out, "") << each.command;
        EXPECT_EQ(outcome.err.rfind("orlith: error: ", 0), 0U) << outcome.err;
        EXPECT_EQ(outcome.err.find('\n'), outcome.err.size() - 1) << outcome.err;
        test::expectIn(outcome.err, each.about);
    }
    EXPECT_EQ(read("old.html"), "old");
}

TEST_F(ViewTest, TablesOfEverySizeFitOnAPage) {
    std::string curve = "LUT_1D_SIZE 65536\n";
    for (int i = 0; i < 65536; ++i) {
        const std::string value = std::to_string(static_cast<double>(i) / 65535.0);
        curve.append(value).append(" ").append(value).append(" ").append(value).append("\n");
    }
    folder_.write("long.cube", curve);
    folder_.write(
        "nothing.csp",
        "CSPLUTV100\n1D\n\n2\n0 1\n0 1\n2\n0 1\n0 1\n2\n0 1\n0 1\n\n2\nnan nan nan\ninf nan 0\n");
    test::writeImage(folder_.path("wide.exr"), 3000, 5, [](int x, int) {
        return test::Pixel{static_cast<float>(x), -1.0F, 0.5F};
    });
    const struct {
        const char* command;
        std::size_t mostBytes;
    } kCases[] = {
        {"view long.cube --image wide.exr --output page.html", 4000000},
        {"view nothing.csp long.cube --strict --output page.html", 6000000},  // two exact curves
    };
    for (const auto& each : kCases) {
        output(each.command);
        const std::string page = read("page.html");
        EXPECT_LT(page.size(), each.mostBytes) << each.command;
        test::expectIn(page, "data:image/jpeg;base64,");
        test::expectIn(page, "</html>\n");
    }
}

}  // namespace
