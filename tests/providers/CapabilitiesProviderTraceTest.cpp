// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The trace lines of whole requests of the capabilities class.

#include "tests/providers/Factories.h"
#include "tests/providers/RequestTrace.h"
#include "tests/support/FaultyBroker.h"

#include <gmock/gmock.h>

namespace CapabilitiesProviderTraceTests {

using ::testing::ElementsAreArray;
using namespace Testing;

constexpr const char* Class = "ZUMLO_SensorEnabledLogicalElementCapabilities";
constexpr const char* firstIdentifier = "ZUMLO:SensorEnabledLogicalElementCap1";

HandlerLines handler(const std::string& request)
{
    const std::string module = "SensorEnabledLogicalElementCapabilitiesProvider";
    return {module, module, "SensorEnabledLogicalElementCapabilities_" + request};
}

const Lines builtLines = builtFactory({"_createEnabledLogicalElementCapMap"});
const Lines instanceLines = operation("makeSensorEnabledLogicalElementCapInstance", 863, 965);
const Lines instanceRequest =
    operation("getAllSensorEnabledLogicalElementCapCMPIInstances", 996, 1017);
const std::string oneInstance = "getOneSensorEnabledLogicalElementCapCMPIInstance";
const std::string pathLines = "getAllSensorEnabledLogicalElementCapCMPIObjPaths";

class CapabilitiesProviderTraceTest : public ProviderTest {
protected:
    CapabilitiesProviderTraceTest()
        : machine_({{Vorn::NodeLexicon::NodeType::Tachometer, "/f", "Fan", Vorn::NodeReading{}}})
    {
        use(broker());
    }

    void use(const CMPIBroker* broker)
    {
        mi_ = SensorEnabledLogicalElementCapabilitiesProvider_Create_InstanceMI(
            broker, nullptr, nullptr);
    }

    Lines traceOfNames()
    {
        const CMPIObjectPath* const ref = path(Class).handle();
        return traceOf([&] { mi_->ft->enumerateInstanceNames(mi_, context(), result(), ref); });
    }

    Lines traceOfInstances()
    {
        const CMPIObjectPath* const ref = path(Class).handle();
        return traceOf(
            [&] { mi_->ft->enumerateInstances(mi_, context(), result(), ref, nullptr); });
    }

    Lines traceOfOne(const std::vector<std::pair<std::string, std::string>>& keys)
    {
        const CMPIObjectPath* const ref = path(Class, keys).handle();
        return traceOf([&] { mi_->ft->getInstance(mi_, context(), result(), ref, nullptr); });
    }

    ScriptedMachine machine_;
    CMPIInstanceMI* mi_;
};

TEST_F(CapabilitiesProviderTraceTest, OfEnumeratedNames)
{
    const HandlerLines lines = handler("EnumInstanceNames");
    EXPECT_THAT(traceOfNames(), ElementsAreArray(sequence({lines.entry(74), builtLines,
                                    operation(pathLines, 1041, 1093), lines.exit(114)})));
}

TEST_F(CapabilitiesProviderTraceTest, OfNamesThatCannotBeMade)
{
    const HandlerLines lines = handler("EnumInstanceNames");
    FaultyBroker faulty(broker_);
    faulty.plan({BrokerCall::newObjectPath, 1, FaultManner::nullResult});
    use(faulty.handle());
    EXPECT_THAT(traceOfNames(),
        ElementsAreArray(sequence({lines.entry(74), builtLines, brokenOff(pathLines, 1041),
            lines.failure(pathLines + " failed", 90), lines.exit(92)})));
    EXPECT_FALSE(answer_.isDone());
}

TEST_F(CapabilitiesProviderTraceTest, OfEnumeratedInstances)
{
    const HandlerLines lines = handler("EnumInstances");
    EXPECT_THAT(traceOfInstances(), ElementsAreArray(sequence({lines.entry(137), builtLines,
                                        around(instanceRequest, instanceLines), lines.exit(169)})));
}

TEST_F(CapabilitiesProviderTraceTest, OfAnInstanceFound)
{
    const HandlerLines lines = handler("GetInstance");
    EXPECT_THAT(traceOfOne({{"InstanceID", firstIdentifier}}),
        ElementsAreArray(sequence({lines.entry(191), builtLines,
            around(operation(oneInstance, 1134, 1158), instanceLines), lines.exit(283)})));
}

TEST_F(CapabilitiesProviderTraceTest, OfAnInstanceNotFound)
{
    const HandlerLines lines = handler("GetInstance");
    EXPECT_THAT(traceOfOne({{"InstanceID", "other"}}),
        ElementsAreArray(sequence({lines.entry(191), builtLines, brokenOff(oneInstance, 1134),
            lines.failure(oneInstance + " failed", 215), lines.exit(217)})));
}

// The request searches the capabilities of a factory that has only sensors.
TEST_F(CapabilitiesProviderTraceTest, OfAnInstanceSearchedByItsPath)
{
    const HandlerLines lines = handler("GetInstance");
    EXPECT_THAT(traceOfOne({{"Other", "x"}}),
        ElementsAreArray(sequence({lines.entry(191), builtFactory({"_createSensorMap"}),
            instanceRequest, lines.exit(283)})));
}

TEST_F(CapabilitiesProviderTraceTest, OfARequestWithoutKeysHasNoFactory)
{
    const HandlerLines lines = handler("GetInstance");
    EXPECT_THAT(traceOfOne({}), ElementsAreArray(sequence({lines.entry(191), lines.exit(283)})));
}

} // namespace CapabilitiesProviderTraceTests
