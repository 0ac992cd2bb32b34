#include "host/TclInterpreter.h"

#include <tcl.h>

#include <cstdarg>
#include <cstdio>
#include <cstdlib>
#include <exception>

#include "host/Cancel.h"
#include "host/Error.h"
#include "host/Text.h"

namespace host {
namespace {

constexpr long kMicrosecondsBetweenChecks = 100000;

Tcl_Obj* toObject(const std::string& text) {
    return Tcl_NewStringObj(text.data(), static_cast<int>(text.size()));
}

std::string toText(Tcl_Obj* object) {
    int byteCount = 0;
    const char* const bytes = Tcl_GetStringFromObj(object, &byteCount);
    return {bytes, static_cast<std::size_t>(byteCount)};
}

/// Calls a command; nothing that it throws may pass through Tcl.
int call(ClientData data, Tcl_Interp* interpreter, int count, Tcl_Obj* const words[]) {
    std::string failure;
    try {
        TclInterpreter::Words arguments;
        for (int i = 1; i < count; ++i)
            arguments.push_back(toText(words[i]));
        (*static_cast<const TclInterpreter::Command*>(data))(arguments);
        return TCL_OK;
    } catch (const std::exception& exception) {
        failure = exception.what();
    } catch (...) {
        failure = "unknown failure";
    }
    Tcl_SetObjResult(interpreter, toObject(failure));
    return TCL_ERROR;
}

/// Lets the script run until the next check.
void extendTime(Tcl_Interp* interpreter) {
    Tcl_Time end;
    Tcl_GetTime(&end);
    end.usec += kMicrosecondsBetweenChecks;
    end.sec += end.usec / 1000000;
    end.usec %= 1000000;
    Tcl_LimitSetTime(interpreter, &end);
    Tcl_LimitTypeSet(interpreter, TCL_LIMIT_TIME);
}

void extendTimeUnlessCancelled(ClientData, Tcl_Interp* interpreter) {
    if (!cancelRequested()) extendTime(interpreter);
}

/// Called by Tcl where it cannot go on: a text outgrows it, or the memory. It may neither return
/// nor throw through Tcl, so this is the end of the program, but not by a crash.
[[noreturn]] void endProgram(const char* format, ...) __attribute__((format(printf, 1, 2)));
void endProgram(const char* format, ...) {
    char text[512];
    va_list arguments;
    va_start(arguments, format);
    std::vsnprintf(text, sizeof text, format, arguments);
    va_end(arguments);
    std::fflush(stdout);
    std::fprintf(stderr, "orlith: error: the script: %s\n", oneLine(text).c_str());
    std::_Exit(EXIT_FAILURE);
}

}  // namespace

void TclInterpreter::Delete::operator()(Tcl_Interp* interpreter) const {
    Tcl_DeleteInterp(interpreter);
}

TclInterpreter::TclInterpreter() {
    static const bool isTclStarted = [] {
        Tcl_SetPanicProc(endProgram);
        Tcl_FindExecutable(nullptr);
        return true;
    }();
    static_cast<void>(isTclStarted);
    interpreter_.reset(Tcl_CreateInterp());
    if (Tcl_MakeSafe(interpreter_.get()) != TCL_OK) throw Error("Tcl cannot be made safe");
    Tcl_LimitAddHandler(interpreter_.get(), TCL_LIMIT_TIME, extendTimeUnlessCancelled, nullptr,
                        nullptr);
}

TclInterpreter::~TclInterpreter() = default;

void TclInterpreter::addCommand(const std::string& name, Command command) {
    Command& kept = commands_[name] = std::move(command);
    Tcl_CreateObjCommand(interpreter_.get(), name.c_str(), call, &kept, nullptr);
}

void TclInterpreter::setVariable(const std::string& name, const std::string& value) {
    Tcl_SetVar2Ex(interpreter_.get(), name.c_str(), nullptr, toObject(value), TCL_GLOBAL_ONLY);
}

TclInterpreter::Words TclInterpreter::list(const std::string& text) const {
    Tcl_Obj* const object = toObject(text);
    Tcl_IncrRefCount(object);
    int count = 0;
    Tcl_Obj** elements = nullptr;
    const bool isList =
        Tcl_ListObjGetElements(interpreter_.get(), object, &count, &elements) == TCL_OK;
    Words words;
    for (int i = 0; i < count; ++i)
        words.push_back(toText(elements[i]));
    Tcl_DecrRefCount(object);
    if (!isList) throw Error(oneLine(Tcl_GetStringResult(interpreter_.get())));
    return words;
}

TclInterpreter::Outcome TclInterpreter::run(const std::string& script) {
    extendTime(interpreter_.get());
    const int code = Tcl_EvalEx(interpreter_.get(), script.data(), static_cast<int>(script.size()),
                                TCL_EVAL_GLOBAL);
    if (code == TCL_OK || code == TCL_RETURN) return {true, 0, {}};
    std::string text = oneLine(Tcl_GetStringResult(interpreter_.get()));
    return {false, Tcl_GetErrorLine(interpreter_.get()),
            cancelRequested() ? "cancelled" : std::move(text)};
}

}  // namespace host
