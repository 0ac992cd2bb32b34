#pragma once

#include "zefra/Controls.h"
#include "zefra/Export.h"
#include "zefra/Node.h"

namespace zefra {

class Executable;
class Iop;

/// An operator: controls, and services of the node that holds it. The host calls it on one thread.
class ZEFRA_EXPORT Op {
public:
    /// @param node  holds the operator and outlives it
    explicit Op(Node& node) : node_(node) {}
    Op(const Op&) = delete;
    Op& operator=(const Op&) = delete;
    virtual ~Op();

    virtual const char* className() const = 0;
    virtual const char* help() const = 0;

    /// Declares the controls, in the order of the panel.
    virtual void knobs(ControlPass& pass);

    /// A control's value was changed by the user or a script; it is stored already.
    /// @return whether the operator has dealt with it
    virtual bool knob_changed(const Control& control);

    // The roles that an operator may have; null where it has not.
    virtual Iop* asImage() { return nullptr; }
    virtual Executable* asExecutable() { return nullptr; }

protected:
    Node& node() const { return node_; }

    /// Reports a failure of this node, with a text as for printf.
    void error(const char* format, ...) const __attribute__((format(printf, 2, 3)));
    void progressMessage(const char* text) const { node_.progressMessage(text); }
    void progressFraction(double fraction) const { node_.progressFraction(fraction); }
    bool aborted() const { return node_.aborted(); }

private:
    Node& node_;
};

/// The mix-in of operators that do something when they are executed.
class ZEFRA_EXPORT Executable {
public:
    virtual ~Executable();

    /// Does the work for the frame that the host has set.
    virtual void execute() = 0;
};

}  // namespace zefra
