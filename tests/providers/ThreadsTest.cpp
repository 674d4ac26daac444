// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// An object manager creates an association MI for the first request along associations, while other
// requests to the same module run.

#include "host/broker/Broker.h"
#include "host/broker/CollectedResult.h"
#include "host/broker/ObjectPath.h"
#include "host/broker/Request.h"
#include "host/broker/Result.h"
#include "tests/providers/Factories.h"
#include "tests/support/ScriptedMachine.h"

#include <gtest/gtest.h>

#include <thread>

namespace ThreadsTests {

using Vorn::NodeLexicon::NodeType;

TEST(ProviderThreadsTest, AFactoryMayRunBesideRequests)
{
    const Testing::ScriptedMachine machine({{NodeType::Temperature, "/temp1", "CPU"}});
    const Host::Broker broker;
    CMPIInstanceMI* const mi =
        SensorElementCapabilitiesProvider_Create_InstanceMI(broker.handle(), nullptr, nullptr);
    const std::jthread maker([&](const std::stop_token& stop) {
        while (!stop.stop_requested())
            SensorElementCapabilitiesProvider_Create_AssociationMI(
                broker.handle(), nullptr, nullptr);
    });
    for (int i = 0; i < 200; ++i) {
        Host::Request request(broker);
        Host::CollectedResult answer;
        Host::Result result(answer);
        mi->ft->enumerateInstanceNames(mi, request.context().handle(), result.handle(),
            request.makePath("root/cimv2", "ZUMLO_SensorElementCapabilities").handle());
        ASSERT_EQ(answer.paths().size(), 1U);
    }
}

} // namespace ThreadsTests
