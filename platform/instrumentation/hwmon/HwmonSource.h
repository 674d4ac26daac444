// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "platform/instrumentation/Source.h"
#include "platform/instrumentation/hwmon/NodeReader.h"

#include <memory>
#include <optional>
#include <vector>

namespace Vorn {

// Serves the fans, voltages and temperatures of the kernel's hwmon interface, a node for each
// feature, with the `label`, `compute` and `ignore` lines of libsensors' configuration applied.
// Added and removed chips are found when nodes are listed next; a node whose chip was removed
// meanwhile has status 13 and no properties.
class HwmonSource final : public Source {
public:
    // In parallel, all nodes of a listing are read when the first of them is, in threads that end
    // with that call: a chip that takes long to be read does not delay the others.
    enum class Order { serial, parallel };

    explicit HwmonSource(Order order = Order::serial) : order_(order) {}

    // Throws std::runtime_error when libsensors cannot be used. A kernel without hwmon has no
    // nodes.
    const std::vector<Node>& nodes(NodeLexicon::NodeType type) override;

    const NodeReading& read(const Node& node) override;

private:
    void readAhead(NodeLexicon::NodeType type);

    Order order_;
    std::shared_ptr<const Hwmon::Catalogue> catalogue_; // of the last listing; null before
    std::optional<Hwmon::NodeReader> reader_;
    std::vector<Node> nodes_;                       // of that listing
    std::vector<std::optional<NodeReading>> ahead_; // by token, each until it is requested
    NodeReading reading_;                           // the last one that was requested
};

} // namespace Vorn
