#include "host/Node.h"

#include <fmt/format.h>

#include <algorithm>
#include <exception>
#include <iterator>
#include <new>
#include <stdexcept>
#include <utility>

#include "host/Cancel.h"
#include "host/Error.h"
#include "host/PanelBuilder.h"
#include "host/ProgressDisplay.h"
#include "host/TclInterpreter.h"
#include "host/ValueStore.h"

namespace host {
namespace {

using Kind = PanelControl::Kind;

/// Obsolete names may set obsolete names, but not for ever.
constexpr int kMaxScriptDepth = 8;

/// Counts how deep calls are nested.
class Depth {
public:
    explicit Depth(int& count) : count_(count) { ++count_; }
    Depth(const Depth&) = delete;
    Depth& operator=(const Depth&) = delete;
    ~Depth() { --count_; }

private:
    int& count_;
};

}  // namespace

Node::Node(const zefra::Description& description, std::string name, IsNameFree isNameFree)
    : name_(std::move(name)), isNameFree_(std::move(isNameFree)), op_(description.makeOp(*this)) {
    PanelBuilder builder(*this);
    op_->knobs(builder);
    controls_ = builder.take();
}

Node::~Node() = default;

// Inputs.

void Node::connect(int input, Node& source) {
    zefra::Iop* const target = image();
    if (target == nullptr || input < 0 || input >= target->inputCount()) {
        throw Error(fmt::format("{}: there is no input {}", name_, input));
    }
    if (source.image() == nullptr) {
        throw Error(fmt::format("{}: {} makes no image", name_, source.name_));
    }
    if (source.dependsOn(*this)) {
        throw Error(fmt::format("{}: {} depends on it already", name_, source.name_));
    }
    const auto place = static_cast<std::size_t>(input);
    if (place >= sources_.size()) sources_.resize(place + 1);
    sources_[place] = &source;
    target->setInput(input, source.image());
}

bool Node::dependsOn(const Node& other) const {
    return this == &other || std::any_of(sources_.begin(), sources_.end(), [&](const Node* each) {
               return each != nullptr && each->dependsOn(other);
           });
}

void Node::expectConnectedInputs() const {
    const zefra::Iop* const target = op_->asImage();
    const int count = target != nullptr ? target->inputCount() : 0;
    for (int input = 0; input < count; ++input) {
        if (!target->isConnected(input)) {
            throw Error(fmt::format("{}: input {} is not connected", name_, input));
        }
    }
    for (const Node* const source : sources_) {
        if (source != nullptr) source->expectConnectedInputs();
    }
}

// Controls.

PanelControl* Node::findControl(const std::string& name) const {
    const auto found = std::find_if(controls_.begin(), controls_.end(), [&](const auto& each) {
        return !name.empty() && each->name() == name;
    });
    return found == controls_.end() ? nullptr : found->get();
}

PanelControl& Node::control(const std::string& name) const {
    PanelControl* const found = findControl(name);
    if (found == nullptr) throw Error(fmt::format("{}: no control named \"{}\"", name_, name));
    return *found;
}

void Node::setValue(const std::string& name, const std::string& text) {
    if (changeDepth_ == 0) replacedControls_.clear();
    const Depth depth(changeDepth_);
    PanelControl& changed = control(name);
    if (changed.kind() == Kind::Obsolete) return runObsoleteScript(changed, text);
    try {
        changed.parse(text, scriptDepth_ > 0);
    } catch (const Error& failure) {
        throw Error(fmt::format("{}.{}: {}", name_, name, failure.what()));
    }
    runKnobChanged(changed);
}

std::string Node::value(const std::string& name) const {
    const PanelControl& found = control(name);
    if (!found.hasValue()) {
        throw Error(fmt::format("{}.{}: the control has no value", name_, name));
    }
    return found.valueText();
}

void Node::runObsoleteScript(const PanelControl& control, const std::string& value) {
    if (control.script().empty()) return;
    const std::string place = fmt::format("{}.{}: ", name_, control.name());
    if (scriptDepth_ == kMaxScriptDepth) throw Error(place + "its script sets it again");
    const Depth depth(scriptDepth_);

    TclInterpreter tcl;
    tcl.addCommand("knob", [this](const TclInterpreter::Words& arguments) {
        if (arguments.size() != 2) throw Error("knob takes a name and a value");
        setValue(arguments[0], arguments[1]);
    });
    tcl.setVariable("value", value);
    const TclInterpreter::Outcome outcome = tcl.run(control.script());
    // The place of what the user set is enough, where scripts have set further controls.
    if (!outcome.isGood) throw Error(scriptDepth_ == 1 ? place + outcome.text : outcome.text);
}

void Node::load(const Values& values) {
    for (const auto& [name, value] : values) {
        if (name == "name") rename(value);
    }
    Values pending;
    std::copy_if(values.begin(), values.end(), std::back_inserter(pending),
                 [](const auto& each) { return each.first != "name"; });

    // The first control of the panel that a value waits for, until there is none. A value can
    // exchange the controls that follow, so the panel is looked at anew each time.
    const auto next = [&] {
        for (const auto& control : controls_) {
            const auto value = std::find_if(pending.begin(), pending.end(), [&](const auto& each) {
                return !each.first.empty() && each.first == control->name();
            });
            if (value != pending.end()) return value;
        }
        return pending.end();
    };
    for (auto value = next(); value != pending.end(); value = next()) {
        const auto [name, text] = *value;
        pending.erase(value);
        setValue(name, text);
    }
    if (!pending.empty()) control(pending.front().first);  // throws: there is none
}

void Node::rename(const std::string& name) {
    if (name == name_) return;
    if (name.empty() || name == "this" || !isNameFree_(name)) {
        throw Error(fmt::format("{}: the name \"{}\" cannot be used", name_, name));
    }
    name_ = name;
}

void Node::storeValues() {
    ValueStore store(*this);
    op_->knobs(store);
}

int Node::replaceControls(const zefra::Control& after, int count,
                          zefra::ControlPass::Declare declare) {
    const auto anchor = std::find_if(controls_.begin(), controls_.end(),
                                     [&](const auto& each) { return each.get() == &after; });
    if (anchor == controls_.end()) return 0;
    const auto first = anchor + 1;
    const auto last = first + std::clamp<std::ptrdiff_t>(count, 0, controls_.end() - first);
    // The operator may be dealing with one of them at this moment.
    std::move(first, last, std::back_inserter(replacedControls_));
    const auto place = controls_.erase(first, last);

    PanelBuilder builder(*this);
    builder.addControls(declare, *op_);
    PanelBuilder::Controls added = builder.take();
    const int addedCount = static_cast<int>(added.size());
    controls_.insert(place, std::make_move_iterator(added.begin()),
                     std::make_move_iterator(added.end()));
    return addedCount;
}

void Node::runKnobChanged(zefra::Control& control) {
    storeValues();
    op_->knob_changed(control);
}

// Execution.

void Node::execute() {
    try {
        zefra::Executable* const executable = op_->asExecutable();
        if (executable == nullptr) throw Error(name_ + ": there is nothing to execute");
        expectConnectedInputs();
        ++executions_;
        executable->execute();
    } catch (const std::bad_alloc&) {
        error("not enough memory");
    } catch (const std::length_error&) {
        error("the table would be too large");
    } catch (const std::exception& exception) {
        error(exception.what());
    } catch (...) {
        error("unknown failure");
    }
    if (progress_ != nullptr) progress_->clear();
}

void Node::error(const char* text) {
    errors_.emplace_back(text);
}

std::vector<std::string> Node::takeErrors() {
    return std::exchange(errors_, {});
}

void Node::warning(const char* text) {
    warnings_.emplace_back(text);
}

std::vector<std::string> Node::takeWarnings() {
    return std::exchange(warnings_, {});
}

void Node::progressMessage(const char* text) {
    if (progress_ != nullptr) progress_->message(text);
}

void Node::progressFraction(double fraction) {
    if (progress_ != nullptr) progress_->fraction(fraction);
}

bool Node::aborted() const {
    return cancelRequested();
}

}  // namespace host
