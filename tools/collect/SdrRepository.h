// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The repository of sensor data records (IPMI 2.0, section 33).

#pragma once

#include "tools/collect/Bmc.h"
#include "tools/collect/SensorRecord.h"

#include <vector>

namespace Ipmi {

// Identifies a state of the repository: the number of records and the times of the last addition
// and erasure, as the BMC returns them.
using RepositoryStamp = Bytes;

// Throws std::runtime_error where there is no repository, and what Bmc::ask() throws.
RepositoryStamp stampOfRepository(Bmc& bmc);

// Returns the records of analog sensors in the order of the repository. Throws std::runtime_error
// when it cannot be read, and what Bmc::ask() throws.
std::vector<SensorRecord> readRepository(Bmc& bmc);

} // namespace Ipmi
