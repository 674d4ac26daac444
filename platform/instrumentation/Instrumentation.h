// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// A cursor over the sensor nodes of this machine.

#pragma once

#include "platform/instrumentation/NodeLexicon.h"

#include <memory>
#include <string>
#include <vector>

namespace Vorn {

// A cursor reads a node once for each visit, when its status or a property is first requested, so
// that status and properties of one visit belong together. Throws standard exceptions only; a
// source that cannot be used throws a std::runtime_error that says where and why, from the
// constructor or from selectNode(), and is reported once on the log channel.
// Where other sources have nodes of any type, one that cannot be used is only reported.
// Not thread-safe; any number of cursors may be in use at once.
class Instrumentation {
public:
    // The default of VORN_INSTRUMENTATION.
    static constexpr const char* defaultSources = "hwmon,ipmi";

    // Opens the sources that VORN_INSTRUMENTATION names.
    Instrumentation();
    ~Instrumentation();
    Instrumentation(const Instrumentation&) = delete;
    Instrumentation& operator=(const Instrumentation&) = delete;

    // Moves the cursor to the first node of the type, if there is one.
    void selectNode(NodeLexicon::NodeType type);

    // Returns whether the cursor is on a node of the selected type.
    explicit operator bool() const noexcept;

    // Moves to the next node of the selected type. REQUIRES: the cursor is on a node, as for all
    // that follow.
    Instrumentation& operator++();

    std::string getPathToNode() const;
    // Returns the printable form of a path.
    std::string convertPathToString(const std::string& path) const;
    std::string getNodeDescription() const;
    unsigned getSensorType() const;
    unsigned getNodeStatus();

    // Stores the value and returns true when the node has the property with a value of that kind;
    // otherwise returns false and leaves `value` as it is.
    bool getProperty(NodeLexicon::Properties property, double& value);
    bool getProperty(NodeLexicon::Properties property, unsigned& value);
    bool getProperty(NodeLexicon::Properties property, std::vector<unsigned>& value);

private:
    struct State;
    std::unique_ptr<State> state_;
};

} // namespace Vorn
