// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/instrumentation/machinefile/MachineFileSource.h"

#include "platform/instrumentation/machinefile/MachineFileCache.h"

namespace Vorn {

MachineFileSource::MachineFileSource(const std::string& path)
    : file_(MachineFileCache::instance().load(path))
{
}

const std::vector<Node>& MachineFileSource::nodes(NodeLexicon::NodeType type)
{
    static const std::vector<Node> none;
    const auto found = file_->nodes.find(type);
    return found == file_->nodes.end() ? none : found->second;
}

const NodeReading& MachineFileSource::read(const Node& node)
{
    return file_->readings.at(node.token);
}

void checkMachineFile(const std::string& path)
{
    MachineFileCache::instance().load(path);
}

} // namespace Vorn
