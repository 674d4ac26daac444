// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/instrumentation/model/Model.h"

#include <utility>

namespace Vorn {

using NodeLexicon::NodeType;

Model::Model(std::vector<ModelNode> nodes) : nodes_(std::move(nodes))
{
    for (std::size_t index = 0; index < nodes_.size(); ++index)
        indices_[nodes_[index].type].push_back(index);
}

const std::vector<std::size_t>& Model::nodesOfType(NodeType type) const
{
    static const std::vector<std::size_t> none;
    const auto found = indices_.find(type);
    return found == indices_.end() ? none : found->second;
}

} // namespace Vorn
