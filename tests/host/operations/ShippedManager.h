// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The object manager with the shipped classes and providers, on a small machine.

#pragma once

#include "host/manager/SensorProfile.h"
#include "host/operations/ObjectManager.h"
#include "tests/host/operations/OperationsTest.h"
#include "tests/support/Environment.h"
#include "tests/support/ShippedClasses.h"

namespace OperationTests {

class ShippedManager {
public:
    explicit ShippedManager(const Host::OperationLimits& limits = {})
        : manager_(
              classes(),
              Host::registeredProfileProviders(SENSOR_PROFILE_BINARY_DIR
                  "/lib/libSensorProfileProvider.so",
                  SENSOR_PROFILE_BINARY_DIR "/lib/libSensorProfileComputerSystem.so"),
              [] { return std::string("host.example"); }, limits)
    {
    }

    OperationHandler& operator*() { return manager_; }

private:
    static const Host::Repository& classes()
    {
        static const auto compiled = Testing::shippedClasses();
        return *compiled;
    }

    Testing::EnvironmentVariable machine_{"VORN_INSTRUMENTATION",
        "model:" SENSOR_PROFILE_SOURCE_DIR "/tests/data/cimxml/machine.json"};
    Host::ObjectManager manager_;
};

} // namespace OperationTests
