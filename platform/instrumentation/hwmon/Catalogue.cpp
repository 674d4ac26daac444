// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/instrumentation/hwmon/Catalogue.h"

#include "platform/instrumentation/hwmon/ComputeLines.h"
#include "platform/text/Trim.h"
#include "platform/text/Utf8.h"

#include <fcntl.h>
#include <sensors/sensors.h>
#include <sys/stat.h>
#include <unistd.h>

#include <algorithm>
#include <array>
#include <cstdlib>
#include <iterator>
#include <memory>
#include <utility>

namespace Vorn::Hwmon {

using NodeLexicon::NodeType;

namespace {

constexpr std::size_t maximumOpenFolders = 256;

// Returns the chip's name, such as "coretemp-isa-0000".
std::string printedName(const sensors_chip_name& chip)
{
    std::array<char, 256> name{};
    const int length = sensors_snprintf_chip_name(name.data(), name.size(), &chip);
    return length < 0 ? std::string(chip.prefix) : std::string(name.data());
}

using NamedChip = std::pair<std::string, const sensors_chip_name*>;

std::vector<NamedChip> detectedChips()
{
    std::vector<NamedChip> chips;
    int position = 0;
    while (const sensors_chip_name* chip = sensors_get_detected_chips(nullptr, &position))
        chips.emplace_back(printedName(*chip), chip);
    std::stable_sort(chips.begin(), chips.end(),
        [](const NamedChip& left, const NamedChip& right) { return left.first < right.first; });
    return chips;
}

std::optional<NodeType> nodeTypeOf(sensors_feature_type type)
{
    switch (type) {
    case SENSORS_FEATURE_FAN:
        return NodeType::Tachometer;
    case SENSORS_FEATURE_IN:
        return NodeType::Voltage;
    case SENSORS_FEATURE_TEMP:
        return NodeType::Temperature;
    default:
        return std::nullopt;
    }
}

// Returns the administrator's or the driver's label, or the feature's name where there is none.
std::string descriptionOf(const sensors_chip_name& chip, const sensors_feature& feature)
{
    const std::unique_ptr<char, decltype(&std::free)> label(
        sensors_get_label(&chip, &feature), &std::free);
    const std::string text =
        label == nullptr ? std::string() : Text::toValidUtf8(Text::trimmed(label.get()));
    return text.empty() ? feature.name : text;
}

std::vector<Attribute> attributesOf(
    const sensors_chip_name& chip, const sensors_feature& feature, bool mayBeComputed)
{
    std::vector<Attribute> attributes;
    int position = 0;
    while (const auto* const found = sensors_get_all_subfeatures(&chip, &feature, &position)) {
        // The average stands in where there is no input.
        const bool isSpare =
            found->type == SENSORS_SUBFEATURE_IN_AVERAGE &&
            sensors_get_subfeature(&chip, &feature, SENSORS_SUBFEATURE_IN_INPUT) != nullptr;
        const AttributeMeaning* const meaning = meaningOf(found->type);
        if (meaning != nullptr && !isSpare)
            attributes.push_back({found->name, meaning,
                mayBeComputed && (found->flags & SENSORS_COMPUTE_MAPPING) != 0});
    }
    std::string enable = std::string(feature.name) + "_enable";
    if (access((std::string(chip.path) + "/" + enable).c_str(), F_OK) == 0)
        attributes.push_back({std::move(enable), &enableMeaning, false});
    return attributes;
}

} // namespace

Descriptor Chip::openFolder() const
{
    Descriptor opened(open(path.c_str(), O_PATH | O_DIRECTORY | O_CLOEXEC));
    struct stat status {};
    if (fstat(opened.number(), &status) != 0 || id != FolderId{status.st_dev, status.st_ino})
        return Descriptor();
    return opened;
}

Catalogue makeCatalogue(const ComputeLines& computeLines)
{
    Catalogue catalogue;
    for (const auto& [name, chip] : detectedChips()) {
        const auto id = folderId(chip->path);
        std::vector<Feature> features;
        int position = 0;
        while (const sensors_feature* feature = sensors_get_features(chip, &position)) {
            const auto type = nodeTypeOf(feature->type);
            if (!type)
                continue;
            const std::size_t token = catalogue.features.size() + features.size();
            features.push_back({feature->name, *type,
                {"/hwmon/" + name + "/" + feature->name, descriptionOf(*chip, *feature),
                    static_cast<unsigned>(*type), token},
                catalogue.chips.size(),
                attributesOf(*chip, *feature, computeLines.mayApplyTo(*chip, feature->name))});
        }
        // A chip that disappeared while its features were listed is left out, since the labels,
        // which name the sensors, may be incomplete.
        if (features.empty() || !id || id != folderId(chip->path))
            continue;
        Chip& listed = catalogue.chips.emplace_back(Chip{chip->path, *id, Descriptor()});
        if (catalogue.chips.size() <= maximumOpenFolders)
            listed.folder = listed.openFolder();
        std::move(features.begin(), features.end(), std::back_inserter(catalogue.features));
    }
    return catalogue;
}

} // namespace Vorn::Hwmon
