// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/instrumentation/model/ModelSource.h"

#include "platform/instrumentation/model/ModelCache.h"

namespace Vorn {

ModelSource::ModelSource(const std::string& path) : model_(ModelCache::instance().load(path)) {}

std::vector<Node> ModelSource::nodes(NodeLexicon::NodeType type)
{
    const std::vector<std::size_t>& indices = model_->nodesOfType(type);
    std::vector<Node> nodes;
    nodes.reserve(indices.size());
    for (const std::size_t index : indices) {
        const ModelNode& node = model_->node(index);
        nodes.push_back({node.path, node.description, node.sensorType, index});
    }
    return nodes;
}

NodeReading ModelSource::read(const Node& node)
{
    return model_->node(node.token).values;
}

} // namespace Vorn
