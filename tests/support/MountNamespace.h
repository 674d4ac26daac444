// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Runs a test program in a mount namespace of its own, in which it can mount a sysfs tree over that
// of the kernel and a sensors configuration over that of the administrator.

#pragma once

#include "tests/support/TemporaryFolder.h"

#include <gtest/gtest.h>

#include <filesystem>
#include <string>

namespace Testing {

// Executes the program again by `private_mounts` or `unshare`; returns when it runs in the
// namespace already or none can be created. REQUIRES: called first in main(), with main's argument.
void enterMountNamespace(char** argv);

// Skips its tests with the reason where no namespace can be created; fails them in CI.
class MountNamespaceTest : public testing::Test {
protected:
    void SetUp() override;
};

// A bind mount of a file or folder over another one, which exists during its lifetime.
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
    // Gives the folder a new inode, as a chip has that the kernel registers again.
    void renew(const std::string& folder);

    // Adds a chip on the bus at the address. Its only attribute is its name.
    void addChip(const std::string& folder, const std::string& name, const std::string& bus,
        const std::string& address);

    // Adds a network interface to the device at the address.
    void addInterface(const std::string& address, const std::string& name);

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
