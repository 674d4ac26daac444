// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The objects around one object as a tree.

#pragma once

#include "tools/cim/AssociationGraph.h"
#include "tools/output/Output.h"

#include <cstddef>

namespace Tools {

struct TreeStyle {
    std::size_t width;
    bool isColored;
    bool isUtf8; // tree lines are drawn; else they are put together from ASCII
};

// The root with its class, and below each object those that are one association further from
// the root, with the role and the class of the association, a line each. What lies below an
// object is shown where the object comes first; after that the object is only named. The
// association between two objects that are equally far is named at both.
void writeTree(Output& out, const AssociationGraph& graph, AssociationGraph::Index root,
    const TreeStyle& style);

} // namespace Tools
