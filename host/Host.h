#pragma once

#include <memory>
#include <string>
#include <vector>

#include "host/Bundles.h"
#include "host/Cancel.h"
#include "host/Node.h"

namespace host {

/// Frames first, first + step, ... up to last, which may lie below for a negative step.
struct FrameRange {
    int first;
    int last;
    int step;
};

/// The embedded host: the nodes of one script, the bundles that their operators come from, and the
/// current frame. One thread.
class Host {
public:
    /// Takes its bundles from the folder that goes with the running program.
    Host();
    explicit Host(std::string bundleFolder);
    Host(const Host&) = delete;
    Host& operator=(const Host&) = delete;
    ~Host();

    /// Loads one bundle, or all of the folder.
    /// @throws Error  with the reason
    void loadBundle(const std::string& path);
    void loadBundles();

    /// Makes a node, named by its class and a number: GenerateLUT1.
    /// @throws Error  no operator of that class
    Node& createNode(const std::string& className);

    /// The node of that name, else the only node of that class, else null.
    Node* findNode(const std::string& nameOrClass) const;
    const std::vector<std::unique_ptr<Node>>& nodes() const { return nodes_; }

    int frame() const { return frame_; }
    void setFrame(int frame) { frame_ = frame; }

    /// Runs a script of saved nodes (Tcl): each operator class is a command that takes a list of
    /// control names and values, makes a node, and connects it to the script's node before it.
    /// @param label  what failures call the script
    /// @throws Error  "LABEL:LINE: reason"
    void runScript(const std::string& tcl, const std::string& label);

    /// Presses a node's button: runs its script (Python).
    /// @throws Error  no such button, or the script's failure. Failures of nodes that it executes
    ///                are those nodes' errors.
    void press(Node& node, const std::string& controlName);

    /// Executes nodes frame by frame. Stops after a frame in which one of them failed, and when the
    /// user cancels; then the current frame is what it was before.
    /// @throws Error  a step of 0, or more frames than anybody can mean
    void executeMultiple(const std::vector<Node*>& nodes, const std::vector<FrameRange>& ranges);

    // Stops what is being executed; the first may be called from a signal handler.
    static void requestCancel() noexcept { host::requestCancel(); }
    static bool cancelRequested() noexcept { return host::cancelRequested(); }
    static void clearCancel() noexcept { host::clearCancel(); }

private:
    bool isNameFree(const std::string& name) const;

    std::string bundleFolder_;
    std::vector<Bundle> bundles_;  // before the nodes, whose operators' code they hold
    std::vector<std::unique_ptr<Node>> nodes_;
    int frame_ = 1;
};

}  // namespace host
