#pragma once

#include <gtest/gtest.h>

#include <string>

#include "host/Error.h"
#include "host/Host.h"
#include "tests/support/Files.h"

namespace test {

/// A host that has loaded the real operator, and a folder of its own.
class HostTest : public ::testing::Test {
protected:
    HostTest() { host_.loadBundle(ORLITH_TEST_BUNDLE); }
    ~HostTest() override { host::Host::clearCancel(); }

    /// A pattern of the smallest size with the operator behind it; returns the operator's node.
    host::Node& generator() {
        host::Node& pattern = host_.createNode("CMSTestPattern");
        pattern.setValue("size", "2");
        host::Node& node = host_.createNode("GenerateLUT");
        node.connect(0, pattern);
        return node;
    }

    host::Host host_;
    TempFolder folder_;
};

/// The text of the Error that an action ends in; empty if it does not.
template <typename Action>
std::string failureOf(Action action) {
    try {
        action();
    } catch (const host::Error& failure) {
        return failure.what();
    }
    return {};
}

}  // namespace test
