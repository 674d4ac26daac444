// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// What tells this machine from any other, without giving away what other programs know it by.

#pragma once

#include <array>
#include <cstdint>
#include <optional>
#include <string>

namespace Vorn {

using ApplicationId = std::array<std::uint8_t, 16>;

// The machine's identifier for one application, as the text of a random UUID: the same at every
// start, another one for each application, and no way back to the machine identifier, which
// machine-id(5) asks to keep confidential. It equals what `systemd-id128 machine-id
// --app-specific=APPLICATION --uuid` prints.
//
// Nothing when the file is missing or holds no identifier, as before a first boot is complete.
std::optional<std::string> machineIdFor(
    const ApplicationId& application, const char* file = "/etc/machine-id");

} // namespace Vorn
