// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "platform/instrumentation/Source.h"

#include <memory>
#include <vector>

struct sensors_chip_name;

namespace Vorn {

namespace Hwmon {
struct FeatureId;
}

// Serves the fans, voltages and temperatures of the kernel's hwmon interface, a node for each
// feature, through libsensors, so that the `label`, `compute` and `ignore` lines of the
// administrator's configuration apply. Added and removed chips are found when nodes are listed
// next; a node whose chip was removed meanwhile has status 13 and no properties.
class HwmonSource final : public Source {
public:
    HwmonSource();
    ~HwmonSource() override;

    // Throws std::runtime_error when libsensors cannot be used. A kernel without hwmon has no
    // nodes.
    std::vector<Node> nodes(NodeLexicon::NodeType type) override;

    NodeReading read(const Node& node) override;

private:
    std::vector<Node> nodesOf(const sensors_chip_name& chip, NodeLexicon::NodeType type);

    std::vector<Hwmon::FeatureId> listed_; // a node's token is its index here
};

} // namespace Vorn
