#pragma once

#include <cstddef>

namespace generatelut {

// The menus of the panel: the index is the control's value. All are ended by an empty entry.

/// Also the table of extensions.
constexpr const char* kFileTypes[] = {"   ",  ".3dl",  ".blut", ".cms", ".csp",
                                      ".cub", ".cube", ".vf",   ""};
constexpr const char* kStyles[] = {"linear", "logarithmic", ""};
constexpr const char* kInputBitDepths[] = {"4 bit", "8 bit", "10 bit", "12 bit", "16 bit", ""};
constexpr const char* kOutputBitDepths[] = {"input bit depth", "4 bit",  "8 bit", "10 bit",
                                            "12 bit",          "16 bit", ""};
constexpr const char* kFormats3DL[] = {"autodesk flame/smoke", "autodesk lustre",
                                       "assimulate scratch", ""};

constexpr int kLinearStyle = 0;
constexpr int kScratchFormat = 2;

/// The entry of a menu, or its ending empty one for an index that is not on it: a saved node or a
/// script may hold any number.
template <std::size_t kCount>
constexpr const char* menuEntry(const char* const (&menu)[kCount], int index) {
    return menu[index >= 0 && index < static_cast<int>(kCount) ? index
                                                               : static_cast<int>(kCount) - 1];
}

}  // namespace generatelut
