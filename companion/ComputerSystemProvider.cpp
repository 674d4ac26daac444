// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The instance provider of ZUMLO_ComputerSystem: one instance, this computer.

#include "companion/ComputerSystemObjects.h"
#include "platform/utilities/ProviderUtilities.h"

#include <cmpimacs.h>

#include <atomic>
#include <exception>

namespace Vorn::Companion {

namespace {

// Some object managers call the factory again while requests run.
std::atomic<const CMPIBroker*> theBroker = nullptr;

constexpr CMPIStatus okStatus = {CMPI_RC_OK, nullptr};
constexpr CMPIStatus notSupported = {CMPI_RC_ERR_NOT_SUPPORTED, nullptr};

// Returns the status with a message, or without one where the broker fails to make it.
CMPIStatus failure(const CMPIBroker* broker, CMPIrc code, const char* message)
{
    CMPIString* const string = CMNewString(broker, message, nullptr);
    return {code, isUsable(string) ? string : nullptr};
}

// Calls `work` with this computer and its path. Exceptions become a status, since CMPI has none.
template <typename Work>
CMPIStatus serve(const CMPIObjectPath* ref, const Work& work)
{
    const CMPIBroker* const broker = theBroker;
    try {
        const ComputerSystem system = thisComputerSystem();
        const CMPIObjectPath* const path = makePath(broker, ref, system);
        if (path == nullptr)
            return failure(broker, CMPI_RC_ERR_FAILED, "the object path cannot be made");
        return work(broker, system, path);
    } catch (const std::exception& error) {
        return failure(broker, CMPI_RC_ERR_FAILED, error.what());
    }
}

// Completes the result unless a delivery to it failed.
CMPIStatus closed(const CMPIResult* result, const CMPIStatus& delivery)
{
    return delivery.rc == CMPI_RC_OK ? CMReturnDone(result) : delivery;
}

CMPIStatus returnInstance(const CMPIBroker* broker, const CMPIResult* result,
    const ComputerSystem& system, const CMPIObjectPath* path, const char** properties)
{
    const CMPIInstance* const instance = makeInstance(broker, path, system, properties);
    if (instance == nullptr)
        return failure(broker, CMPI_RC_ERR_FAILED, "the instance cannot be made");
    return closed(result, CMReturnInstance(result, instance));
}

CMPIStatus ComputerSystem_Cleanup(CMPIInstanceMI*, const CMPIContext*, CMPIBoolean)
{
    return okStatus;
}

CMPIStatus ComputerSystem_EnumInstanceNames(
    CMPIInstanceMI*, const CMPIContext*, const CMPIResult* result, const CMPIObjectPath* ref)
{
    return serve(ref, [&](const CMPIBroker*, const ComputerSystem&, const CMPIObjectPath* path) {
        return closed(result, CMReturnObjectPath(result, path));
    });
}

CMPIStatus ComputerSystem_EnumInstances(CMPIInstanceMI*, const CMPIContext*,
    const CMPIResult* result, const CMPIObjectPath* ref, const char** properties)
{
    return serve(ref,
        [&](const CMPIBroker* broker, const ComputerSystem& system, const CMPIObjectPath* path) {
            return returnInstance(broker, result, system, path, properties);
        });
}

CMPIStatus ComputerSystem_GetInstance(CMPIInstanceMI*, const CMPIContext*, const CMPIResult* result,
    const CMPIObjectPath* ref, const char** properties)
{
    return serve(ref,
        [&](const CMPIBroker* broker, const ComputerSystem& system, const CMPIObjectPath* path) {
            if (!isObjPathsEqual(path, ref, false))
                return failure(broker, CMPI_RC_ERR_NOT_FOUND, "no such computer system");
            return returnInstance(broker, result, system, path, properties);
        });
}

CMPIStatus ComputerSystem_CreateInstance(CMPIInstanceMI*, const CMPIContext*, const CMPIResult*,
    const CMPIObjectPath*, const CMPIInstance*)
{
    return notSupported;
}

CMPIStatus ComputerSystem_ModifyInstance(CMPIInstanceMI*, const CMPIContext*, const CMPIResult*,
    const CMPIObjectPath*, const CMPIInstance*, const char**)
{
    return notSupported;
}

CMPIStatus ComputerSystem_DeleteInstance(
    CMPIInstanceMI*, const CMPIContext*, const CMPIResult*, const CMPIObjectPath*)
{
    return notSupported;
}

CMPIStatus ComputerSystem_ExecQuery(CMPIInstanceMI*, const CMPIContext*, const CMPIResult*,
    const CMPIObjectPath*, const char*, const char*)
{
    return notSupported;
}

const CMPIInstanceMIFT handlers = {200, 200, "instanceComputerSystemProvider",
    ComputerSystem_Cleanup, ComputerSystem_EnumInstanceNames, ComputerSystem_EnumInstances,
    ComputerSystem_GetInstance, ComputerSystem_CreateInstance, ComputerSystem_ModifyInstance,
    ComputerSystem_DeleteInstance, ComputerSystem_ExecQuery};

} // namespace

extern "C" [[gnu::visibility("default")]] CMPIInstanceMI* ComputerSystemProvider_Create_InstanceMI(
    const CMPIBroker* broker, const CMPIContext*, CMPIStatus* status)
{
    static CMPIInstanceMI mi = {nullptr, &handlers};
    if (broker == nullptr) {
        CMSetStatus(status, CMPI_RC_ERR_INVALID_PARAMETER);
        return nullptr;
    }
    theBroker = broker;
    return &mi;
}

} // namespace Vorn::Companion
