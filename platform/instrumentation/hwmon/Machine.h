// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Changes of the set of chips and of the sensors configuration.

#pragma once

#include "platform/instrumentation/FileStamp.h"

#include <cstddef>
#include <map>
#include <optional>
#include <set>
#include <string>
#include <utility>
#include <vector>

#include <sys/types.h>

namespace Vorn::Hwmon {

// Identifies a chip's folder in sysfs: a chip that is registered anew gets another one. The times
// of the folder are no criterion: the kernel sets them whenever it allocates the inode, which it
// may evict from its cache.
using FolderId = std::pair<dev_t, ino_t>;

// Returns nothing when there is no such folder.
std::optional<FolderId> folderId(const std::string& path);

// What the list of chips depends on.
struct Machine {
    bool hasHwmon = false;                                // whether the kernel has a hwmon class
    std::vector<std::pair<std::string, FolderId>> chips;  // with the names of their folders
    std::vector<std::pair<std::string, FileStamp>> files; // of the sensors configuration

    bool operator==(const Machine&) const = default;
};

// Costs a few system calls, and one for each chip. Throws std::system_error when the folder of the
// chips cannot be listed.
Machine presentMachine();

// The names of the attributes of the chips at one time.
struct AttributeNames {
    std::size_t fingerprint = 0; // changes with them: drivers may add some to a registered chip
    // The result of unlistedAttributes() for the folders of chips; not for those of their devices,
    // which have the attributes of old drivers.
    std::map<FolderId, std::set<std::string>> unlisted;
};

// Lists the folder of each chip, or that of its device.
AttributeNames attributeNames(const Machine& machine);

// Returns those names of attributes in the folder of a chip that libsensors does not list: they end
// in "_enable" or "_label".
std::set<std::string> unlistedAttributes(const std::string& chipFolder);

} // namespace Vorn::Hwmon
