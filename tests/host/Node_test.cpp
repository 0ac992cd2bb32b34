#include "host/Node.h"

#include <filesystem>
#include <stdexcept>

#include "host/ProgressDisplay.h"
#include "tests/host/HostFixture.h"

namespace {

using test::failureOf;
using Kind = host::PanelControl::Kind;
using NodeTest = test::HostTest;

TEST_F(NodeTest, ExchangesTheTypeControlsAndKeepsTheirValues) {
    host::Node& node = host_.createNode("GenerateLUT");
    const host::PanelControl* const type = node.findControl("file_type");
    node.setValue("lut1d", "77");
    node.setValue("file_type", ".3dl");
    EXPECT_EQ(node.findControl("lut1d")->kind(), Kind::Obsolete);
    node.setValue("lut1d", "5");  // obsolete now: dropped
    node.setValue("bitdepth_id", "16 bit");
    node.setValue("file", "grade.csp");  // the operator follows the name
    EXPECT_EQ(node.value("file_type"), ".csp");
    EXPECT_EQ(node.value("lut1d"), "77");
    node.setValue("bitdepth_id", "0");  // obsolete here
    node.setValue("file_type", "1");
    EXPECT_EQ(node.value("bitdepth_id"), "16 bit");
    EXPECT_EQ(node.findControl("file_type"), type);
    EXPECT_TRUE(node.takeErrors().empty());
}

TEST_F(NodeTest, UnderstandsTextByTheKindOfControl) {
    const struct {
        const char *control, *text, *shown;
    } kCases[] = {
        {"file_type", ".3dl", ".3dl"},    {"file_type", "   ", "   "},
        {"file_type", ".vf ", ".vf"},     {"file_type", "", "   "},
        {"file_type", "1", ".3dl"},       {"format_3dl_id", "2", "assimulate scratch"},
        {"clamp_output", "no", "false"},  {"clamp_output", "True", "true"},
        {"clamp_output", "off", "false"}, {"clamp_output", "1", "true"},
        {"file_type", "6", ".cube"},      {"lut1d", "-2147483648", "-2147483648"},
        {"lut1d", " +12 ", "12"},         {"file", " two words.cube", " two words.cube"},
    };
    host::Node& node = host_.createNode("GenerateLUT");
    for (const auto& each : kCases) {
        SCOPED_TRACE(std::string(each.control) + " " + each.text);
        node.setValue(each.control, each.text);
        EXPECT_EQ(node.value(each.control), each.shown);
    }
}

#define FORMATS ": autodesk flame/smoke, autodesk lustre, assimulate scratch"

TEST_F(NodeTest, RefusesTextThatDoesNotFit) {
    const struct {
        const char *control, *text, *failure;
    } kCases[] = {
        {"foo", "1", "GenerateLUT1: no control named \"foo\""},
        {"format_3dl_id", "-1", "GenerateLUT1.format_3dl_id: \"-1\" is not on the menu" FORMATS},
        {"format_3dl_id", "3", "GenerateLUT1.format_3dl_id: \"3\" is not on the menu" FORMATS},
        {"file_type", ".xyz",
         "GenerateLUT1.file_type: \".xyz\" is not on the menu: (blank), .3dl, .blut, .cms, .csp, "
         ".cub, .cube, .vf"},
        {"clamp_output", "maybe", "GenerateLUT1.clamp_output: \"maybe\" is neither true nor false"},
        {"generate", "1", "GenerateLUT1.generate: the control has no value"},
    };
    host::Node& node = host_.createNode("GenerateLUT");
    node.setValue("file_type", ".3dl");
    for (const auto& each : kCases)
        EXPECT_EQ(failureOf([&] { node.setValue(each.control, each.text); }), each.failure);

    node.setValue("file_type", ".vf");
    for (const std::string text : {"abc", "1.5", "12 13", "", "99999999999", "+-1", "0x10"}) {
        EXPECT_EQ(failureOf([&] { node.setValue("lut1d", text); }),
                  "GenerateLUT1.lut1d: \"" + text + "\" is not an integer");
    }
    EXPECT_EQ(node.value("lut1d"), "1024");
}

TEST_F(NodeTest, RefusesInputsThatCannotBe) {
    host::Node& read = host_.createNode("Read");
    host::Node& first = host_.createNode("GenerateLUT");
    host::Node& second = host_.createNode("GenerateLUT");
    EXPECT_EQ(failureOf([&] { read.connect(0, first); }), "Read1: there is no input 0");
    second.connect(0, first);
    EXPECT_EQ(failureOf([&] { first.connect(0, second); }),
              "GenerateLUT1: GenerateLUT2 depends on it already");
}

// Execution.

TEST_F(NodeTest, CollectsFailuresOfAnExecution) {
    using Texts = std::vector<std::string>;
    host::Node& read = host_.createNode("Read");
    read.execute();
    EXPECT_EQ(read.takeErrors(), (Texts{"Read1: there is nothing to execute"}));

    host::Node& node = host_.createNode("GenerateLUT");
    node.setValue("file", folder_.path("out.cube"));
    node.execute();
    EXPECT_EQ(node.takeErrors(), (Texts{"GenerateLUT1: input 0 is not connected"}));

    node.connect(0, read);
    read.setValue("file", folder_.path("missing.exr"));
    node.execute();
    EXPECT_EQ(node.takeErrors(),
              (Texts{folder_.path("missing.exr") + ": No such file or directory"}));
    EXPECT_TRUE(node.takeErrors().empty());
    EXPECT_FALSE(std::filesystem::exists(folder_.path("out.cube")));
}

/// An operator that fails as it is told.
class FailingOp final : public zefra::Op, public zefra::Executable {
public:
    using Op::Op;
    const char* className() const override { return "Failing"; }
    const char* help() const override { return ""; }
    zefra::Executable* asExecutable() override { return this; }
    void knobs(zefra::ControlPass& pass) override {
        pass.integer(&way_, "way", "way");
        pass.obsolete("loop", "knob loop $value");
        pass.obsolete("chain", "knob way_old [expr $value + 1]");
        pass.obsolete("way_old", "knob way $value");
        pass.obsolete("broken", "nonsense");
    }
    void execute() override {
        if (way_ == 0) throw std::length_error("vector");
        if (way_ == 1) throw std::bad_alloc();
        if (way_ == 2) throw 7;
        error("way %d", way_);
    }

private:
    int way_ = 0;
};
zefra::Op* makeFailing(zefra::Node& node) {
    return new FailingOp(node);
}

class FailingNodeTest : public ::testing::Test {
protected:
    const zefra::Description description_{"Failing", "", makeFailing};
    host::Host host_;
    host::Node& node_ = host_.createNode("Failing");
};

TEST_F(FailingNodeTest, PutsEveryExceptionIntoWords) {
    for (const char* const text :
         {"the table would be too large", "not enough memory", "unknown failure", "way 3"}) {
        node_.execute();
        EXPECT_EQ(node_.takeErrors(), std::vector<std::string>{text});
        node_.setValue("chain", node_.value("way"));  // one more
    }
}

TEST_F(FailingNodeTest, RunsScriptsOfObsoleteNames) {
    const struct {
        const char *name, *value, *failure;
    } kCases[] = {
        {"chain", "41", ""},
        {"chain", "0.5", "Failing1.chain: Failing1.way: \"1.5\" is not an integer"},
        {"loop", "1", "Failing1.loop: Failing1.loop: its script sets it again"},
        {"broken", "1", "Failing1.broken: invalid command name \"nonsense\""},
        // A value is taken into an expression, so it is able to run commands, but not these.
        {"chain", "[exec id]", "Failing1.chain: invalid command name \"exec\""},
    };
    for (const auto& each : kCases) {
        EXPECT_EQ(failureOf([&] { node_.setValue(each.name, each.value); }), each.failure);
        EXPECT_EQ(node_.value("way"), "42");
    }
}

TEST_F(NodeTest, ShowsProgressAndErasesIt) {
    const std::string path = folder_.path("terminal");
    std::FILE* const terminal = std::fopen(path.c_str(), "w");
    ASSERT_NE(terminal, nullptr);
    host::Node& node = generator();
    node.setValue("file", folder_.path("shown.cube"));
    for (const bool isTerminal : {false, true}) {
        host::ProgressDisplay display(terminal, isTerminal);
        node.setProgress(&display);
        node.execute();
        EXPECT_EQ(test::readFile(path).empty(), !isTerminal);
    }
    node.setProgress(nullptr);
    std::fclose(terminal);
    const std::string drawn = test::readFile(path);
    EXPECT_EQ(drawn.find("\r\x1b[KAnalyzing frame [                    ]   0%"), 0U);
    EXPECT_EQ(drawn.substr(drawn.size() - 4), "\r\x1b[K");
}

}  // namespace
