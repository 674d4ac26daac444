// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Requests side by side over one broker.

#include "host/broker/ClassInformation.h"
#include "host/broker/CollectedResult.h"
#include "host/broker/Instance.h"
#include "host/broker/Result.h"
#include "tests/host/broker/BrokerTest.h"

#include <atomic>
#include <thread>
#include <vector>

namespace HostTests {

TEST(ConcurrencyTest, EightThreadsRunRequestsAtOnce)
{
    Host::ClassTable classes;
    classes.add("Test_Class", {"DeviceID"});
    std::atomic<int> traced = 0;
    Host::Broker broker;
    broker.setClassInformation(&classes);
    broker.setTraceObserver([&](const Host::TraceMessage&) { ++traced; });
    const CMPIBroker* const mb = broker.handle();

    const auto work = [&](int number) {
        const std::string principal = "principal" + std::to_string(number);
        for (int round = 0; round < 50; ++round) {
            Host::Request request(broker, {.principal = principal});
            Host::CollectedResult collected;
            Host::Result result(collected);
            CMPIObjectPath* const path = CMNewObjectPath(mb, "root/cimv2", "Test_Class", nullptr);
            for (int i = 0; i < 20; ++i) {
                CMPIInstance* const made = CMNewInstance(mb, path, nullptr);
                CMSetProperty(made, "DeviceID", principal.c_str(), CMPI_chars);
                CMSetProperty(made, "N", &i, CMPI_sint32);
                CMReturnInstance(result.handle(), made);
            }
            CMTraceMessage(mb, CMPI_LEV_VERBOSE, "Test", principal.c_str(), nullptr);
            CMPIObjectPath* const clone = CMClone(path, nullptr);
            CMRelease(clone);
            ASSERT_EQ(collected.instances().size(), 20U);
            for (const Host::Instance* const delivered : collected.instances())
                EXPECT_EQ(delivered->objectPath().key("DeviceID")->text(), principal);
        }
    };
    std::vector<std::thread> threads;
    for (int number = 0; number < 8; ++number)
        threads.emplace_back(work, number);
    for (std::thread& thread : threads)
        thread.join();
    EXPECT_EQ(traced, 8 * 50);
}

} // namespace HostTests
