#pragma once

#include "host/PanelControl.h"
#include "zefra/Controls.h"

namespace host {

class Node;

/// The pass that stores the panel's values in the operator. What the operator declares and the
/// panel does not show keeps its value.
class ValueStore final : public zefra::ControlPass {
public:
    explicit ValueStore(const Node& node) : node_(node) {}

    bool buildsPanel() const override { return false; }
    zefra::Control* fileName(std::string* value, const char* name, const char* label) override;
    zefra::Control* text(std::string* value, const char* name, const char* label) override;
    zefra::Control* enumeration(int* value, const char* const* items, const char* name,
                                const char* label) override;
    zefra::Control* integer(int* value, const char* name, const char* label) override;
    zefra::Control* boolean(bool* value, const char* name, const char* label) override;
    zefra::Control* textLine(const char*, const char*) override { return nullptr; }
    zefra::Control* scriptButton(const char*, const char*, const char*) override { return nullptr; }
    zefra::Control* obsolete(const char*, const char*) override { return nullptr; }
    void tooltip(const char*) override {}
    void flags(unsigned) override {}
    /// Stores what the function declares; adds nothing.
    int addControls(Declare declare, zefra::Op& op) override;

private:
    /// The panel's control of that name, if it is of that kind: a name may stand for an obsolete
    /// control now and for one with a value in the group that is about to replace it.
    const PanelControl* find(const char* name, PanelControl::Kind kind) const;

    const Node& node_;
};

}  // namespace host
