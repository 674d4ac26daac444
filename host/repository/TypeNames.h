// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The names that DSP0004 gives the data types of CIM.

#pragma once

#include <cmpidt.h>

#include <string>
#include <string_view>

namespace Host {

// Returns the type of that name in any letter case, CMPI_null when there is none.
CMPIType dataTypeNamed(std::string_view name);

// Returns the name as MOF writes it, such as `uint16[]`; `ref` for a reference.
std::string nameOfType(CMPIType type);

} // namespace Host
