// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Runs a test program in a mount namespace of its own, so that it can put a sysfs tree of its
// making where the kernel's is, and a sensors configuration where the administrator's is,
// without anybody else seeing it.

#pragma once

#include "tests/support/TemporaryFolder.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <string>

namespace Testing {

// Runs the program again inside `unshare`, or returns at once when it is inside already or no
// namespace can be made. REQUIRES: called first in main(), with main's argument.
void enterMountNamespace(char** argv);

// Skips its tests, saying why, where no namespace can be made; fails them under CI.
class MountNamespaceTest : public testing::Test {
protected:
    void SetUp() override;
};

// A file or folder bound over another one while it lives.
class BindMount {
public:
    BindMount(const std::filesystem::path& from, const std::filesystem::path& over);
    ~BindMount();
    BindMount(const BindMount&) = delete;
    BindMount& operator=(const BindMount&) = delete;

private:
    std::filesystem::path over_;
};

// The sysfs tree of a machine, laid out in a temporary folder and bound over /sys/class. The tree
// holds `hwmon/hwmonN/...`, whose `device` links lead to `../../devices/<address>`, where a
// `subsystem` link names the bus.
class BoundSysfs {
public:
    // Reads tests/data/sysfs/<machine>.txt, which has a line for each file (`PATH CONTENT`) and
    // for each symbolic link (`PATH -> TARGET`). An empty name gives an empty tree.
    explicit BoundSysfs(const std::string& machine);

    // Paths are relative to the tree, such as "hwmon/hwmon0/temp1_input".
    std::filesystem::path path(const std::string& relative) const
    {
        return tree_.path() / relative;
    }
    void write(const std::string& relative, const std::string& text);
    void remove(const std::string& relative);
    void rename(const std::string& from, const std::string& to);

    // A chip on the bus at the address, with no attribute but its name.
    void addChip(const std::string& folder, const std::string& name, const std::string& bus,
        const std::string& address);

private:
    TemporaryFolder tree_;
    BindMount mount_;
};

// A sensors configuration instead of the administrator's /etc/sensors3.conf.
class BoundSensorsConfiguration {
public:
    explicit BoundSensorsConfiguration(const std::string& text);

    void write(const std::string& text);

private:
    TemporaryFolder folder_;
    std::filesystem::path file_;
    BindMount mount_;
};

} // namespace Testing
