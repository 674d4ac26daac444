// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Where sensor nodes come from. A source reads one kind of hardware description (the kernel's
// hwmon interface, a model file); Vorn::Instrumentation walks the nodes of all of them.

#pragma once

#include "platform/instrumentation/NodeLexicon.h"

#include <cstddef>
#include <optional>
#include <string>
#include <vector>

namespace Vorn {

// One sensor of a source, as it is listed.
struct Node {
    std::string path;        // unique in the machine and the same after a restart
    std::string description; // UTF-8, what a person calls the sensor
    unsigned sensorType = 0; // a NodeLexicon::NodeType number, or a code of the source's own
    std::size_t token = 0;   // the source's own; names the node when it is read
};

// What one node says when it is asked. A value the node does not have is absent.
struct NodeReading {
    unsigned status = 0; // a node status code; 0 when the node reports none
    std::optional<double> reading = {};
    std::optional<double> lowerNonCritical = {};
    std::optional<double> upperNonCritical = {};
    std::optional<double> lowerCritical = {};
    std::optional<double> upperCritical = {};
    std::optional<double> lowerFatal = {};
    std::optional<double> upperFatal = {};
    std::optional<unsigned> baseUnits = {};
    std::optional<std::vector<unsigned>> possibleStates = {};

    bool operator==(const NodeReading&) const = default;
};

// A source belongs to one cursor and is used by one thread at a time; whatever a
// source shares between its objects it guards itself.
class Source {
public:
    virtual ~Source() = default;

    // The nodes of one type, in the source's own order.
    // Throws std::runtime_error naming the file, line or chip when it cannot be used.
    virtual std::vector<Node> nodes(NodeLexicon::NodeType type) = 0;

    // A fresh reading of a node that nodes() of this object returned. A value that cannot be
    // read now is absent, never stale.
    virtual NodeReading read(const Node& node) = 0;
};

} // namespace Vorn
