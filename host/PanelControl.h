#pragma once

#include <string>
#include <vector>

#include "zefra/Controls.h"

namespace host {

class Node;

/// A control on a node's panel: what the operator declared, and the value that the panel shows.
class PanelControl final : public zefra::Control {
public:
    enum class Kind {
        FileName,
        Text,
        Enumeration,
        Integer,
        Boolean,
        TextLine,
        ScriptButton,
        Obsolete
    };

    PanelControl(Node& node, Kind kind, const char* name, const char* label);

    Kind kind() const { return kind_; }
    /// Empty for a line of text.
    const std::string& name() const override { return name_; }
    const std::string& label() const { return label_; }
    const std::string& tooltip() const { return tooltip_; }
    unsigned flags() const { return flags_; }
    /// The entries of a menu.
    const std::vector<std::string>& items() const { return items_; }
    /// What a button runs (Python), or a value for an obsolete name (Tcl; empty for none).
    const std::string& script() const { return script_; }

    /// True for the kinds that keep a value in the operator.
    bool hasValue() const;
    /// The value of a file name or a text; the words of a line of text.
    const std::string& text() const { return text_; }
    /// An integer, a menu's index, which may lie beyond its entries, or 1 for true.
    int number() const { return number_; }

    /// The value as a person reads it: a menu's entry, or its index where there is none.
    std::string valueText() const;

    /// Takes a value over from text.
    /// @param mayLeaveMenu  an operator's own script may set an index beyond a menu's entries,
    ///                      a person may not
    /// @throws Error  and keeps the value, if the text does not fit the kind
    void parse(const std::string& text, bool mayLeaveMenu);

    /// Sets a number and stores the panel's values in the operator. Nothing for file names, texts
    /// and kinds without a value.
    void setValue(int value) override;

    // For the pass that builds the panel.
    void setText(std::string text) { text_ = std::move(text); }
    void setNumber(int number) { number_ = number; }
    void setItems(std::vector<std::string> items) { items_ = std::move(items); }
    void setScript(std::string script) { script_ = std::move(script); }
    void setTooltip(std::string text) { tooltip_ = std::move(text); }
    void setFlags(unsigned bits) { flags_ = bits; }

private:
    Node& node_;
    Kind kind_;
    std::string name_;
    std::string label_;
    std::string tooltip_;
    unsigned flags_ = 0;
    std::vector<std::string> items_;
    std::string script_;
    std::string text_;
    int number_ = 0;
};

}  // namespace host
