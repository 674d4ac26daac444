// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "platform/instrumentation/Source.h"
#include "platform/instrumentation/machinefile/ServedMachineFile.h"

#include <memory>
#include <string>
#include <vector>

namespace Vorn {

// Serves the sensors of a model file as it was when the source was made.
class MachineFileSource final : public Source {
public:
    // Throws std::runtime_error naming the file, the place in it and the reason.
    explicit MachineFileSource(const std::string& path);

    const std::vector<Node>& nodes(NodeLexicon::NodeType type) override;
    const NodeReading& read(const Node& node) override;

    // Returns when the sensors were read, if a process renews the file.
    const std::optional<Renewal>& renewal() const { return file_->renewal; }

private:
    std::shared_ptr<const ServedMachineFile> file_;
};

// Returns when the file can be served. Throws as the constructor of MachineFileSource does.
void checkMachineFile(const std::string& path);

} // namespace Vorn
