// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The line numbers in the harvest's trace lines. Monitoring scripts match them, so they are an
// interface: they do not follow the source.

#pragma once

#include "diagnostics/TracedOperation.h"

namespace Vorn::SensorProfileProvider::HarvestLines {

inline constexpr OperationLines getSensorInstances = {.entry = 668, .exit = 732};
inline constexpr OperationLines setVector = {.entry = 740, .exit = 920};
inline constexpr OperationLines getSensorEnabledLogCapInstances = {.entry = 639, .exit = 660};
inline constexpr unsigned getSensorEnabledLogCapInstancesFailed = 654;

} // namespace Vorn::SensorProfileProvider::HarvestLines
