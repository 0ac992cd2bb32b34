#pragma once

#include <functional>
#include <map>
#include <memory>
#include <string>
#include <vector>

struct Tcl_Interp;

namespace host {

/// A Tcl interpreter for scripts that come from others: a safe one, without files, processes,
/// sockets or standard output, in which cancelling ends a script that does not end by itself.
class TclInterpreter {
public:
    using Words = std::vector<std::string>;
    /// @param arguments  the words after the command's name; what it throws fails the script
    using Command = std::function<void(const Words& arguments)>;

    TclInterpreter();
    TclInterpreter(const TclInterpreter&) = delete;
    TclInterpreter& operator=(const TclInterpreter&) = delete;
    ~TclInterpreter();

    void addCommand(const std::string& name, Command command);
    void setVariable(const std::string& name, const std::string& value);

    /// Takes a list apart.
    /// @throws Error  what is wrong with it
    Words list(const std::string& text) const;

    struct Outcome {
        bool isGood;
        int line;          ///< of the failure, counted from 1
        std::string text;  ///< of the failure
    };
    Outcome run(const std::string& script);

private:
    struct Delete {
        void operator()(Tcl_Interp* interpreter) const;
    };
    std::map<std::string, Command> commands_;  // Tcl keeps their addresses
    std::unique_ptr<Tcl_Interp, Delete> interpreter_;
};

}  // namespace host
