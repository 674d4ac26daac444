// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Reads the text of a model file.

#pragma once

#include "platform/instrumentation/model/Model.h"

#include <string_view>
#include <vector>

namespace Vorn {

// The nodes in the order of the text. Takes memory and time in proportion to the text, whatever
// it holds; nesting is refused where the format has none. May be called from any thread.
// Throws std::runtime_error: for what is no JSON with line and column, for JSON of another shape
// with the JSON pointer (RFC 6901) of the value, and with what was expected there and found.
std::vector<ModelNode> readModel(std::string_view text);

} // namespace Vorn
