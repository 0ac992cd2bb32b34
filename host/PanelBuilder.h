#pragma once

#include <memory>
#include <vector>

#include "host/PanelControl.h"
#include "zefra/Controls.h"

namespace host {

/// The pass that makes a panel: a control for each declaration, with the operator's value in it.
class PanelBuilder final : public zefra::ControlPass {
public:
    using Controls = std::vector<std::unique_ptr<PanelControl>>;

    explicit PanelBuilder(Node& node) : node_(node) {}

    /// What has been declared; the pass is done.
    Controls take() { return std::move(controls_); }

    bool buildsPanel() const override { return true; }
    zefra::Control* fileName(std::string* value, const char* name, const char* label) override;
    zefra::Control* text(std::string* value, const char* name, const char* label) override;
    zefra::Control* enumeration(int* value, const char* const* items, const char* name,
                                const char* label) override;
    zefra::Control* integer(int* value, const char* name, const char* label) override;
    zefra::Control* boolean(bool* value, const char* name, const char* label) override;
    zefra::Control* textLine(const char* label, const char* text) override;
    zefra::Control* scriptButton(const char* name, const char* label, const char* script) override;
    zefra::Control* obsolete(const char* name, const char* script) override;
    void tooltip(const char* text) override;
    void flags(unsigned bits) override;
    int addControls(Declare declare, zefra::Op& op) override;

private:
    PanelControl& add(PanelControl::Kind kind, const char* name, const char* label);

    Node& node_;
    Controls controls_;
};

}  // namespace host
