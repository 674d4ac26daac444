// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// OpenPegasus' stand-in, and what registering in it leaves.

#pragma once

#include "tests/packaging/RegisterTest.h"

#include <string>

namespace OpenPegasusTests {

using namespace Testing;

class OpenPegasusTest : public RegisterTest {
protected:
    OpenPegasusTest() : RegisterTest({"cimmof", "cimprovider", "cimcli"}) {}

    Lines modules() const { return linesOf(contentOf(path("modules"))); }

    Lines classesIn(const std::string& space) const { return filesBelow(path("classes/" + space)); }

    // Returns the line that declares a class in the source that was compiled last.
    std::string definition(const std::string& name) const
    {
        return contentOf(path("classes/root/cimv2/" + name));
    }

    const Lines modules_ = {"SensorProfileModule", "SensorProfileRegistrationModule",
        "SensorProfileComputerSystemModule"};
    const std::string registration_ = shared("registration/sensor-profile-registration.mof");
    const std::string systemStep_ =
        "cimmof -uc -aV -n root/cimv2 " + shared("sensor-profile-computer-system.mof");
    const std::string sensorStep_ = "cimmof -uc -aV -n root/cimv2 " + shared("sensor-profile.mof");
    const std::string conformanceStep_ =
        "cimmof -uc -aV -n root/cimv2 " + shared("sensor-profile-conformance.mof");
    const std::string interopStep_ =
        "cimmof -uc -aV -n root/PG_InterOp " + shared("sensor-profile-conformance.mof");
    const std::string profileStep_ =
        "cimmof -uc -aV -n root/PG_InterOp " + shared("sensor-profile-registered-profile.mof");
    const std::string addingStep_ =
        "cimmof -w -n root/cimv2 " + shared("sensor-profile-computer-system.mof");
    const std::string registrationStep_ = "cimmof -n root/PG_InterOp " + registration_;
    const std::string namespaceQuery_ =
        "cimcli gp PG_ProviderCapabilities.ProviderModuleName=\"SensorProfileModule\","
        "ProviderName=\"SensorProfileProvider\",CapabilityID=\"1\" Namespaces -n root/PG_InterOp";
};

} // namespace OpenPegasusTests
