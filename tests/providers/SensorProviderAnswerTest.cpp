// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The ends of requests of ZUMLO_NumericSensor: instances found by the whole path, results closed
// before the exit mark, and exceptions.

#include "tests/providers/ClosingResult.h"
#include "tests/providers/Factories.h"
#include "tests/support/FaultyBroker.h"
#include "tests/support/ProviderTest.h"
#include "tests/support/WatchedMachine.h"

#include <gmock/gmock.h>

#include <functional>

namespace SensorProviderAnswerTests {

using namespace Testing;
using namespace ::testing;
using Vorn::NodeReading;
using Vorn::NodeLexicon::NodeType;

constexpr const char* Class = "ZUMLO_NumericSensor";
const std::vector<ScriptedNode> threeSensors = {{NodeType::Temperature, "/t", "CPU", NodeReading{}},
    {NodeType::Voltage, "/v", "Core", NodeReading{}},
    {NodeType::Tachometer, "/f", "Fan", NodeReading{}}};

class SensorProviderAnswerTest : public ProviderTest {
protected:
    Host::ObjectPath& wholePath(const std::string& deviceID)
    {
        Host::ObjectPath& made = path(Class,
            {{"CreationClassName", Class}, {"DeviceID", deviceID},
                {"SystemCreationClassName", "ZUMLO_ComputerSystem"}, {"SystemName", systemName_}});
        made.setHost(systemName_.c_str());
        return made;
    }

    // Returns every kind of request, including those that fail early.
    std::vector<std::function<CMPIStatus(const CMPIResult*)>> requests()
    {
        CMPIInstanceMI* const mi =
            SensorProfileProvider_Create_InstanceMI(broker(), nullptr, nullptr);
        const auto get = [this, mi](const CMPIObjectPath* ref) {
            return [this, mi, ref](const CMPIResult* into) {
                return mi->ft->getInstance(mi, context(), into, ref, nullptr);
            };
        };
        return {
            [this, mi](const CMPIResult* into) {
                return mi->ft->enumerateInstanceNames(mi, context(), into, path(Class).handle());
            },
            [this, mi](const CMPIResult* into) {
                return mi->ft->enumerateInstances(
                    mi, context(), into, path(Class).handle(), nullptr);
            },
            get(path(Class, {{"DeviceID", "Fan:/f"}}).handle()),
            get(path(Class, {{"Other", "x"}}).handle()),
        };
    }
};

// ---- Found by the whole path ----

// The broker fails to return the key DeviceID by its name.
class SearchTest : public SensorProviderAnswerTest {
protected:
    void get(const std::string& deviceID, const char** properties = nullptr)
    {
        const ScriptedMachine machine(threeSensors);
        Testing::FaultyBroker faulty(broker_);
        CMPIInstanceMI* const mi =
            SensorProfileProvider_Create_InstanceMI(faulty.handle(), nullptr, nullptr);
        const CMPIObjectPath* const ref = faulty.watch(wholePath(deviceID).handle());
        faulty.plan({BrokerCall::getKey, 1, FaultManner::nullResult});
        status_ = mi->ft->getInstance(mi, context(), result(), ref, properties);
        EXPECT_EQ(faulty.fired(), 1U);
    }

    CMPIStatus status_ = {CMPI_RC_ERR_FAILED, nullptr};
};

TEST_F(SearchTest, TheInstanceWhosePathEqualsTheRequestsIsReturnedOnce)
{
    get("Core:/v");
    EXPECT_EQ(status_.rc, CMPI_RC_OK);
    ASSERT_EQ(answer_.instances().size(), 1U);
    EXPECT_EQ(property(*answer_.instances()[0], "DeviceID"), "string \"Core:/v\"");
    EXPECT_EQ(property(*answer_.instances()[0], "SensorType"), "uint16 3");
    EXPECT_EQ(answer_.refused(), 0U);
    EXPECT_TRUE(answer_.isDone());
}

TEST_F(SearchTest, TheInstanceFoundHasThePropertiesOfTheList)
{
    const char* properties[] = {"Name", nullptr};
    get("Core:/v", properties);
    ASSERT_EQ(answer_.instances().size(), 1U);
    EXPECT_THAT(Testing::namesOf(answer_.instances()[0]->properties()),
        ElementsAre(
            "CreationClassName", "DeviceID", "SystemCreationClassName", "SystemName", "Name"));
}

TEST_F(SearchTest, NoInstanceIsFoundByThePathOfNone)
{
    get("Core:/other");
    EXPECT_EQ(status_.rc, CMPI_RC_OK);
    EXPECT_TRUE(answer_.instances().empty());
    EXPECT_TRUE(answer_.isDone());
}

// ---- Results closed before the exit mark ----

TEST_F(SensorProviderAnswerTest, TheResultIsClosedBetweenTheMarks)
{
    const ScriptedMachine machine(threeSensors);
    auto all = requests();
    CMPIInstanceMI* const mi = SensorProfileProvider_Create_InstanceMI(broker(), nullptr, nullptr);
    all.push_back([this, mi](const CMPIResult* into) { // a path without keys
        return mi->ft->getInstance(mi, context(), into, path(Class).handle(), nullptr);
    });
    for (const auto& request : all) {
        const LogCapture capture;
        const ClosingResult closing(capture);
        request(closing.handle());
        EXPECT_TRUE(closing.answer.isDone());
        EXPECT_GE(closing.linesBefore.size(), 2U);
        EXPECT_THAT(closing.linesBefore, Not(Contains(::testing::Truly(isExitMark))));
        EXPECT_THAT(capture.log(), Contains(::testing::Truly(isExitMark)));
    }
}

// ---- Exceptions ----

TEST_F(SensorProviderAnswerTest, AnExceptionThatIsNoStandardOneLeavesWithoutAnExitMark)
{
    const Testing::WatchedMachine machine([] { throw Testing::StrangeException(); });
    for (const auto& request : requests()) {
        const LogCapture capture;
        EXPECT_THROW(request(result()), Testing::StrangeException);
        const auto lines = capture.log();
        ASSERT_GE(lines.size(), 2U);
        EXPECT_EQ(lines[0].function, "markProviderEntry");
        EXPECT_THAT(lines, Not(Contains(::testing::Truly(isExitMark))));
        EXPECT_FALSE(answer_.isDone());
        EXPECT_EQ(machine.cursorsLeft(), 0U);
    }
}

} // namespace SensorProviderAnswerTests
