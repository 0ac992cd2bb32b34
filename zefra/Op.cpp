#include "zefra/Op.h"

#include <cstdarg>
#include <cstdio>
#include <vector>

namespace zefra {

Control::~Control() = default;
ControlPass::~ControlPass() = default;
Node::~Node() = default;
Op::~Op() = default;
Executable::~Executable() = default;

void Op::knobs(ControlPass&) {}

bool Op::knob_changed(const Control&) {
    return false;
}

void Op::error(const char* format, ...) const {
    va_list arguments;
    va_start(arguments, format);
    va_list again;
    va_copy(again, arguments);
    const int length = std::vsnprintf(nullptr, 0, format, arguments);
    va_end(arguments);
    std::vector<char> text(static_cast<std::size_t>(length < 0 ? 0 : length) + 1);
    std::vsnprintf(text.data(), text.size(), format, again);
    va_end(again);
    node_.error(text.data());
}

}  // namespace zefra
