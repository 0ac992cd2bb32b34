// The operator in its real bundle, on a node of the embedded host.

#include <gtest/gtest.h>

#include <array>
#include <filesystem>
#include <memory>
#include <string>
#include <vector>

#include "host/Host.h"
#include "tests/support/Files.h"
#include "zefra/Registration.h"
#include "zefra/Row.h"

namespace {

using Kind = host::PanelControl::Kind;
using Texts = std::vector<std::string>;

constexpr char kNoType[] =
    "Error writing LUT file. You must select the file type or set a \".type\" extension on the file"
    " name to indicate what type of file to write.";
constexpr char kNoTypeYet[] =
    "Error writing LUT file. Select a file type or set a \".type\" extension on the file name so"
    " that Zefra can determine the type of file to write.";

/// An image whose every pixel tells its place and channel, and which keeps count of its calls.
class PlacesOp final : public zefra::Iop {
public:
    using Iop::Iop;
    const char* className() const override { return "Places"; }
    const char* help() const override { return ""; }

    static float value(zefra::Channel channel, int x, int y) {
        const bool isInside = x >= area.x && x < area.r && y >= area.y && y < area.t;
        if (!isInside) return 0.0F;
        const float base = channel == zefra::kRed ? 0.0F : channel == zefra::kGreen ? 0.25F : 0.5F;
        return base + static_cast<float>(x) / 128.0F + static_cast<float>(y) / 1024.0F;
    }

    static zefra::Box area;
    static int validations;
    static Texts requests;
    static int rows;
    static zefra::ChannelMask channelsAskedFor;

protected:
    void _validate(bool) override {
        ++validations;
        setBox(area);
    }
    void _request(int x, int y, int r, int t, zefra::ChannelMask channels, int count) override {
        std::string text;
        for (const int number : {x, y, r, t, static_cast<int>(channels), count})
            text += std::to_string(number) + " ";
        requests.push_back(text);
    }
    void engine(int y, int x, int r, zefra::ChannelMask channels, zefra::Row& row) override {
        ++rows;
        channelsAskedFor |= channels;
        for (const zefra::Channel channel : {zefra::kRed, zefra::kGreen, zefra::kBlue}) {
            for (int column = x; column < r && (channels & channel) != 0; ++column)
                row.writable(channel)[column - row.left()] = value(channel, column, y);
        }
    }
};
zefra::Box PlacesOp::area;
int PlacesOp::validations;
Texts PlacesOp::requests;
int PlacesOp::rows;
zefra::ChannelMask PlacesOp::channelsAskedFor;

zefra::Op* makePlaces(zefra::Node& node) {
    return new PlacesOp(node);
}

class GenerateLUTTest : public ::testing::Test {
protected:
    GenerateLUTTest() {
        PlacesOp::area = {0, 0, 21, 21};  // 3 x 3 patches: 2 points
        PlacesOp::validations = PlacesOp::rows = 0;
        PlacesOp::requests.clear();
        PlacesOp::channelsAskedFor = 0;
        host_.loadBundle(ORLITH_TEST_BUNDLE);
        node_ = &host_.createNode("GenerateLUT");
        node_->connect(0, host_.createNode("Places"));
    }

    /// Sets controls, a name and a value in turn, executes, and returns what the operator says.
    Texts execute(const Texts& controls) {
        for (std::size_t i = 0; i < controls.size(); i += 2)
            node_->setValue(controls[i], controls[i + 1]);
        node_->takeErrors();
        node_->execute();
        return node_->takeErrors();
    }

    bool exists(const std::string& name) const {
        return std::filesystem::exists(folder_.path(name));
    }
    std::string start(const std::string& name, std::size_t byteCount) const {
        return test::readFile(folder_.path(name)).substr(0, byteCount);
    }

    const zefra::Description description_{"Places", "", makePlaces};
    test::TempFolder folder_;
    host::Host host_;
    host::Node* node_ = nullptr;
};

// What the panel shows.

TEST_F(GenerateLUTTest, IsRegisteredWithItsHelp) {
    const zefra::Description* const description = zefra::Description::find("GenerateLUT");
    ASSERT_NE(description, nullptr);
    const std::string stamp = description->buildStamp();
    EXPECT_NE(stamp.find(", for Zefra 1.0"), std::string::npos) << stamp;
    EXPECT_STREQ(node_->className(), "GenerateLUT");
    EXPECT_STREQ(
        node_->op().help(),
        "Generate Color Management Lookup Tables.<p>Input must be the output of a CMSTestPattern "
        "operator, passed through a sequence of operators that produce the desired color "
        "correction.</p><p>The size of the 3D LUT is controlled by the Test Pattern generator "
        "node, not this one. This node looks at the size of the image it gets and figures out the "
        "size of LUT to be generated.</p>The following extensions/file formats are "
        "recognized:<ul> <li>.3dl  : Autodesk/Scratch format</li> <li>.blut : Houdini mplay blut "
        "format</li> <li>.cms  : CMS file format (includes the 1D LUT).</li> <li>.csp  : CineSpace "
        "format</li> <li>.cub  : Truelight LUT format</li> <li>.cube : Iridas LUT format</li> "
        "<li>.vf   : Zefra's Vectorfield operator</li> </ul>");
}

struct Declaration {
    Kind kind;
    const char *name, *label, *value = nullptr;
    std::string tooltip = {};
    Texts items = {};
    unsigned flags = 0;
    const char* script = "";
};

/// The panel for a file type.
std::vector<Declaration> panelOf(const std::string& type) {
    // clang-format off
    const Texts types = {"   ", ".3dl", ".blut", ".cms", ".csp", ".cub", ".cube", ".vf"};
    std::vector<Declaration> panel = {
        {Kind::FileName, "file", "output file", "",
         "LUT data will be written into this file. The following filename extensions are recognized:<ul> <li>.3dl  : Autodesk/Scratch format</li> <li>.blut : Houdini mplay blut format</li> <li>.cms  : CMS file format (includes the 1D LUT).</li> <li>.csp  : CineSpace format</li> <li>.cub  : Truelight LUT format</li> <li>.cube : Iridas LUT format</li> <li>.vf   : Zefra's Vectorfield operator</li> </ul>"},
        {Kind::Obsolete, "output_file", "", nullptr, "", {}, 0, "knob file $value"},
        {Kind::Enumeration, "file_type", "file type", type.c_str(),
         "If the file type is blank, the format will be guessed from the filename, but you will not be able to set any type-specific controls.",
         types, 0x88010000}};
    const std::vector<Declaration> controls = type == ".3dl" ? std::vector<Declaration>{
        {Kind::Obsolete, "lut1d", ""},
        {Kind::Obsolete, "style1d", ""},
        {Kind::TextLine, "", "@b;3D LUT"},
        {Kind::Enumeration, "bitdepth_id", "input bit depth (.3dl)", "10 bit",
         "The bit depth to scale input values to for .3dl files. For instance, a 10 bit file will have values between 0 and 1023.",
         {"4 bit", "8 bit", "10 bit", "12 bit", "16 bit"}},
        {Kind::Enumeration, "output_bitdepth_id", "output bit depth (.3dl)", "input bit depth",
         "The bit depth to scale output values to for .3dl files. For instance, a 10 bit file will have values between 0 and 1023.  In general this should match the input bit depth.",
         {"input bit depth", "4 bit", "8 bit", "10 bit", "12 bit", "16 bit"}},
        {Kind::Boolean, "clamp_output", "clamp output", "true",
         "Clamp 3dl output values to the range 0-1. Turning this off allows superwhite values to be represented which are allowed in some packages (e.g. Zefra). This may make the resulting file unreadable by other packages.",
         {}, 0x100},
        {Kind::Enumeration, "format_3dl_id", "3dl file format", "autodesk flame/smoke",
         "There are several different specifications for integer 3dl files. Autodesk Flame, Smoke and Lustre prefer cube sizes of 17x17, 33x33 and 65x65. Autodesk Lustre outputs 3DMESH/Mesh header. ASSIMULATE SCRATCH scales and offsets the 3D LUT.",
         {"autodesk flame/smoke", "autodesk lustre", "assimulate scratch"}},
        {Kind::Obsolete, "scratch_compatible", "", nullptr, "", {}, 0,
         "knob format_3dl_id [expr $value == \"false\" ? 1 : 3]"}}
    : std::vector<Declaration>{
        {Kind::TextLine, "", "@b;1D preLUT"},
        {Kind::Integer, "lut1d", "1D preLUT size", "1024",
         "This is the size of the 1D lookup table. The default value is 1024."},
        {Kind::Enumeration, "style1d", "", "logarithmic",
         "Some systems assume the LUT is designed to apply to log images, others linear. Some LUT formats are assumed to encode values as either log or linear. Use this setting to get your output LUT values encoded the way your use of the LUT requires.",
         {"linear", "logarithmic"}},
        {Kind::Obsolete, "bitdepth_id", ""},
        {Kind::Obsolete, "scratch_compatible", ""}};
    // clang-format on
    panel.insert(panel.end(), controls.begin(), controls.end());
    panel.push_back({Kind::TextLine, "", " "});
    panel.push_back({Kind::ScriptButton, "generate", "Generate and Write LUT File", nullptr, "",
                     Texts(), 0,
                     "frame = int(zefra.Root()['frame'].value())\n"
                     "zefra.executeMultiple([zefra.toNode(\"this\")], ([frame, frame, 1],))\n"
                     "del frame"});
    return panel;
}

void expectPanel(const host::Node& node, const std::vector<Declaration>& declarations) {
    ASSERT_EQ(node.controls().size(), declarations.size());
    for (std::size_t i = 0; i < declarations.size(); ++i) {
        const host::PanelControl& control = *node.controls()[i];
        const Declaration& expected = declarations[i];
        SCOPED_TRACE(std::to_string(i) + " " + expected.name);
        EXPECT_EQ(control.kind(), expected.kind);
        EXPECT_EQ(control.name(), expected.name);
        EXPECT_EQ(control.label(), expected.label);
        EXPECT_EQ(control.flags(), expected.flags);
        EXPECT_EQ(control.script(), expected.script);
        EXPECT_EQ(control.items(), expected.items);
        EXPECT_EQ(control.tooltip(), expected.tooltip);
        EXPECT_EQ(control.hasValue(), expected.value != nullptr);
        if (expected.value != nullptr) {
            EXPECT_EQ(control.valueText(), expected.value);
        }
        if (control.kind() == Kind::TextLine) {
            EXPECT_EQ(control.text(), "");
        }
    }
}

TEST_F(GenerateLUTTest, DeclaresItsControlsForEveryFileType) {
    expectPanel(*node_, panelOf("   "));
    for (const std::string type :
         {".3dl", ".blut", ".cms", ".csp", ".cub", ".cube", ".vf", "   "}) {
        SCOPED_TRACE(type);
        node_->setValue("file_type", type);
        expectPanel(*node_, panelOf(type));
    }
}

TEST_F(GenerateLUTTest, FollowsTheFileName) {
    const struct {
        const char *typeBefore, *file, *typeAfter;
        bool isError;
    } kCases[] = {
        {"0", "grade.3dl", ".3dl", false},
        {"0", "grade.cube", ".cube", false},
        {"1", "a.b/grade.vf", ".vf", false},
        {"1", "grade.CUBE", "   ", false},
        {"1", "grade.txt", "   ", false},
        {"1", "grade.", "   ", false},
        {"0", "grade", "   ", true},
        {"0", "", "   ", true},
        {"0", "folder.cube/grade", "   ", true},
        {"0", "folder.cube:grade", "   ", true},
        {"4", "grade", ".csp", false},
        {"4", "", ".csp", false},
    };
    for (const auto& each : kCases) {
        SCOPED_TRACE(std::string(each.file) + " after " + each.typeBefore);
        node_->setValue("file_type", each.typeBefore);
        node_->setValue("file", each.file);
        EXPECT_EQ(node_->value("file_type"), each.typeAfter);
        EXPECT_EQ(node_->value("file"), each.file);
        EXPECT_EQ(node_->takeErrors(), each.isError ? Texts{kNoTypeYet} : Texts{});
        const bool shows3DL = node_->findControl("clamp_output") != nullptr;
        EXPECT_EQ(shows3DL, node_->value("file_type") == ".3dl") << "the panel follows";
    }
    for (const char* const name : {"file", "file_type"})
        EXPECT_TRUE(node_->op().knob_changed(*node_->findControl(name))) << name;
    for (const char* const name : {"lut1d", "style1d", "generate"})
        EXPECT_FALSE(node_->op().knob_changed(*node_->findControl(name))) << name;
    const std::unique_ptr<zefra::Op> unshown(
        zefra::Description::find("GenerateLUT")->makeOp(*node_));
    EXPECT_TRUE(unshown->knob_changed(*node_->findControl("file_type"))) << "without a panel";
}

// What it does with the image.

TEST_F(GenerateLUTTest, PassesItsInputThrough) {
    PlacesOp::area = {-2, 1, 40, 30};
    zefra::Iop& image = *node_->image();
    image.validate(true);
    EXPECT_EQ(image.box().x, -2);
    EXPECT_EQ(image.box().y, 1);
    EXPECT_EQ(image.box().r, 40);
    EXPECT_EQ(image.box().t, 30);
    for (const auto& [y, x, r] : {std::array<int, 3>{1, -2, 40}, {29, 5, 9}, {12, -4, 41}}) {
        zefra::Row row(x - 3, r + 2);
        row.get(image, y, x, r, zefra::kRGB);
        for (const zefra::Channel channel : {zefra::kRed, zefra::kGreen, zefra::kBlue}) {
            for (int column = x; column < r; ++column) {
                EXPECT_EQ(row.pixels(channel)[column - row.left()],
                          PlacesOp::value(channel, column, y));
            }
            EXPECT_EQ(row.pixels(channel)[0], 0.0F) << "outside what was asked for";
        }
    }
    image.request(0, 1, 20, 21, zefra::kGreen, 3);
    EXPECT_EQ(PlacesOp::requests, Texts{"0 1 20 21 7 3 "}) << "always red, green and blue";
}

constexpr char kCube[] =
    "TITLE \"Generated by Orlith::LUT\"\n"
    "LUT_3D_SIZE 2\n"
    "0.026367 0.276367 0.526367\n"  // 3/128 + 3/1024, and so on
    "0.081055 0.331055 0.581055\n"
    "0.135742 0.385742 0.635742\n"
    "0.033203 0.283203 0.533203\n"
    "0.087891 0.337891 0.587891\n"
    "0.142578 0.392578 0.642578\n"
    "0.040039 0.290039 0.540039\n"
    "0.094727 0.344727 0.594727\n";

TEST_F(GenerateLUTTest, AnnouncesReadsAndWrites) {
    EXPECT_EQ(execute({"file", folder_.path("out.cube")}), Texts{});
    EXPECT_EQ(PlacesOp::requests, Texts{"0 0 21 21 7 0 "});
    EXPECT_EQ(PlacesOp::rows, 3);
    EXPECT_EQ(PlacesOp::channelsAskedFor, zefra::kRGB);
    EXPECT_EQ(test::readFile(folder_.path("out.cube")), kCube);
}

TEST_F(GenerateLUTTest, ReadsFromPixelZeroWhereverTheBoxStarts) {
    PlacesOp::area = {-7, -7, 14, 14};
    EXPECT_EQ(execute({"file", folder_.path("out.cube")}), Texts{});
    EXPECT_EQ(start("out.cube", 47 + 3 * 27 + 8).substr(47),
              "0.026367 0.276367 0.526367\n"
              "0.081055 0.331055 0.581055\n"
              "0.000000 0.000000 0.000000\n"
              "0.033203");
}

TEST_F(GenerateLUTTest, ChoosesTheWriterByTypeAndElseByName) {
    const struct {
        const char *file, *type, *begin;
    } kCases[] = {
        {"out", ".cube", "TITLE \"Gener"},     {"out.b/../out", ".csp", "CSPLUTV100\n3"},
        {"out.cube", ".csp", "CSPLUTV100\n3"}, {"out.3dl", ".cube", "TITLE \"Gener"},
        {"out.vf", "", "#Inventor V2"},        {"out.vfz", "", "#Inventor V2"},
        {"out.blut", ".blut", "HLUT"},         {"out.cub", ".cub", "# Truelight "},
        {"out.cms", ".cms", "NUCODA_3D_CU"},
    };
    std::filesystem::create_directory(folder_.path("out.b"));
    for (const auto& each : kCases) {
        SCOPED_TRACE(std::string(each.file) + " as " + each.type);
        EXPECT_EQ(execute({"file", folder_.path(each.file), "file_type", each.type}), Texts{});
        EXPECT_EQ(start(each.file, std::string(each.begin).size()), each.begin);
        std::filesystem::remove(folder_.path(each.file));
    }
}

TEST_F(GenerateLUTTest, HandsThe3DLControlsToTheWriter) {
    const struct {
        Texts controls;
        const char* begin;
    } kCases[] = {
        {{"file_type", ""},
         "flame\n# Dimensions 2x2x2\n# Input bit depth 10\n"
         "# Output bit depth 10\n0 1023 \n27 283 538\n"},
        {{"file_type", ".3dl", "bitdepth_id", "8 bit", "output_bitdepth_id", "12 bit",
          "format_3dl_id", "1"},
         "lustre\n# Dimensions 2x2x2\n# Input bit depth 8\n# Output bit depth 12\n"
         "3DMESH\nMesh 0 12\n0 255 \n108 1132 2155\n"},
        // Stored values count with the blank type too, though their controls are hidden.
        {{"file_type", "", "lut1d", "3"},
         "lustre\n# Dimensions 2x2x2\n# Input bit depth 8\n# Output bit depth 12\n"},
        {{"file_type", ".3dl", "bitdepth_id", "2", "output_bitdepth_id", "0", "format_3dl_id", "2"},
         "scratch\n# Dimensions 2x2x2\n# Input bit depth 10\n# Output bit depth 10\n0 1023 \n"
         "41 292 543\n"},
    };
    const std::string file = folder_.path("out.3dl");
    node_->setValue("file", file);
    for (const auto& each : kCases) {
        EXPECT_EQ(execute(each.controls), Texts{});
        const std::string expected =
            std::string("# Generated by OL_PRODUCT_NAME for ") + each.begin;
        EXPECT_EQ(start("out.3dl", expected.size()), expected);
    }
}

TEST_F(GenerateLUTTest, SaysWhatFailed) {
    const struct {
        const char *file, *type, *control, *value, *message;
        int rows;  // read before that
    } kCases[] = {
        {"out", "", "", "", kNoType, 0},
        {"out.icc", "", "", "", kNoType, 0},
        {"out.CUBE", "", "", "", kNoType, 0},
        {"out.cms", ".cms", "lut1d", "0",
         "Error writing LUT file: unable to write: expecting pre-LUT data", 3},
        {"none/out.cube", ".cube", "", "",
         "Error writing LUT file: unable to open file for writing", 3},
        {"out.3dl", ".3dl", "scratch_compatible", "true",
         "Error writing LUT file: 3DL file reader: invalid 3DL format specified for writing", 3},
    };
    for (const auto& each : kCases) {
        SCOPED_TRACE(std::string(each.file) + " as " + each.type);
        PlacesOp::rows = 0;
        Texts controls = {"file", folder_.path(each.file), "file_type", each.type};
        if (each.control[0] != '\0') controls.insert(controls.end(), {each.control, each.value});
        EXPECT_EQ(execute(controls), Texts{each.message});
        EXPECT_EQ(PlacesOp::rows, each.rows);
    }
    EXPECT_FALSE(exists("out") || exists("out.icc") || exists("out.cube"));
    EXPECT_EQ(execute({"file", "/dev/full", "file_type", ".csp"}),
              Texts{"Error writing LUT file: not all of the file could be written"});
    node_->setValue("file", folder_.path("out"));
    node_->findControl("file_type")->setValue(8);
    EXPECT_EQ(execute({}), Texts{kNoType}) << "beyond the menu";
}

TEST_F(GenerateLUTTest, DoesNothingWithoutAFileName) {
    EXPECT_EQ(execute({"file_type", ".cube"}), Texts{});
    EXPECT_EQ(PlacesOp::validations, 0);
    EXPECT_EQ(PlacesOp::requests, Texts{});
    EXPECT_EQ(PlacesOp::rows, 0);
}

TEST_F(GenerateLUTTest, LeavesATableThatCannotBeToTheHost) {
    PlacesOp::area = {0, 0, 7 * 100000, 7};  // 2154 points a side
    EXPECT_EQ(execute({"file", folder_.path("out.cube")}), Texts{"the table would be too large"});
    EXPECT_FALSE(exists("out.cube"));
}

TEST_F(GenerateLUTTest, SeesTheSizeOfTheImageAnewEachTime) {
    EXPECT_EQ(execute({"file", folder_.path("out.cube")}), Texts{});
    PlacesOp::area = {0, 0, 42, 35};
    EXPECT_EQ(execute({}), Texts{});
    EXPECT_EQ(start("out.cube", 47).substr(33), "LUT_3D_SIZE 3\n");
    PlacesOp::area = {0, 0, 6, 6};
    EXPECT_EQ(execute({}), Texts{}) << "too small for a cube is no failure of the operator";
}

}  // namespace
