// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Chips and features by names of our own: what libsensors hands out is gone with its next
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

// A feature of a chip as libsensors has it at present; null pointers when it is gone.
struct Feature {
    const sensors_chip_name* chip = nullptr;
    const sensors_feature* feature = nullptr;
};

// The detected chips, sorted by name: the order of the kernel's folder is arbitrary.
std::vector<const sensors_chip_name*> detectedChips();

// The features of one type that the administrator does not ignore, in the driver's order.
std::vector<const sensors_feature*> featuresOf(
    const sensors_chip_name& chip, sensors_feature_type type);

// Such as "coretemp-isa-0000".
std::string printedName(const sensors_chip_name& chip);

// Which folder of the kernel the chip is: a chip that was unplugged and plugged in again is
// another one. Nothing when it is gone.
std::optional<std::pair<dev_t, ino_t>> folderOf(const sensors_chip_name& chip);

// The administrator's label or the driver's, as it stands, else the feature's name; the latter
// also when the chip has just gone. Empty when libsensors has no memory.
std::string labelOf(const Feature& feature);

FeatureId identify(const Feature& feature);

// Looks the feature up by name. A machine has some dozens of chips: this costs nothing beside
// the reading that follows.
Feature find(const FeatureId& id);

} // namespace Vorn::Hwmon
