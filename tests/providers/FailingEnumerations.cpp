// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Enumerations of instances that fail, in place of the factory's own, which never do.

#include "tests/providers/FailingEnumerations.h"
#include "factory/SensorFactory.h"

namespace Vorn::SensorProfileProvider {

namespace {

int fail(std::vector<CMPIInstance*>& instances, CMPIStatus* rc)
{
    instances.push_back(nullptr); // to be returned to nobody
    *rc = {Testing::FailedEnumeration, nullptr};
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

// What else those files of the factory hold; the tests do not ask for it.

int SensorFactory::getOneSensorCMPIInstance(const CMPIBroker*, const CMPIObjectPath*, CMPIString*,
    const char**, std::vector<CMPIInstance*>&, CMPIStatus*)
{
    return 1;
}

int SensorFactory::getAllSensorCMPIObjPaths(
    const CMPIBroker*, const CMPIObjectPath*, std::vector<CMPIObjectPath*>&, CMPIStatus*)
{
    return 1;
}

int SensorFactory::getOneSensorEnabledLogicalElementCapCMPIInstance(const CMPIBroker*,
    const CMPIObjectPath*, CMPIString*, const char**, std::vector<CMPIInstance*>&, CMPIStatus*)
{
    return 1;
}

int SensorFactory::getAllSensorEnabledLogicalElementCapCMPIObjPaths(
    const CMPIBroker*, const CMPIObjectPath*, std::vector<CMPIObjectPath*>&, CMPIStatus*)
{
    return 1;
}

} // namespace Vorn::SensorProfileProvider
