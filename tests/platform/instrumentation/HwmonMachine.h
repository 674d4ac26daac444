// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Machines whose sysfs tree a test defines.

#pragma once

#include "tests/platform/instrumentation/Walk.h"
#include "tests/support/Environment.h"
#include "tests/support/MountNamespace.h"

#include <filesystem>
#include <map>
#include <optional>
#include <stdexcept>
#include <string>
#include <vector>

namespace Testing {

// Each test runs with the source hwmon alone and an empty sensors configuration.
class HwmonTest : public MountNamespaceTest {
protected:
    void SetUp() override
    {
        MountNamespaceTest::SetUp();
        if (!IsSkipped() && !HasFatalFailure())
            configuration_.emplace("");
    }

    BoundSensorsConfiguration& configuration() { return *configuration_; }

private:
    EnvironmentVariable environment_{"VORN_INSTRUMENTATION", "hwmon"};
    std::optional<BoundSensorsConfiguration> configuration_;
};

using Attributes = std::map<std::string, std::string>;

// A machine with one chip, "testchip-isa-0290", and the given attributes.
class OneChip {
public:
    explicit OneChip(const Attributes& attributes) : sysfs_("")
    {
        sysfs_.addChip("hwmon0", "testchip", "platform", "testchip.656");
        for (const auto& [name, text] : attributes)
            set(name, text);
    }

    void set(const std::string& attribute, const std::string& text)
    {
        sysfs_.write("hwmon/hwmon0/" + attribute, text + "\n");
    }

    BoundSysfs& sysfs() { return sysfs_; }

private:
    BoundSysfs sysfs_;
};

inline std::string testchip(const std::string& feature)
{
    return "/hwmon/testchip-isa-0290/" + feature;
}

// Returns the only node of a machine.
inline SeenNode only(const std::vector<SeenNode>& nodes)
{
    if (nodes.size() != 1)
        throw std::logic_error("there are " + std::to_string(nodes.size()) + " nodes");
    return nodes.front();
}

// Returns the only node of a chip with these attributes.
inline SeenNode nodeOf(const Attributes& attributes)
{
    const OneChip chip(attributes);
    return only(walk());
}

} // namespace Testing
