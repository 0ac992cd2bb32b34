#pragma once

#include <cstddef>
#include <functional>
#include <memory>
#include <string>
#include <utility>
#include <vector>

#include "host/PanelControl.h"
#include "zefra/Iop.h"
#include "zefra/Node.h"
#include "zefra/Op.h"
#include "zefra/Registration.h"

namespace host {

class ProgressDisplay;

/// A node: one operator, its panel and its failures.
class Node final : public zefra::Node {
public:
    using Values = std::vector<std::pair<std::string, std::string>>;
    using IsNameFree = std::function<bool(const std::string&)>;

    /// @param isNameFree  whether a saved node may call itself that
    Node(const zefra::Description& description, std::string name, IsNameFree isNameFree);
    ~Node() override;

    const std::string& name() const { return name_; }
    const char* className() const { return op_->className(); }
    zefra::Op& op() { return *op_; }
    /// The image that the node makes; null if it makes none.
    zefra::Iop* image() { return op_->asImage(); }

    /// Takes another node's image as an input. The source outlives this node's use of it.
    /// @throws Error  no such input, no image, or a loop
    void connect(int input, Node& source);

    /// In the order of the panel.
    const std::vector<std::unique_ptr<PanelControl>>& controls() const { return controls_; }
    /// The control of that name, or null.
    PanelControl* findControl(const std::string& name) const;

    /// Sets a control as a person at the panel does: the text is understood by the control's kind,
    /// stored in the operator, and the operator is told of the change. A value for an obsolete name
    /// runs that name's script, which may set a menu to an index beyond its entries.
    /// @throws Error  no such control, or a text that does not fit it
    void setValue(const std::string& name, const std::string& text);

    /// A control's value as the panel shows it: a menu's entry, or its index where there is none.
    /// @throws Error  no such control, or one without a value
    std::string value(const std::string& name) const;

    /// Takes the values of a saved node over. They are set in the order of the panel, whatever
    /// order they come in; "name" is the node's own.
    /// @throws Error  as setValue; a value without a control; a name that is taken
    void load(const Values& values);

    /// Runs the operator. Whatever fails, this node's errors say so.
    void execute();

    /// How often the operator has been run since the count was cleared.
    int executions() const { return executions_; }
    void clearExecutions() { executions_ = 0; }

    /// The failures since the last call, oldest first.
    std::vector<std::string> takeErrors();
    std::size_t errorCount() const { return errors_.size(); }
    /// What the user should know, likewise.
    std::vector<std::string> takeWarnings();

    /// Where progress is shown; null, as at first, for nowhere.
    void setProgress(ProgressDisplay* display) { progress_ = display; }

    /// Stores the panel's values in the operator.
    void storeValues();

    // What the operator asks for.
    void error(const char* text) override;
    void warning(const char* text) override;
    void progressMessage(const char* text) override;
    void progressFraction(double fraction) override;
    bool aborted() const override;
    int replaceControls(const zefra::Control& after, int count,
                        zefra::ControlPass::Declare declare) override;
    void runKnobChanged(zefra::Control& control) override;

private:
    PanelControl& control(const std::string& name) const;
    void runObsoleteScript(const PanelControl& control, const std::string& value);
    void rename(const std::string& name);
    void expectConnectedInputs() const;
    bool dependsOn(const Node& other) const;

    std::string name_;
    IsNameFree isNameFree_;
    std::unique_ptr<zefra::Op> op_;
    std::vector<std::unique_ptr<PanelControl>> controls_;
    std::vector<std::unique_ptr<PanelControl>> replacedControls_;
    std::vector<Node*> sources_;
    std::vector<std::string> errors_;
    std::vector<std::string> warnings_;
    ProgressDisplay* progress_ = nullptr;
    int executions_ = 0;
    int changeDepth_ = 0;
    int scriptDepth_ = 0;
};

}  // namespace host
