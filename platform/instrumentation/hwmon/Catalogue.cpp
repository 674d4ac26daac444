// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/instrumentation/hwmon/Catalogue.h"

#include "platform/instrumentation/hwmon/FeatureLines.h"
#include "platform/text/Trim.h"
#include "platform/text/Utf8.h"

#include <fcntl.h>
#include <sensors/sensors.h>
#include <sys/stat.h>
#include <unistd.h>

#include <algorithm>
#include <array>
#include <cstdlib>
#include <memory>
#include <set>
#include <stdexcept>
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

// Returns the administrator's or the driver's label, or the feature's name where it is empty.
std::string labelOf(const sensors_chip_name& chip, const sensors_feature& feature)
{
    const std::unique_ptr<char, decltype(&std::free)> label(
        sensors_get_label(&chip, &feature), &std::free);
    const std::string text =
        label == nullptr ? std::string() : Text::toValidUtf8(Text::trimmed(label.get()));
    return text.empty() ? feature.name : text;
}

std::vector<Attribute> attributesOf(const sensors_chip_name& chip, const sensors_feature& feature,
    bool mayBeComputed, const std::set<std::string>& unlisted)
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
    if (unlisted.contains(enable))
        attributes.push_back({std::move(enable), &enableMeaning, false});
    return attributes;
}

// Returns the features of a chip without their place in the catalogue.
std::vector<Feature> featuresOf(
    const NamedChip& chip, const std::set<std::string>& unlisted, const FeatureLines& configuration)
{
    const auto& [chipName, name] = chip;
    std::vector<Feature> features;
    int position = 0;
    while (const sensors_feature* found = sensors_get_features(name, &position))
        if (const auto type = nodeTypeOf(found->type)) {
            const std::string feature = found->name;
            // libsensors would look for the file of a label for each feature.
            const bool hasLabel =
                unlisted.contains(feature + "_label") || configuration.mayLabel(*name, feature);
            Node node{"/hwmon/" + chipName + "/" + feature,
                hasLabel ? labelOf(*name, *found) : feature, static_cast<unsigned>(*type)};
            features.push_back({feature, *type, std::move(node), 0,
                attributesOf(*name, *found, configuration.mayCompute(*name, feature), unlisted)});
        }
    return features;
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

Catalogue makeCatalogue(const AttributeNames& attributes, const FeatureLines& configuration)
{
    Catalogue catalogue;
    for (const NamedChip& detected : detectedChips()) {
        const std::string path = detected.second->path;
        const auto id = folderId(path);
        if (!id)
            continue;
        Chip chip{path, *id, Descriptor()};
        chip.folder = chip.openFolder();
        const auto listed = attributes.unlisted.find(*id);
        std::vector<Feature> features = featuresOf(detected,
            listed != attributes.unlisted.end() ? listed->second : unlistedAttributes(path),
            configuration);
        // A chip that disappeared while its features were listed is left out, since the labels,
        // which name the sensors, may be incomplete.
        if (features.empty() || id != folderId(path))
            continue;
        if (!chip.folder.isOpen())
            throw std::runtime_error("cannot open " + path);
        for (Feature& feature : features) {
            feature.chip = catalogue.chips.size();
            feature.node.token = catalogue.features.size();
            catalogue.features.push_back(std::move(feature));
        }
        if (catalogue.chips.size() >= maximumOpenFolders)
            chip.folder = Descriptor();
        catalogue.chips.push_back(std::move(chip));
    }
    return catalogue;
}

} // namespace Vorn::Hwmon
