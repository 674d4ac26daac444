// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The fans, voltages and temperatures that the kernel's drivers measure.

#pragma once

#include "platform/instrumentation/Source.h"

#include <memory>
#include <vector>

struct sensors_chip_name;

namespace Vorn {

namespace Hwmon {
struct FeatureId;
}

// One node per feature, by way of libsensors, so that the `label`, `compute` and `ignore` lines
// of the administrator's sensors configuration hold. A chip that came or went shows when nodes
// are listed next; one that went after that reads as status 13 without any property.
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

    std::vector<Hwmon::FeatureId> listed_; // a node's token is its place here
};

} // namespace Vorn
