#pragma once

#include "zefra/Controls.h"
#include "zefra/Export.h"

namespace zefra {

/// The host's side of an operator: what it offers to the one operator that the node holds.
class ZEFRA_EXPORT Node {
public:
    virtual ~Node();

    /// Reports a failure of this node.
    virtual void error(const char* text) = 0;
    /// Says what the user should know although nothing has failed.
    virtual void warning(const char* text) = 0;

    // Progress of an execution.
    virtual void progressMessage(const char* text) = 0;
    virtual void progressFraction(double fraction) = 0;
    /// True once the user has cancelled.
    virtual bool aborted() const = 0;

    /// Takes away the `count` controls that stand after a control and puts those in their place
    /// that a function declares. Their values in the operator stay.
    /// @return how many were added
    virtual int replaceControls(const Control& after, int count, ControlPass::Declare declare) = 0;

    /// Runs the script hook "knobChanged" for a control, so that the panel follows a value that was
    /// set from code.
    virtual void runKnobChanged(Control& control) = 0;
};

}  // namespace zefra
