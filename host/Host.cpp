#include "host/Host.h"

#include <fmt/format.h>

#include <algorithm>
#include <cstdint>

#include "host/BuiltInOps.h"
#include "host/ButtonScript.h"
#include "host/Error.h"
#include "host/TclInterpreter.h"
#include "zefra/Registration.h"

namespace host {
namespace {

constexpr std::int64_t kMaxFrames = 100000;

std::int64_t frameCount(const FrameRange& range) {
    if (range.step == 0) throw Error("a range of frames has a step of 0");
    const std::int64_t steps = (std::int64_t{range.last} - range.first) / range.step;
    const bool isEmpty = range.step > 0 ? range.last < range.first : range.last > range.first;
    return isEmpty ? 0 : steps + 1;
}

/// Puts the current frame back.
class FrameRestorer {
public:
    explicit FrameRestorer(Host& host) : host_(host), frame_(host.frame()) {}
    FrameRestorer(const FrameRestorer&) = delete;
    FrameRestorer& operator=(const FrameRestorer&) = delete;
    ~FrameRestorer() { host_.setFrame(frame_); }

private:
    Host& host_;
    int frame_;
};

/// The values of a saved node: a list of names and values in turn.
Node::Values toValues(const std::string& className, const TclInterpreter::Words& words) {
    if (words.size() % 2 != 0) {
        throw Error(fmt::format("{}: \"{}\" has no value", className, words.back()));
    }
    Node::Values values;
    for (std::size_t i = 0; i < words.size(); i += 2)
        values.emplace_back(words[i], words[i + 1]);
    return values;
}

}  // namespace

Host::Host() : Host(bundleFolderOfProgram()) {}

Host::Host(std::string bundleFolder) : bundleFolder_(std::move(bundleFolder)) {
    registerBuiltInOps();
}

Host::~Host() = default;

void Host::loadBundle(const std::string& path) {
    bundles_.emplace_back(path);
}

void Host::loadBundles() {
    for (const std::string& path : bundlesIn(bundleFolder_))
        loadBundle(path);
}

Node& Host::createNode(const std::string& className) {
    const zefra::Description* const description = zefra::Description::find(className);
    if (description == nullptr) throw Error(fmt::format("no operator of class \"{}\"", className));
    int number = 1;
    while (!isNameFree(className + std::to_string(number)))
        ++number;
    nodes_.push_back(
        std::make_unique<Node>(*description, className + std::to_string(number),
                               [this](const std::string& name) { return isNameFree(name); }));
    return *nodes_.back();
}

bool Host::isNameFree(const std::string& name) const {
    return std::none_of(nodes_.begin(), nodes_.end(),
                        [&](const auto& each) { return each->name() == name; });
}

Node* Host::findNode(const std::string& nameOrClass) const {
    Node* ofClass = nullptr;
    int countOfClass = 0;
    for (const auto& node : nodes_) {
        if (node->name() == nameOrClass) return node.get();
        if (node->className() != nameOrClass) continue;
        ofClass = node.get();
        ++countOfClass;
    }
    return countOfClass == 1 ? ofClass : nullptr;
}

void Host::runScript(const std::string& tcl, const std::string& label) {
    TclInterpreter interpreter;
    Node* previous = nullptr;
    for (const zefra::Description* const description : zefra::Description::all()) {
        const std::string className = description->className();
        interpreter.addCommand(className, [&, className](const TclInterpreter::Words& arguments) {
            if (arguments.size() != 1) {
                throw Error(className + " takes one list of control names and values");
            }
            const Node::Values values = toValues(className, interpreter.list(arguments[0]));
            Node& node = createNode(className);
            node.load(values);
            const bool hasInput = node.image() != nullptr && node.image()->inputCount() > 0;
            if (hasInput && previous != nullptr) node.connect(0, *previous);
            previous = &node;
        });
    }
    const TclInterpreter::Outcome outcome = interpreter.run(tcl);
    if (!outcome.isGood) {
        throw Error(fmt::format("{}:{}: {}", label, outcome.line, outcome.text));
    }
}

void Host::press(Node& node, const std::string& controlName) {
    const PanelControl* const button = node.findControl(controlName);
    if (button == nullptr || button->kind() != PanelControl::Kind::ScriptButton) {
        throw Error(fmt::format("{}: no button named \"{}\"", node.name(), controlName));
    }
    runButtonScript(*this, node, *button);
}

void Host::executeMultiple(const std::vector<Node*>& nodes, const std::vector<FrameRange>& ranges) {
    std::int64_t total = 0;
    for (const FrameRange& range : ranges)
        total += frameCount(range);
    if (total > kMaxFrames) throw Error(fmt::format("{} frames are too many", total));

    const FrameRestorer restorer(*this);
    for (const FrameRange& range : ranges) {
        for (std::int64_t i = 0; i < frameCount(range); ++i) {
            setFrame(static_cast<int>(range.first + i * range.step));
            bool isGood = true;
            for (Node* const node : nodes) {
                const std::size_t before = node->errorCount();
                node->execute();
                isGood = isGood && node->errorCount() == before;
            }
            if (!isGood || cancelRequested()) return;
        }
    }
}

}  // namespace host
