// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "companion/ComputerSystem.h"

#include "platform/identity/MachineIdentity.h"
#include "platform/utilities/ProviderUtilities.h"

namespace Vorn::Companion {

namespace {

// Stands for this provider. Never changes, or every machine would get a new identifier.
constexpr ApplicationId application = {
    0xb3, 0xdf, 0xdc, 0xbb, 0x7a, 0x28, 0x45, 0xc0, 0xb6, 0x17, 0x6d, 0xa2, 0x1f, 0x2a, 0x76, 0x2d};

} // namespace

ComputerSystem thisComputerSystem()
{
    return {getSystemName(), machineIdFor(application)};
}

} // namespace Vorn::Companion
