#pragma once

#include <string>

#include "zefra/Export.h"

namespace zefra {

class Op;

/// A control on a node's panel, as its operator sees it.
class ZEFRA_EXPORT Control {
public:
    virtual ~Control();

    virtual const std::string& name() const = 0;

    /// Sets a number, a menu's index included, and stores it in the operator.
    virtual void setValue(int value) = 0;
};

/// What an operator declares its controls to. The host runs through the declarations in two kinds
/// of pass: one that builds the panel, and one that stores the panel's values in the operator.
class ZEFRA_EXPORT ControlPass {
public:
    using Declare = void (*)(Op& op, ControlPass& pass);

    virtual ~ControlPass();

    /// True while the panel is being built.
    virtual bool buildsPanel() const = 0;

    // One control each; `value` is where the operator keeps it, and its default. All return the
    // control while the panel is being built, otherwise null. Names are unique in a node.
    virtual Control* fileName(std::string* value, const char* name, const char* label) = 0;
    virtual Control* text(std::string* value, const char* name, const char* label) = 0;
    /// @param items  the menu, ended by an empty text; the value is the index
    virtual Control* enumeration(int* value, const char* const* items, const char* name,
                                 const char* label) = 0;
    virtual Control* integer(int* value, const char* name, const char* label) = 0;
    virtual Control* boolean(bool* value, const char* name, const char* label) = 0;
    /// A line to read; "@b;" makes what follows bold.
    virtual Control* textLine(const char* label, const char* text) = 0;
    /// A button that runs a script.
    virtual Control* scriptButton(const char* name, const char* label, const char* script) = 0;
    /// A name that saved nodes may still use. A value for it runs the script with $value set, or is
    /// dropped where the script is null.
    virtual Control* obsolete(const char* name, const char* script) = 0;

    // For the control declared last.
    virtual void tooltip(const char* text) = 0;
    virtual void flags(unsigned bits) = 0;

    /// While the panel is being built: adds the controls that a function declares.
    /// @return how many, as replaceControls wants it later
    virtual int addControls(Declare declare, Op& op) = 0;
};

}  // namespace zefra
