// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Writes a model file.

#pragma once

#include "platform/instrumentation/model/Model.h"

#include <string>
#include <vector>

namespace Vorn {

// One line per node, in the order given, members always in the same order; numbers in the
// shortest form that reads back as the same double. A value that a node lacks, or that is not
// finite, is left out. Bytes that are no UTF-8 become U+FFFD.
std::string writeModel(const std::vector<ModelNode>& nodes);

} // namespace Vorn
