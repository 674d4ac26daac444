// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "platform/instrumentation/hwmon/Catalogue.h"

#include <memory>

namespace Vorn::Hwmon {

// Reads the features of a catalogue. Used by one thread at a time; several readers may read one
// catalogue at once.
class NodeReader {
public:
    explicit NodeReader(std::shared_ptr<const Catalogue> catalogue);

    // Reads a feature of the catalogue; one whose chip was removed has status 13 and no properties.
    NodeReading read(const Feature& feature);

private:
    int folderOf(const Chip& chip);

    std::shared_ptr<const Catalogue> catalogue_;
    // The last chip that was read without an open folder in the catalogue, and its folder.
    const Chip* chip_ = nullptr;
    Descriptor folder_;
};

} // namespace Vorn::Hwmon
