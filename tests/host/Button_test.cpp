#include <csignal>
#include <filesystem>

#include "tests/host/HostFixture.h"

namespace {

using test::failureOf;

/// An operator with a button whose script is that of the test, and which counts its executions.
class ButtonOp final : public zefra::Op, public zefra::Executable {
public:
    using Op::Op;
    const char* className() const override { return "Button"; }
    const char* help() const override { return ""; }
    zefra::Executable* asExecutable() override { return this; }
    void knobs(zefra::ControlPass& pass) override {
        pass.integer(&count_, "count", "count");
        pass.boolean(&isOn_, "on", "on");
        pass.fileName(&text_, "text", "text");
        pass.scriptButton("press", "press", script.c_str());
    }
    void execute() override {
        ++executions;
        if (executions == failingExecution) error("execution %d fails", executions);
    }

    static std::string script;
    static int executions;
    static int failingExecution;

private:
    int count_ = 3;
    bool isOn_ = false;
    std::string text_;
};
std::string ButtonOp::script;
int ButtonOp::executions;
int ButtonOp::failingExecution;

zefra::Op* makeButton(zefra::Node& node) {
    return new ButtonOp(node);
}

class ButtonTest : public test::HostTest {
protected:
    ButtonTest() {
        ButtonOp::executions = 0;
        ButtonOp::failingExecution = 0;
    }

    /// Presses a button with that script on a new node, and returns the failure.
    std::string press(const std::string& script) {
        ButtonOp::script = script;
        node_ = &host_.createNode("Button");
        return failureOf([&] { host_.press(*node_, "press"); });
    }

    const zefra::Description description_{"Button", "", makeButton};
    host::Node* node_ = nullptr;
};

TEST_F(ButtonTest, ReadsAndSetsControls) {
    EXPECT_EQ(press("node = zefra.toNode('this')\n"
                    "assert node.name() == 'Button1'\n"
                    "assert node['count'].value() == 3 and node['on'].value() is False\n"
                    "node['count'].setValue(node['count'].value() + 4)\n"
                    "node['on'].setValue(True)\n"
                    "node['text'].setValue('\u00e4 b')\n"
                    "assert node['text'].value() == '\u00e4 b'\n"
                    "assert zefra.toNode('Button1')['count'].value() == 7\n"
                    "assert zefra.toNode('none') is None and zefra.toNode('Button') is None\n"),
              "");
    EXPECT_EQ(node_->value("count"), "7");
    EXPECT_EQ(node_->value("on"), "true");
    EXPECT_EQ(node_->value("text"), "\u00e4 b");
}

TEST_F(ButtonTest, ExecutesRangesOfFramesAndPutsTheFrameBack) {
    host_.setFrame(12);
    EXPECT_EQ(press("node = zefra.toNode('this')\n"
                    "zefra.executeMultiple([node], ([1, 5, 2], (9, 8, -1), [3, 2, 1]))\n"
                    "assert zefra.Root()['frame'].value() == 12\n"),
              "");
    EXPECT_EQ(ButtonOp::executions, 5);
    EXPECT_EQ(press("zefra.Root()['frame'].setValue(40)"), "");
    EXPECT_EQ(host_.frame(), 40);
}

TEST_F(ButtonTest, StopsAfterAFailedFrameAndWhenCancelled) {
    const std::string script = "zefra.executeMultiple([zefra.toNode('this')], [(1, 9, 1)])";
    ButtonOp::failingExecution = 3;
    EXPECT_EQ(press(script), "");
    EXPECT_EQ(ButtonOp::executions, 3);
    EXPECT_EQ(node_->takeErrors(), std::vector<std::string>{"execution 3 fails"});

    host::Host::requestCancel();
    EXPECT_EQ(press(script), "");
    EXPECT_EQ(ButtonOp::executions, 4);
}

TEST_F(ButtonTest, TurnsPythonFailuresIntoOneLine) {
    const struct {
        const char *script, *failure;
    } kCases[] = {
        {"raise ValueError('one\\ntwo')", "ValueError: one two"},
        {"\n1 +", "SyntaxError: invalid syntax (NODE.press, line 2)"},
        {"import sys; sys.exit(3)", "SystemExit: 3"},
        {"zefra.toNode('this')['none'].value()", "RuntimeError: NODE: no control named \"none\""},
        {"zefra.toNode('this')['count'].setValue('x')",
         "RuntimeError: NODE.count: \"x\" is not an integer"},
        {"zefra.executeMultiple([], [(1, 9, 0)])",
         "RuntimeError: a range of frames has a step of 0"},
        {"zefra.executeMultiple([], [(-2147483648, 2147483647, 1)])",
         "RuntimeError: 4294967296 frames are too many"},
    };
    for (const auto& each : kCases) {
        const std::string failure = press(each.script);
        std::string expected = each.failure;
        const std::size_t node = expected.find("NODE");
        if (node != std::string::npos) expected.replace(node, 4, node_->name());
        EXPECT_EQ(failure, node_->name() + ".press: " + expected);
    }
}

TEST_F(ButtonTest, KeepsNothingOfAnotherScriptNorOfAnotherHost) {
    EXPECT_EQ(press("leftover = 1\n"
                    "zefra.kept = zefra.toNode('this')"),
              "");
    EXPECT_EQ(press("leftover"), "Button2.press: NameError: name 'leftover' is not defined");

    host::Host other;
    ButtonOp::script = "zefra.kept['count'].value()";
    host::Node& node = other.createNode("Button");
    node.load({{"name", "elsewhere"}});
    EXPECT_EQ(failureOf([&] { other.press(node, "press"); }),
              "elsewhere.press: RuntimeError: no node named \"Button1\"");
    EXPECT_EQ(press("del zefra.kept"), "");
}

TEST_F(ButtonTest, LeavesTheSignalsToTheProgram) {
    const auto before = std::signal(SIGINT, SIG_DFL);
    EXPECT_EQ(press("pass"), "");
    EXPECT_EQ(std::signal(SIGINT, before), SIG_DFL);
}

}  // namespace
