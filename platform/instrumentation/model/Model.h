// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// A described machine: what a model file holds.

#pragma once

#include "platform/instrumentation/Source.h"

#include <cstddef>
#include <map>
#include <string>
#include <vector>

namespace Vorn {

struct ModelNode {
    NodeLexicon::NodeType type{};
    std::string path;
    std::string description;
    unsigned sensorType = 0;
    NodeReading values;
};

// The nodes in the order of the file, found by type. Never changes once it is made, so that
// any number of threads may read it.
class Model {
public:
    explicit Model(std::vector<ModelNode> nodes);

    const ModelNode& node(std::size_t index) const { return nodes_.at(index); }

    // The indices of the nodes of one type, ascending.
    const std::vector<std::size_t>& nodesOfType(NodeLexicon::NodeType type) const;

private:
    std::vector<ModelNode> nodes_;
    std::map<NodeLexicon::NodeType, std::vector<std::size_t>> indices_;
};

} // namespace Vorn
