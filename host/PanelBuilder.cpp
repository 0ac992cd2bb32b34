#include "host/PanelBuilder.h"

namespace host {
namespace {

using Kind = PanelControl::Kind;

const char* orEmpty(const char* text) {
    return text != nullptr ? text : "";
}

}  // namespace

PanelControl& PanelBuilder::add(Kind kind, const char* name, const char* label) {
    controls_.push_back(std::make_unique<PanelControl>(node_, kind, orEmpty(name), orEmpty(label)));
    return *controls_.back();
}

zefra::Control* PanelBuilder::fileName(std::string* value, const char* name, const char* label) {
    PanelControl& control = add(Kind::FileName, name, label);
    if (value != nullptr) control.setText(*value);
    return &control;
}

zefra::Control* PanelBuilder::text(std::string* value, const char* name, const char* label) {
    PanelControl& control = add(Kind::Text, name, label);
    if (value != nullptr) control.setText(*value);
    return &control;
}

zefra::Control* PanelBuilder::enumeration(int* value, const char* const* items, const char* name,
                                          const char* label) {
    PanelControl& control = add(Kind::Enumeration, name, label);
    std::vector<std::string> entries;
    for (; *items != nullptr && **items != '\0'; ++items)
        entries.emplace_back(*items);
    control.setItems(std::move(entries));
    if (value != nullptr) control.setNumber(*value);
    return &control;
}

zefra::Control* PanelBuilder::integer(int* value, const char* name, const char* label) {
    PanelControl& control = add(Kind::Integer, name, label);
    if (value != nullptr) control.setNumber(*value);
    return &control;
}

zefra::Control* PanelBuilder::boolean(bool* value, const char* name, const char* label) {
    PanelControl& control = add(Kind::Boolean, name, label);
    if (value != nullptr) control.setNumber(*value ? 1 : 0);
    return &control;
}

zefra::Control* PanelBuilder::textLine(const char* label, const char* text) {
    PanelControl& control = add(Kind::TextLine, nullptr, label);
    control.setText(orEmpty(text));
    return &control;
}

zefra::Control* PanelBuilder::scriptButton(const char* name, const char* label,
                                           const char* script) {
    PanelControl& control = add(Kind::ScriptButton, name, label);
    control.setScript(orEmpty(script));
    return &control;
}

zefra::Control* PanelBuilder::obsolete(const char* name, const char* script) {
    PanelControl& control = add(Kind::Obsolete, name, nullptr);
    control.setScript(orEmpty(script));
    return &control;
}

void PanelBuilder::tooltip(const char* text) {
    if (!controls_.empty()) controls_.back()->setTooltip(orEmpty(text));
}

void PanelBuilder::flags(unsigned bits) {
    if (!controls_.empty()) controls_.back()->setFlags(bits);
}

int PanelBuilder::addControls(Declare declare, zefra::Op& op) {
    const std::size_t before = controls_.size();
    declare(op, *this);
    return static_cast<int>(controls_.size() - before);
}

}  // namespace host
