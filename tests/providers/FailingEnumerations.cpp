// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Enumerations that fail or return several capabilities instances. They replace the factory's,
// which never do.

#include "tests/providers/FailingEnumerations.h"

#include "factory/BrokerCalls.h"
#include "factory/ClassNames.h"
#include "factory/SensorFactory.h"

#include <array>

namespace Vorn::SensorProfileProvider {

namespace {

int fail(std::vector<CMPIInstance*>& instances, CMPIStatus* rc)
{
    instances.push_back(nullptr); // not to be returned to the client
    *rc = {Testing::failedEnumeration, nullptr};
    return 1;
}

} // namespace

int SensorFactory::getAllSensorCMPIInstances(const CMPIBroker*, const CMPIObjectPath*, const char**,
    bool, std::vector<CMPIInstance*>& instances, CMPIStatus* rc)
{
    return fail(instances, rc);
}

int SensorFactory::getAllSensorEnabledLogicalElementCapCMPIInstances(const CMPIBroker*,
    const CMPIObjectPath*, const char**, bool, std::vector<CMPIInstance*>& instances,
    CMPIStatus* rc)
{
    return fail(instances, rc);
}

// The other functions of the replaced files. The enumerations of paths return two paths for each
// class.

namespace {

int addPaths(const CMPIBroker* broker, const CMPIObjectPath* ref, const char* className,
    const char* key, const std::array<const char*, 2>& names, std::vector<CMPIObjectPath*>& paths)
{
    for (const char* const name : names) {
        paths.push_back(newPath(broker, ref, className, "host", nullptr));
        addTextKey(paths.back(), key, name);
    }
    return 0;
}

} // namespace

int SensorFactory::getOneSensorCMPIInstance(const CMPIBroker*, const CMPIObjectPath*, CMPIString*,
    const char**, std::vector<CMPIInstance*>&, CMPIStatus*)
{
    return 1;
}

int SensorFactory::getAllSensorCMPIObjPaths(const CMPIBroker* broker, const CMPIObjectPath* ref,
    std::vector<CMPIObjectPath*>& paths, CMPIStatus*)
{
    return addPaths(broker, ref, SensorClass, "DeviceID", {"A", "B"}, paths);
}

int SensorFactory::getOneSensorEnabledLogicalElementCapCMPIInstance(const CMPIBroker*,
    const CMPIObjectPath*, CMPIString*, const char**, std::vector<CMPIInstance*>&, CMPIStatus*)
{
    return 1;
}

int SensorFactory::getAllSensorEnabledLogicalElementCapCMPIObjPaths(const CMPIBroker* broker,
    const CMPIObjectPath* ref, std::vector<CMPIObjectPath*>& paths, CMPIStatus*)
{
    if (Testing::capabilitiesPathsResult != 0)
        return Testing::capabilitiesPathsResult;
    return addPaths(
        broker, ref, SensorEnabledLogicalElementCapClass, "InstanceID", {"1", "2"}, paths);
}

} // namespace Vorn::SensorProfileProvider
