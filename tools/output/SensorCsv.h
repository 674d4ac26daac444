// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "tools/output/Output.h"
#include "tools/sensors/SensorList.h"

namespace Tools {

// Writes a line of titles and a line for each sensor (RFC 4180, but lines end in a line feed). The
// text is UTF-8; fields without a value are empty.
void writeCsv(Output& out, const Sensors& sensors);

} // namespace Tools
