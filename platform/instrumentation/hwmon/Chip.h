// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Chips and features by name: the pointers that libsensors returns are valid until its next
// initialisation. REQUIRES of every function here: a ChipList lock is held.

#pragma once

#include <sensors/sensors.h>

#include <optional>
#include <string>
#include <utility>
#include <vector>

#include <sys/types.h>

namespace Vorn::Hwmon {

struct ChipId {
    std::string prefix;
    sensors_bus_id bus{};
    int address = 0;
    std::string folder; // where the kernel shows the chip's attributes
};

struct FeatureId {
    ChipId chip;
    std::string name;
};

// A feature of a chip in libsensors' current list; null pointers when it was removed.
struct Feature {
    const sensors_chip_name* chip = nullptr;
    const sensors_feature* feature = nullptr;
};

// Returns the detected chips, sorted by name: the order of the kernel's folder is arbitrary.
std::vector<const sensors_chip_name*> detectedChips();

// Returns the features of one type that the administrator does not ignore, in the driver's order.
std::vector<const sensors_feature*> featuresOf(
    const sensors_chip_name& chip, sensors_feature_type type);

// Returns the chip's name, such as "coretemp-isa-0000".
std::string printedName(const sensors_chip_name& chip);

// Returns the chip's folder in sysfs, which changes when a chip is unplugged and plugged in again;
// nothing when the chip was removed.
std::optional<std::pair<dev_t, ino_t>> folderOf(const sensors_chip_name& chip);

// Returns the administrator's or the driver's label, unchanged, or the feature's name where there
// is none or the chip was removed; empty when libsensors runs out of memory.
std::string labelOf(const Feature& feature);

FeatureId identify(const Feature& feature);

// Finds the feature by name, which costs little compared with reading it.
Feature find(const FeatureId& id);

} // namespace Vorn::Hwmon
