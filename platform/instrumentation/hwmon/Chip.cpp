// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/instrumentation/hwmon/Chip.h"

#include <algorithm>
#include <array>
#include <cstdlib>
#include <memory>
#include <utility>

#include <sys/stat.h>

namespace Vorn::Hwmon {

namespace {

bool isChip(const sensors_chip_name& chip, const ChipId& id)
{
    return id.prefix == chip.prefix && id.bus.type == chip.bus.type && id.bus.nr == chip.bus.nr &&
           id.address == chip.addr && id.folder == chip.path;
}

} // namespace

std::vector<const sensors_chip_name*> detectedChips()
{
    std::vector<std::pair<std::string, const sensors_chip_name*>> named;
    int position = 0;
    while (const sensors_chip_name* chip = sensors_get_detected_chips(nullptr, &position))
        named.emplace_back(printedName(*chip), chip);
    std::stable_sort(named.begin(), named.end(),
        [](const auto& left, const auto& right) { return left.first < right.first; });
    std::vector<const sensors_chip_name*> chips;
    chips.reserve(named.size());
    for (const auto& [name, chip] : named)
        chips.push_back(chip);
    return chips;
}

std::vector<const sensors_feature*> featuresOf(
    const sensors_chip_name& chip, sensors_feature_type type)
{
    std::vector<const sensors_feature*> features;
    int position = 0;
    while (const sensors_feature* feature = sensors_get_features(&chip, &position))
        if (feature->type == type)
            features.push_back(feature);
    return features;
}

std::string printedName(const sensors_chip_name& chip)
{
    std::array<char, 256> name{};
    const int length = sensors_snprintf_chip_name(name.data(), name.size(), &chip);
    return length < 0 ? std::string(chip.prefix) : std::string(name.data());
}

std::optional<std::pair<dev_t, ino_t>> folderOf(const sensors_chip_name& chip)
{
    struct stat folder = {};
    if (stat(chip.path, &folder) != 0)
        return std::nullopt;
    return std::pair{folder.st_dev, folder.st_ino};
}

std::string labelOf(const Feature& feature)
{
    const std::unique_ptr<char, decltype(&std::free)> label(
        sensors_get_label(feature.chip, feature.feature), &std::free);
    return label == nullptr ? std::string() : std::string(label.get());
}

FeatureId identify(const Feature& feature)
{
    const sensors_chip_name& chip = *feature.chip;
    return {{chip.prefix, chip.bus, chip.addr, chip.path}, feature.feature->name};
}

Feature find(const FeatureId& id)
{
    int chipPosition = 0;
    while (const sensors_chip_name* chip = sensors_get_detected_chips(nullptr, &chipPosition)) {
        if (!isChip(*chip, id.chip))
            continue;
        int featurePosition = 0;
        while (const sensors_feature* feature = sensors_get_features(chip, &featurePosition))
            if (id.name == feature->name)
                return {chip, feature};
    }
    return {};
}

} // namespace Vorn::Hwmon
