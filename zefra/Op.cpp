#include "zefra/Op.h"

#include <cstdarg>
#include <cstdio>

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
    // Long enough for any text of ours with a path in it; a longer one is cut.
    char text[8192];
    va_list arguments;
    va_start(arguments, format);
    std::vsnprintf(text, sizeof text, format, arguments);
    va_end(arguments);
    node_.error(text);
}

}  // namespace zefra
