// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The objects associated with one object, as a tree.

#pragma once

#include "tools/cim/AssociationGraph.h"
#include "tools/output/Output.h"
#include "tools/output/TextStyle.h"

namespace Tools {

// Writes a line for the root with its class, and below each object a line for each object that is
// one association further from the root, with the role and the class of the association. The
// subtree of an object is written at its first occurrence only, and once for all objects below
// another one when it is the same below each. The other objects with the role of the one above are
// counted in a line where nothing is below them. An association between two objects at the same
// distance is written at both.
void writeTree(Output& out, const AssociationGraph& graph, AssociationGraph::Index root,
    const TextStyle& style);

} // namespace Tools
