// The Python module that button scripts use:
//
//   zefra.Root()['frame'].value()              the current frame; setValue(number)
//   node = zefra.toNode("this")                the button's node; others by name, None for none
//   node.name()
//   node['lut1d'].value()                      int, bool, or str for menus and file names
//   node['lut1d'].setValue(2048)               as typed at the panel
//   zefra.executeMultiple([node], ([first, last, step],))

#include "host/ButtonScript.h"

#include <fmt/format.h>
#include <pybind11/embed.h>
#include <pybind11/stl.h>

#include <algorithm>
#include <array>
#include <optional>
#include <string>
#include <utility>
#include <vector>

#include "host/Error.h"
#include "host/Host.h"
#include "host/Text.h"

namespace host {
namespace {

namespace py = pybind11;

/// What the module's functions work on while a button's script runs.
struct Press {
    Host& host;
    Node& node;
};
Press* currentPress = nullptr;

Press& press() {
    if (currentPress == nullptr) throw Error("no button is being pressed");
    return *currentPress;
}

class PressScope {
public:
    explicit PressScope(Press& press) : outer_(std::exchange(currentPress, &press)) {}
    PressScope(const PressScope&) = delete;
    PressScope& operator=(const PressScope&) = delete;
    ~PressScope() { currentPress = outer_; }

private:
    Press* outer_;
};

/// A node as a script holds it: by name, since the script may keep it longer than there is a node.
struct PythonNode {
    std::string name;

    Node& node() const {
        Node* const found = press().host.findNode(name);
        if (found == nullptr) throw Error(fmt::format("no node named \"{}\"", name));
        return *found;
    }
};

struct PythonControl {
    PythonNode owner;
    std::string name;

    py::object value() const {
        const std::string text = owner.node().value(name);
        const PanelControl& control = *owner.node().findControl(name);
        switch (control.kind()) {
            case PanelControl::Kind::Integer:
                return py::int_(control.number());
            case PanelControl::Kind::Boolean:
                return py::bool_(control.number() != 0);
            default:
                return py::str(text);
        }
    }

    void setValue(const py::object& value) const { owner.node().setValue(name, py::str(value)); }
};

struct PythonFrame {
    int value() const { return press().host.frame(); }
    void setValue(int frame) const { press().host.setFrame(frame); }
};

struct PythonRoot {
    PythonFrame get(const std::string& name) const {
        if (name != "frame") throw Error(fmt::format("Root: no control named \"{}\"", name));
        return {};
    }
};

std::optional<PythonNode> toNode(const std::string& name) {
    if (name == "this") return PythonNode{press().node.name()};
    const Node* const node = press().host.findNode(name);
    if (node == nullptr || node->name() != name) return std::nullopt;
    return PythonNode{name};
}

void executeMultiple(const std::vector<PythonNode>& pythonNodes,
                     const std::vector<std::array<int, 3>>& pythonRanges) {
    std::vector<Node*> nodes(pythonNodes.size());
    std::transform(pythonNodes.begin(), pythonNodes.end(), nodes.begin(),
                   [](const PythonNode& each) { return &each.node(); });
    std::vector<FrameRange> ranges(pythonRanges.size());
    std::transform(pythonRanges.begin(), pythonRanges.end(), ranges.begin(),
                   [](const std::array<int, 3>& each) {
                       return FrameRange{each[0], each[1], each[2]};
                   });
    press().host.executeMultiple(nodes, ranges);
}

/// Starts the interpreter that the program was built for, whatever the environment says about
/// others. It lives as long as the program and is not taken down at its end: extension modules that
/// a script has loaded do not survive that reliably.
void startPython() {
    static const bool isStarted = [] {
        PyPreConfig preparation;
        PyPreConfig_InitIsolatedConfig(&preparation);
        preparation.utf8_mode = 1;  // as in the paths that controls hold
        Py_PreInitialize(&preparation);

        PyConfig config;
        PyConfig_InitIsolatedConfig(&config);
        config.install_signal_handlers = 0;
        config.write_bytecode = 0;
        PyConfig_SetBytesString(&config, &config.home, ORLITH_PYTHON_HOME);
        PyConfig_SetBytesString(&config, &config.program_name, ORLITH_PYTHON_HOME "/bin/python3");
        py::initialize_interpreter(&config, 0, nullptr, false);
        return true;
    }();
    static_cast<void>(isStarted);
    // Standard output is for results.
    const auto sys = py::module_::import("sys");
    sys.attr("stdout") = sys.attr("stderr");
}

std::string describe(const py::error_already_set& raised) {
    const std::string type = py::str(raised.type().attr("__name__"));
    return fmt::format("{}: {}", type, oneLine(std::string(py::str(raised.value()))));
}

}  // namespace

void runButtonScript(Host& host, Node& node, const PanelControl& button) {
    const std::string name = fmt::format("{}.{}", node.name(), button.name());
    Press press{host, node};
    const PressScope scope(press);
    try {
        startPython();
        py::dict names;
        names["zefra"] = py::module_::import("zefra");
        const auto builtins = py::module_::import("builtins");
        names["__builtins__"] = builtins;
        const py::object code = builtins.attr("compile")(button.script(), name, "exec");
        builtins.attr("exec")(code, names);
    } catch (const py::error_already_set& raised) {
        throw Error(fmt::format("{}: {}", name, describe(raised)));
    } catch (const std::exception& failure) {
        throw Error(fmt::format("{}: {}", name, oneLine(failure.what())));
    }
}

}  // namespace host

PYBIND11_EMBEDDED_MODULE(zefra, module) {
    using namespace host;
    py::class_<PythonFrame>(module, "Frame")
        .def("value", &PythonFrame::value)
        .def("setValue", &PythonFrame::setValue);
    py::class_<PythonRoot>(module, "Root").def(py::init<>()).def("__getitem__", &PythonRoot::get);
    py::class_<PythonControl>(module, "Control")
        .def("value", &PythonControl::value)
        .def("setValue", &PythonControl::setValue);
    py::class_<PythonNode>(module, "Node")
        .def("name", [](const PythonNode& node) { return node.name; })
        .def("__getitem__", [](const PythonNode& node, const std::string& control) {
            return PythonControl{node, control};
        });
    module.def("toNode", &toNode);
    module.def("executeMultiple", &executeMultiple);
}
