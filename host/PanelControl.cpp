#include "host/PanelControl.h"

#include <fmt/format.h>

#include <algorithm>
#include <charconv>
#include <string_view>
#include <system_error>

#include "host/Error.h"
#include "host/Node.h"
#include "host/Text.h"

namespace host {
namespace {

using Kind = PanelControl::Kind;

/// The whole text as a number, if it is one of 32 bits.
bool parseInteger(std::string_view text, int& number) {
    text = trimmed(text);
    if (text.size() > 1 && text[0] == '+' && text[1] != '-') text.remove_prefix(1);
    const char* const end = text.data() + text.size();
    int parsed = 0;
    const auto result = std::from_chars(text.data(), end, parsed);
    if (result.ec != std::errc() || result.ptr != end) return false;
    number = parsed;
    return true;
}

bool parseBoolean(std::string_view text, int& number) {
    std::string word(trimmed(text));
    for (char& letter : word) {
        if (letter >= 'A' && letter <= 'Z') letter = static_cast<char>(letter - 'A' + 'a');
    }
    const bool isTrue = word == "true" || word == "1" || word == "on" || word == "yes";
    const bool isFalse = word == "false" || word == "0" || word == "off" || word == "no";
    if (isTrue || isFalse) number = isTrue ? 1 : 0;
    return isTrue || isFalse;
}

/// An entry's text, or an index.
bool parseMenu(std::string_view text, const std::vector<std::string>& items, bool mayLeaveMenu,
               int& number) {
    const auto item = std::find_if(items.begin(), items.end(), [&](const std::string& each) {
        return trimmed(each) == trimmed(text);
    });
    if (item != items.end()) {
        number = static_cast<int>(item - items.begin());
        return true;
    }
    int index = 0;
    if (!parseInteger(text, index) || index < 0) return false;
    if (!mayLeaveMenu && static_cast<std::size_t>(index) >= items.size()) return false;
    number = index;
    return true;
}

/// The entries of a menu in a row.
std::string entryList(const std::vector<std::string>& items) {
    std::string list;
    for (const std::string& item : items) {
        if (!list.empty()) list += ", ";
        list += trimmed(item).empty() ? "(blank)" : item;
    }
    return list;
}

}  // namespace

PanelControl::PanelControl(Node& node, Kind kind, const char* name, const char* label)
    : node_(node), kind_(kind), name_(name), label_(label) {}

bool PanelControl::hasValue() const {
    return kind_ == Kind::FileName || kind_ == Kind::Text || kind_ == Kind::Enumeration ||
           kind_ == Kind::Integer || kind_ == Kind::Boolean;
}

std::string PanelControl::valueText() const {
    switch (kind_) {
        case Kind::Enumeration: {
            const auto index = static_cast<std::size_t>(number_);
            return number_ >= 0 && index < items_.size() ? items_[index] : std::to_string(number_);
        }
        case Kind::Integer:
            return std::to_string(number_);
        case Kind::Boolean:
            return number_ != 0 ? "true" : "false";
        default:
            return text_;
    }
}

void PanelControl::parse(const std::string& text, bool mayLeaveMenu) {
    switch (kind_) {
        case Kind::FileName:
        case Kind::Text:
            text_ = text;
            return;
        case Kind::Enumeration:
            if (parseMenu(text, items_, mayLeaveMenu, number_)) return;
            throw Error(fmt::format("\"{}\" is not on the menu: {}", text, entryList(items_)));
        case Kind::Integer:
            if (parseInteger(text, number_)) return;
            throw Error(fmt::format("\"{}\" is not an integer", text));
        case Kind::Boolean:
            if (parseBoolean(text, number_)) return;
            throw Error(fmt::format("\"{}\" is neither true nor false", text));
        default:
            throw Error("the control has no value");
    }
}

void PanelControl::setValue(int value) {
    if (!hasValue() || kind_ == Kind::FileName || kind_ == Kind::Text) return;
    number_ = kind_ == Kind::Boolean ? (value != 0 ? 1 : 0) : value;
    node_.storeValues();
}

}  // namespace host
