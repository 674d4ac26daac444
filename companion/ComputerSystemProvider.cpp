// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The instance provider of ZUMLO_ComputerSystem: one instance, this computer.

#include "companion/ComputerSystemObjects.h"
#include "companion/SingleInstance.h"

namespace Vorn::Companion {

namespace {

struct ThisComputer {
    static constexpr const char* provider = "instanceComputerSystemProvider";
    static constexpr const char* notFound = "no such computer system";

    CMPIObjectPath* path(const CMPIBroker* broker, const CMPIObjectPath* ref) const
    {
        return makePath(broker, ref, system);
    }

    CMPIInstance* instance(
        const CMPIBroker* broker, const CMPIObjectPath* path, const char** properties) const
    {
        return makeInstance(broker, path, system, properties);
    }

    ComputerSystem system = thisComputerSystem();
};

} // namespace

extern "C" [[gnu::visibility("default")]] CMPIInstanceMI* ComputerSystemProvider_Create_InstanceMI(
    const CMPIBroker* broker, const CMPIContext*, CMPIStatus* status)
{
    return SingleInstanceProvider<ThisComputer>::create(broker, status);
}

} // namespace Vorn::Companion
