// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "platform/instrumentation/Source.h"
#include "platform/instrumentation/machinefile/MachineFileSource.h"

#include <optional>
#include <string>

namespace Vorn {

// The file that `sensorctl collect` writes by default.
inline constexpr const char* defaultCollection = "/run/sensor-profile/ipmi.json";

// Returns the time since the machine started, which also passes while it is suspended and does not
// jump when its clock is set.
double secondsSinceStart();

// Serves the sensors of a management controller from the file that another process renews. When
// they were read more than three of its periods ago, every sensor has lost communication; its
// limits and possible states stay. Without the file there are no nodes: most machines have no such
// controller.
class IpmiSource final : public Source {
public:
    // An empty path is that of the default. Throws std::runtime_error naming the file, the place in
    // it and the reason.
    explicit IpmiSource(const std::string& named);

    const std::vector<Node>& nodes(NodeLexicon::NodeType type) override;
    const NodeReading& read(const Node& node) override;

    // Returns how many seconds ago the sensors were read; nothing without a file.
    std::optional<double> age() const;

private:
    bool isOutdated() const;

    std::optional<MachineFileSource> file_;
    NodeReading lost_; // of the last node that was read from an outdated file
};

} // namespace Vorn
