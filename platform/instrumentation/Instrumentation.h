// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// A cursor over the sensor nodes of the present machine.

#pragma once

#include "platform/instrumentation/NodeLexicon.h"

#include <memory>
#include <string>
#include <vector>

namespace Vorn {

// Readings are taken afresh when the cursor stands on a node and is asked for the first time;
// status and properties of one visit belong together. Throws standard exceptions only; a
// source that cannot be used throws a std::runtime_error that says where and why, from the
// constructor or from selectNode(), and is reported once on the log channel.
// A cursor is used by one thread; any number of cursors may be in use at once.
class Instrumentation {
public:
    // Over the sources that VORN_INSTRUMENTATION names ("hwmon" when it is not set).
    Instrumentation();
    ~Instrumentation();
    Instrumentation(const Instrumentation&) = delete;
    Instrumentation& operator=(const Instrumentation&) = delete;

    // Stands on the first node of the type, if there is one.
    void selectNode(NodeLexicon::NodeType type);

    // True while the cursor stands on a node of the selected type.
    explicit operator bool() const noexcept;

    // To the next node of the selected type. REQUIRES: the cursor stands on a node, as for
    // all that follow.
    Instrumentation& operator++();

    std::string getPathToNode() const;
    // The printable form of a path.
    std::string convertPathToString(const std::string& path) const;
    std::string getNodeDescription() const;
    unsigned getSensorType() const;
    unsigned getNodeStatus();

    // True and the value stored when the node has the property with a value of that kind;
    // otherwise false and the value untouched.
    bool getProperty(NodeLexicon::Properties property, double& value);
    bool getProperty(NodeLexicon::Properties property, unsigned& value);
    bool getProperty(NodeLexicon::Properties property, std::vector<unsigned>& value);

private:
    struct State;
    std::unique_ptr<State> state_;
};

} // namespace Vorn
