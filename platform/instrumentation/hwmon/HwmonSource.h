// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "platform/instrumentation/Descriptor.h"
#include "platform/instrumentation/Source.h"

#include <memory>
#include <vector>

namespace Vorn {

namespace Hwmon {
struct Catalogue;
struct Chip;
} // namespace Hwmon

// Serves the fans, voltages and temperatures of the kernel's hwmon interface, a node for each
// feature, with the `label`, `compute` and `ignore` lines of libsensors' configuration applied.
// Added and removed chips are found when nodes are listed next; a node whose chip was removed
// meanwhile has status 13 and no properties.
class HwmonSource final : public Source {
public:
    // Throws std::runtime_error when libsensors cannot be used. A kernel without hwmon has no
    // nodes.
    std::vector<Node> nodes(NodeLexicon::NodeType type) override;

    NodeReading read(const Node& node) override;

private:
    int folderOf(const Hwmon::Chip& chip);

    std::shared_ptr<const Hwmon::Catalogue> catalogue_; // of the last listing; null before
    // The last chip that was read without an open folder in the catalogue, and its folder.
    const Hwmon::Chip* chip_ = nullptr;
    Descriptor folder_;
};

} // namespace Vorn
