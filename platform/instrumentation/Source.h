// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The interface of the sources of Vorn::Instrumentation: a source lists and reads the sensor nodes
// of one kind of hardware description, the kernel's hwmon interface or a model file.

#pragma once

#include "platform/instrumentation/NodeLexicon.h"

#include <cstddef>
#include <optional>
#include <string>
#include <vector>

namespace Vorn {

// One sensor in the list of a source.
struct Node {
    std::string path;        // unique in the machine and the same after a restart
    std::string description; // UTF-8, the name that is shown
    unsigned sensorType = 0; // a NodeLexicon::NodeType number, or a code of the source's own
    std::size_t token = 0;   // identifies the node when the source reads it
};

// The status and the values of one node at one moment. A value the node does not have is absent.
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

// Belongs to one cursor and is used by one thread at a time; state that objects of a source share
// is synchronised by the source.
class Source {
public:
    virtual ~Source() = default;

    // Returns the nodes of one type, in the source's own order. They live until the next call.
    // Throws std::runtime_error naming the file, line or chip when it cannot be used.
    virtual const std::vector<Node>& nodes(NodeLexicon::NodeType type) = 0;

    // Reads a node that the last call of nodes() returned. A value that cannot be read now is
    // absent, never an earlier one. The reading lives until the next call of either function.
    virtual const NodeReading& read(const Node& node) = 0;
};

} // namespace Vorn
