// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "companion/ComputerSystem.h"

#include "platform/utilities/ProviderUtilities.h"

#include <systemd/sd-id128.h>

#include <array>

namespace Vorn::Companion {

namespace {

// Identifies this provider in the hash. It never changes, or every machine would get a new
// identifier.
constexpr sd_id128_t application = {{0xb3, 0xdf, 0xdc, 0xbb, 0x7a, 0x28, 0x45, 0xc0, 0xb6, 0x17,
    0x6d, 0xa2, 0x1f, 0x2a, 0x76, 0x2d}};

// Returns the machine's identifier for this provider as the text of a UUID: by machine-id(5), the
// identifier itself is confidential. There is none before a first boot is complete.
std::optional<std::string> machineId()
{
    sd_id128_t identifier{};
    if (::sd_id128_get_machine_app_specific(application, &identifier) < 0)
        return std::nullopt;
    std::array<char, SD_ID128_UUID_STRING_MAX> text{};
    return ::sd_id128_to_uuid_string(identifier, text.data());
}

} // namespace

ComputerSystem thisComputerSystem()
{
    return {getSystemName(), machineId()};
}

} // namespace Vorn::Companion
