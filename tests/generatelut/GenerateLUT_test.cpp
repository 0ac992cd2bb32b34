// The operator in its real bundle, on a node of the embedded host.

#include <gtest/gtest.h>

#include <array>
#include <filesystem>
#include <memory>
#include <sstream>
#include <string>
#include <vector>

#include "host/Host.h"
#include "tests/support/Files.h"
#include "zefra/Registration.h"
#include "zefra/Row.h"

namespace {

using Kind = host::PanelControl::Kind;
using Texts = std::vector<std::string>;

constexpr zefra::Channel kChannels[] = {zefra::kRed, zefra::kGreen, zefra::kBlue};

constexpr char kNoType[] =
    "Error writing LUT file. You must select the file type or set a \".type\" extension on the file"
    " name to indicate what type of file to write.";
constexpr char kNoTypeYet[] =
    "Error writing LUT file. Select a file type or set a \".type\" extension on the file name so"
    " that Zefra can determine the type of file to write.";

/// What the image of these tests covers, and what was asked of it.
struct Places {
    zefra::Box area = {0, 0, 21, 21};  // 3 x 3 patches: 2 points
    int validations = 0;
    int rows = 0;
    Texts requests;
    zefra::ChannelMask channels = 0;
};
Places places;

/// An image whose every pixel tells its place and channel.
class PlacesOp final : public zefra::Iop {
public:
    using Iop::Iop;
    const char* className() const override { return "Places"; }
    const char* help() const override { return ""; }

    static float value(zefra::Channel channel, int x, int y) {
        const zefra::Box& area = places.area;
        if (x < area.x || x >= area.r || y < area.y || y >= area.t) return 0.0F;
        const float base = channel == zefra::kRed ? 0.0F : channel == zefra::kGreen ? 0.25F : 0.5F;
        return base + static_cast<float>(x) / 128.0F + static_cast<float>(y) / 1024.0F;
    }

protected:
    void _validate(bool) override {
        ++places.validations;
        setBox(places.area);
    }
    void _request(int x, int y, int r, int t, zefra::ChannelMask channels, int count) override {
        std::ostringstream text;
        text << x << " " << y << " " << r << " " << t << " " << int(channels) << " " << count;
        places.requests.push_back(text.str());
    }
    void engine(int y, int x, int r, zefra::ChannelMask channels, zefra::Row& row) override {
        ++places.rows;
        places.channels |= channels;
        for (const zefra::Channel channel : kChannels) {
            for (int column = x; column < r && (channels & channel) != 0; ++column)
                row.writable(channel)[column - row.left()] = value(channel, column, y);
        }
    }
};

zefra::Op* makePlaces(zefra::Node& node) {
    return new PlacesOp(node);
}

class GenerateLUTTest : public ::testing::Test {
protected:
    GenerateLUTTest() {
        places = {};
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
    EXPECT_EQ(node_->op().help() + std::string("\n"),
              test::readFile(test::dataPath("panel/help.txt")));
}

/// The panel in words: a control's kind and name, then what else there is of it, a line each.
std::string panelText(const host::Node& node) {
    constexpr const char* kKinds[] = {"file name", "words", "menu",   "integer",
                                      "boolean",   "text",  "button", "obsolete"};
    std::ostringstream text;
    for (const auto& control : node.controls()) {
        text << kKinds[static_cast<int>(control->kind())] << " " << control->name() << "\n";
        const auto add = [&](const char* what, const std::string& value) {
            if (!value.empty()) text << "  " << what << ": " << value << "\n";
        };
        add("label", control->label());
        if (control->hasValue()) add("value", "\"" + control->valueText() + "\"");
        if (control->kind() == Kind::TextLine) add("words", control->text());
        for (const std::string& item : control->items())
            add("entry", item);
        if (control->flags() != 0) text << "  flags: 0x" << std::hex << control->flags() << "\n";
        add("script", control->script());
        add("tip", control->tooltip());
    }
    return text.str();
}

TEST_F(GenerateLUTTest, DeclaresItsControlsForEveryFileType) {
    for (const std::string type :
         {"   ", ".3dl", ".blut", ".cms", ".csp", ".cub", ".cube", ".vf", "   "}) {
        SCOPED_TRACE(type);
        if (node_->value("file_type") != type) node_->setValue("file_type", type);
        const std::string panel =
            test::readFile(test::dataPath(type == ".3dl" ? "panel/3dl.txt" : "panel/pre-lut.txt"));
        EXPECT_EQ(panelText(*node_), test::replaced(panel, "TYPE", type));
    }
}

TEST_F(GenerateLUTTest, FollowsTheFileName) {
    const struct {
        const char *typeBefore, *file, *typeAfter;
        bool isError;
    } kCases[] = {
        {"0", "grade.3dl", ".3dl", false},
        {"1", "a.b/grade.vf", ".vf", false},
        {"1", "grade.CUBE", "   ", false},
        {"0", "grade", "   ", true},
        {"0", "", "   ", true},
        {"0", "folder.cube/grade", "   ", true},
        {"4", "grade", ".csp", false},
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
    EXPECT_TRUE(node_->op().knob_changed(*node_->findControl("file")));
    EXPECT_FALSE(node_->op().knob_changed(*node_->findControl("lut1d")));
    const std::unique_ptr<zefra::Op> unshown(
        zefra::Description::find("GenerateLUT")->makeOp(*node_));
    EXPECT_TRUE(unshown->knob_changed(*node_->findControl("file_type"))) << "without a panel";
}

// What it does with the image.

TEST_F(GenerateLUTTest, PassesItsInputThrough) {
    places.area = {-2, 1, 40, 30};
    zefra::Iop& image = *node_->image();
    image.validate(true);
    const zefra::Box& box = image.box();
    EXPECT_EQ((std::array{box.x, box.y, box.r, box.t}), (std::array{-2, 1, 40, 30}));
    zefra::Row row(1, 12);
    row.get(image, 29, 5, 9, zefra::kRGB);
    for (const zefra::Channel channel : kChannels) {
        for (int x = 1; x < 12; ++x) {
            EXPECT_EQ(row.pixels(channel)[x - 1],
                      x >= 5 && x < 9 ? PlacesOp::value(channel, x, 29) : 0.0F);
        }
    }
    image.request(0, 1, 20, 21, zefra::kGreen, 3);
    EXPECT_EQ(places.requests, Texts{"0 1 20 21 7 3"}) << "always red, green and blue";
}

TEST_F(GenerateLUTTest, AnnouncesReadsAndWrites) {
    EXPECT_EQ(execute({"file", folder_.path("out.cube")}), Texts{});
    EXPECT_EQ(places.requests, Texts{"0 0 21 21 7 0"});
    EXPECT_EQ(places.rows, 3);
    EXPECT_EQ(places.channels, zefra::kRGB);
    EXPECT_EQ(test::readFile(folder_.path("out.cube")),
              test::readFile(test::dataPath("cube/places.cube")));
}

TEST_F(GenerateLUTTest, ReadsFromPixelZeroWhereverTheBoxStarts) {
    places.area = {-7, -7, 14, 14};
    EXPECT_EQ(execute({"file", folder_.path("out.cube")}), Texts{});
    EXPECT_EQ(start("out.cube", 47 + 27).substr(47), "0.026367 0.276367 0.526367\n");
}

TEST_F(GenerateLUTTest, HandsThe3DLControlsToTheWriter) {
    const struct {
        Texts controls;
        const char* begin;
    } kCases[] = {
        {{"file_type", ""}, "flame\n# Dimensions 2x2x2\n# Input bit depth 10\n"},
        {{"file_type", ".3dl", "bitdepth_id", "8 bit", "output_bitdepth_id", "12 bit",
          "format_3dl_id", "1"},
         "lustre\n# Dimensions 2x2x2\n# Input bit depth 8\n# Output bit depth 12\n"
         "3DMESH\nMesh 0 12\n0 255 \n108 1132 2155\n"},
        // Stored values count with the blank type too, though their controls are hidden.
        {{"file_type", "", "lut1d", "3"}, "lustre\n# Dimensions 2x2x2\n# Input bit depth 8\n"},
    };
    node_->setValue("file", folder_.path("out.3dl"));
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
        places.rows = 0;
        Texts controls = {"file", folder_.path(each.file), "file_type", each.type};
        if (each.control[0] != '\0') controls.insert(controls.end(), {each.control, each.value});
        EXPECT_EQ(execute(controls), Texts{each.message});
        EXPECT_EQ(places.rows, each.rows);
    }
    EXPECT_FALSE(std::filesystem::exists(folder_.path("out")));
    EXPECT_EQ(execute({"file", "/dev/full", "file_type", ".csp"}),
              Texts{"Error writing LUT file: not all of the file could be written"});
    node_->setValue("file", folder_.path("out"));
    node_->findControl("file_type")->setValue(8);
    EXPECT_EQ(execute({}), Texts{kNoType}) << "beyond the menu";
}

TEST_F(GenerateLUTTest, DoesNothingWithoutAFileName) {
    EXPECT_EQ(execute({"file_type", ".cube"}), Texts{});
    EXPECT_EQ(places.validations, 0);
    EXPECT_EQ(places.rows, 0);
}

TEST_F(GenerateLUTTest, SeesTheSizeOfTheImageAnewEachTime) {
    EXPECT_EQ(execute({"file", folder_.path("out.cube")}), Texts{});
    places.area = {0, 0, 42, 35};
    EXPECT_EQ(execute({}), Texts{});
    EXPECT_EQ(start("out.cube", 47).substr(33), "LUT_3D_SIZE 3\n");
    places.area = {0, 0, 7 * 100000, 7};  // 2154 points a side
    EXPECT_EQ(execute({}), Texts{"the table would be too large"});
}

}  // namespace
