// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The chips and sensors of the machine without their values: what does not change while the chips
// and the sensors configuration stay.

#pragma once

#include "platform/instrumentation/Source.h"
#include "platform/instrumentation/hwmon/AttributeMeaning.h"
#include "platform/instrumentation/hwmon/Machine.h"
#include "platform/utilities/Descriptor.h"

#include <cstddef>
#include <optional>
#include <string>
#include <vector>

namespace Vorn::Hwmon {

class FeatureLines;

struct Chip {
    std::string path; // of the folder with its attributes
    FolderId id;
    Descriptor folder; // not open past the first 256 chips

    // Returns a descriptor of the folder; none when the chip was removed.
    Descriptor openFolder() const;
};

struct Attribute {
    std::string file; // in the folder of the chip
    const AttributeMeaning* meaning;
    bool isComputed; // by libsensors, for a `compute` line
};

struct Feature {
    std::string name; // the driver's, such as "temp1"
    NodeLexicon::NodeType type;
    Node node;                         // its token is the index of the feature
    std::size_t chip;                  // its index
    std::vector<Attribute> attributes; // those that the chip has
};

// Immutable, so that any number of threads may read it.
struct Catalogue {
    Machine machine;
    std::size_t attributes = 0;    // the fingerprint of their names
    std::vector<Chip> chips;       // sorted by name: the order of the kernel's folder is arbitrary
    std::vector<Feature> features; // in the order of chips, then of their drivers
};

// Returns the chips and features that libsensors lists and the administrator does not ignore.
// Throws std::runtime_error naming the chip whose folder cannot be opened. REQUIRES: a lock of
// ChipList is held, and libsensors has listed the chips after the attributes were listed.
Catalogue makeCatalogue(const AttributeNames& attributes, const FeatureLines& configuration);

} // namespace Vorn::Hwmon
