#include "host/ValueStore.h"

#include "host/Node.h"

namespace host {

using Kind = PanelControl::Kind;

const PanelControl* ValueStore::find(const char* name, Kind kind) const {
    const PanelControl* const control = node_.findControl(name);
    return control != nullptr && control->kind() == kind ? control : nullptr;
}

zefra::Control* ValueStore::fileName(std::string* value, const char* name, const char*) {
    const PanelControl* const control = find(name, Kind::FileName);
    if (control != nullptr && value != nullptr) *value = control->text();
    return nullptr;
}

zefra::Control* ValueStore::text(std::string* value, const char* name, const char*) {
    const PanelControl* const control = find(name, Kind::Text);
    if (control != nullptr && value != nullptr) *value = control->text();
    return nullptr;
}

zefra::Control* ValueStore::enumeration(int* value, const char* const*, const char* name,
                                        const char*) {
    const PanelControl* const control = find(name, Kind::Enumeration);
    if (control != nullptr && value != nullptr) *value = control->number();
    return nullptr;
}

zefra::Control* ValueStore::integer(int* value, const char* name, const char*) {
    const PanelControl* const control = find(name, Kind::Integer);
    if (control != nullptr && value != nullptr) *value = control->number();
    return nullptr;
}

zefra::Control* ValueStore::boolean(bool* value, const char* name, const char*) {
    const PanelControl* const control = find(name, Kind::Boolean);
    if (control != nullptr && value != nullptr) *value = control->number() != 0;
    return nullptr;
}

int ValueStore::addControls(Declare declare, zefra::Op& op) {
    declare(op, *this);
    return 0;
}

}  // namespace host
