// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The status codes of the hardware model that sources report.

#pragma once

namespace Vorn::NodeStatus {

inline constexpr unsigned normal = 1;
inline constexpr unsigned lostCommunication = 13;
inline constexpr unsigned disabled = 16;
inline constexpr unsigned noContact = 17;
inline constexpr unsigned warning = 21;
inline constexpr unsigned warningLow = 22;
inline constexpr unsigned warningHigh = 23;
inline constexpr unsigned criticalLow = 25;
inline constexpr unsigned criticalHigh = 26;

} // namespace Vorn::NodeStatus
