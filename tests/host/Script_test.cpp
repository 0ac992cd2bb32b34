#include "tests/host/HostFixture.h"

namespace {

using test::failureOf;
using ScriptTest = test::HostTest;

TEST_F(ScriptTest, SetsValuesInTheOrderOfThePanel) {
    const struct {
        const char *values, *control, *shown;
    } kCases[] = {
        {"format_3dl_id 2 clamp_output false file_type .3dl", "format_3dl_id",
         "assimulate scratch"},
        {"file_type .3dl scratch_compatible false", "format_3dl_id", "autodesk lustre"},
        {"scratch_compatible false file_type .3dl", "format_3dl_id", "autodesk lustre"},
        {"scratch_compatible true file_type .3dl", "format_3dl_id", "3"},
        {"scratch_compatible false", "lut1d", "1024"},
        {"output_file x.cube", "file_type", ".cube"},
        {"output_file {my grade.vf}", "file", "my grade.vf"},
        {"file_type .csp file x.cube", "file_type", ".csp"},
        {"file_type {   } file x.cube", "file_type", "   "},
        {"lut1d 7 lut1d 8", "lut1d", "8"},
    };
    for (const auto& each : kCases) {
        SCOPED_TRACE(each.values);
        host::Host host;
        host.runScript(std::string("GenerateLUT {") + each.values + "}", "saved.tcl");
        EXPECT_EQ(host.nodes()[0]->value(each.control), each.shown);
    }
}

TEST_F(ScriptTest, NamesThePlaceOfAFailure) {
    const struct {
        const char *script, *failure;
    } kCases[] = {
        {"\n\nGenerateLUT {lut1d abc}", "s.tcl:3: GenerateLUT1.lut1d: \"abc\" is not an integer"},
        {"\nGenerateLUT {\n file\n}", "s.tcl:2: GenerateLUT: \"file\" has no value"},
        {"GenerateLUT file x", "s.tcl:1: GenerateLUT takes one list of control names and values"},
        {"GenerateLUT {file \"a\"b}",
         "s.tcl:1: list element in quotes followed by \"b\" instead of space"},
        {"\nGrade {}", "s.tcl:2: invalid command name \"Grade\""},
        {"GenerateLUT {", "s.tcl:1: missing close-brace"},
        {"GenerateLUT {name a}\nGenerateLUT {name a}",
         "s.tcl:2: GenerateLUT1: the name \"a\" cannot be used"},
        {"exec touch x", "s.tcl:1: invalid command name \"exec\""},
        {"puts x", "s.tcl:1: can not find channel named \"stdout\""},
    };
    for (const auto& each : kCases) {
        host::Host host;
        EXPECT_EQ(failureOf([&] { host.runScript(each.script, "s.tcl"); }), each.failure);
    }
    EXPECT_EQ(failureOf([&] { host_.createNode("Grade"); }), "no operator of class \"Grade\"");
}

TEST_F(ScriptTest, IsTclWithItsVariablesAndLoops) {
    host_.runScript("foreach n {2 3 5} { CMSTestPattern \"size $n\" }", "s.tcl");
    ASSERT_EQ(host_.nodes().size(), 3U);
    EXPECT_EQ(host_.nodes()[2]->value("size"), "5");
    EXPECT_EQ(host_.findNode("CMSTestPattern2")->value("size"), "3");
    EXPECT_EQ(host_.findNode("CMSTestPattern"), nullptr) << "there are three";
    host_.runScript("Read {name image}", "s.tcl");
    EXPECT_EQ(host_.findNode("Read"), host_.nodes()[3].get());
    EXPECT_EQ(host_.findNode("image"), host_.nodes()[3].get());
}

TEST_F(ScriptTest, SaysWhichBundleCannotBeLoaded) {
    const std::string broken = folder_.write("broken.so", "no bundle");
    EXPECT_NE(failureOf([&] { host_.loadBundle(broken); }).find(broken), std::string::npos);
    host::Host noFolder(folder_.path("none"));
    EXPECT_EQ(failureOf([&] { noFolder.loadBundles(); }),
              folder_.path("none") + ": No such file or directory");
}

}  // namespace
