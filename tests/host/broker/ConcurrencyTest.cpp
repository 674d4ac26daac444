// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Requests on many threads with one broker, mainly for the thread sanitizer.

#include "host/broker/Instance.h"
#include "host/broker/Result.h"
#include "tests/host/broker/BrokerTest.h"
#include "tests/support/ClassTable.h"

#include <thread>
#include <vector>

namespace HostTests {

TEST(ConcurrencyTest, EightThreadsRunRequestsAtOnce)
{
    Testing::ClassTable classes;
    classes.add("Test_Class", {"DeviceID"});
    Host::Broker broker;
    broker.setClassInformation(&classes);
    const CMPIBroker* const mb = broker.handle();

    const auto work = [&](int number) {
        const std::string id = "device" + std::to_string(number);
        for (int round = 0; round < 50; ++round) {
            Host::Request request(broker);
            Host::CollectedResult collected;
            Host::Result result(collected);
            CMPIObjectPath* const path = CMNewObjectPath(mb, "root/cimv2", "Test_Class", nullptr);
            for (int i = 0; i < 20; ++i) {
                CMPIInstance* const made = CMNewInstance(mb, path, nullptr);
                CMSetProperty(made, "DeviceID", id.c_str(), CMPI_chars);
                CMSetProperty(made, "N", &i, CMPI_sint32);
                CMReturnInstance(result.handle(), made);
            }
            CMTraceMessage(mb, CMPI_LEV_VERBOSE, "Test", id.c_str(), nullptr);
            ASSERT_EQ(collected.instances().size(), 20U);
            for (const Host::Instance* const delivered : collected.instances())
                EXPECT_EQ(delivered->objectPath().key("DeviceID")->text(), id);
        }
    };
    std::vector<std::thread> threads;
    for (int number = 0; number < 8; ++number)
        threads.emplace_back(work, number);
    for (std::thread& thread : threads)
        thread.join();
}

} // namespace HostTests
