// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The entering and exiting lines of the factory's operations, with their parameters.

#include "factory/SensorFactory.h"
#include "tests/support/ProviderTest.h"

#include <gmock/gmock.h>

#include <regex>
#include <sstream>

namespace FactoryTraceTests {

using namespace Vorn::SensorProfileProvider;
using namespace Testing;
using namespace ::testing;

// Returns a parameter list as the operation prints it.
template <typename... LabelsAndValues>
std::string listOf(const LabelsAndValues&... items)
{
    std::ostringstream out;
    (out << ... << items);
    return out.str();
}

class FactoryTraceTest : public ProviderTest {
protected:
    // Expects the entering and exiting line of an operation. A line number of 0 stands for that of
    // the source. The address of a record is not compared, since a builder takes its record by
    // value.
    static void expectTraced(const LogCapture& capture, const std::string& operation,
        unsigned entry, unsigned exit, const std::string& parameters)
    {
        static const std::regex record(" (snsr|snsrCap)=0x[0-9a-f]+");
        std::vector<std::string> texts;
        std::vector<unsigned> lines;
        for (const LogLine& line : capture.log())
            if (line.function == operation) {
                EXPECT_EQ(line.file, "SensorFactory");
                EXPECT_EQ(line.level, 3000);
                texts.push_back(std::regex_replace(line.text, record, " $1=RECORD"));
                lines.push_back(line.line);
            }
        ASSERT_EQ(lines.size(), 2U) << operation;
        if (entry != 0) {
            EXPECT_THAT(lines, ElementsAre(entry, exit));
        }
        const auto text = [&](const std::string& mark, unsigned line) {
            return mark + ": " + operation + "() in SensorFactory [Line: " + std::to_string(line) +
                   "],Parameters List: " + parameters;
        };
        EXPECT_THAT(texts, ElementsAre(text("ENTERING", lines[0]), text("EXITING", lines[1])));
    }

    const ScriptedMachine machine_{{{Vorn::NodeLexicon::NodeType::Tachometer, "/f", "Fan", {}}}};
    SensorFactory factory_{true, true};
    const CMPIObjectPath* ref_ = path("ANY_Class").handle();
    const char* names_[2] = {"Name", nullptr};
    const char** properties_ = names_;
    std::vector<CMPIInstance*> instances_;
    std::vector<CMPIObjectPath*> paths_;
    CMPIStatus rc_ = {CMPI_RC_OK, nullptr};
};

// The parameter is whether instances are enumerated for their object paths.
class FactoryInstancesTraceTest : public FactoryTraceTest,
                                  public ::testing::WithParamInterface<bool> {};

INSTANTIATE_TEST_SUITE_P(IsObjPath, FactoryInstancesTraceTest, ::testing::Bool());

TEST_P(FactoryInstancesTraceTest, ShowsASensorInstance)
{
    const LogCapture capture;
    factory_.makeSensorInstance(broker(), ref_, Sensor(), properties_, GetParam(), &rc_);
    expectTraced(capture, "makeSensorInstance", 269, 737,
        listOf(" broker=", broker(), " ref=", ref_, " snsr=RECORD properties=", properties_,
            " isObjPath=", GetParam(), " rc=", &rc_));
}

// The last label has no leading blank.
TEST_P(FactoryInstancesTraceTest, ShowsAllSensorInstances)
{
    const LogCapture capture;
    factory_.getAllSensorCMPIInstances(broker(), ref_, properties_, GetParam(), instances_, &rc_);
    expectTraced(capture, "getAllSensorCMPIInstances", 0, 0,
        listOf(" broker=", broker(), " ref=", ref_, " properties=", properties_,
            " isObjPath=", GetParam(), " instances=", &instances_, "rc=", &rc_));
}

TEST_P(FactoryInstancesTraceTest, ShowsACapabilitiesInstance)
{
    const LogCapture capture;
    factory_.makeSensorEnabledLogicalElementCapInstance(
        broker(), ref_, {}, properties_, GetParam(), &rc_);
    expectTraced(capture, "makeSensorEnabledLogicalElementCapInstance", 863, 965,
        listOf(" broker=", broker(), " ref=", ref_, " snsrCap=RECORD properties=", properties_,
            " IsObjPath=", GetParam(), " rc=", &rc_));
}

TEST_P(FactoryInstancesTraceTest, ShowsAllCapabilitiesInstances)
{
    const LogCapture capture;
    factory_.getAllSensorEnabledLogicalElementCapCMPIInstances(
        broker(), ref_, properties_, GetParam(), instances_, &rc_);
    expectTraced(capture, "getAllSensorEnabledLogicalElementCapCMPIInstances", 996, 1017,
        listOf(" broker=", broker(), " ref=", ref_, " properties=", properties_,
            " isObjPath=", GetParam(), " instances=", &instances_, " rc=", &rc_));
}

// The instance is built with all properties.
TEST_F(FactoryTraceTest, ShowsOneSensorInstance)
{
    CMPIString* const key = Host::String::make(request_->arena(), "Fan:/f").handle();
    const LogCapture capture;
    factory_.getOneSensorCMPIInstance(broker(), ref_, key, properties_, instances_, &rc_);
    expectTraced(capture, "getOneSensorCMPIInstance", 0, 0,
        listOf(" broker=", broker(), " ref=", ref_, " key=", key, " properties=", properties_,
            " instances=", &instances_, " rc=", &rc_));
    expectTraced(capture, "makeSensorInstance", 269, 737,
        listOf(" broker=", broker(), " ref=", ref_, " snsr=RECORD properties=", properties_,
            " isObjPath=0 rc=", &rc_));
}

TEST_F(FactoryTraceTest, ShowsOneCapabilitiesInstance)
{
    CMPIString* const key =
        Host::String::make(request_->arena(), "ZUMLO:SensorEnabledLogicalElementCap1").handle();
    const LogCapture capture;
    factory_.getOneSensorEnabledLogicalElementCapCMPIInstance(
        broker(), ref_, key, properties_, instances_, &rc_);
    expectTraced(capture, "getOneSensorEnabledLogicalElementCapCMPIInstance", 1134, 1158,
        listOf(" broker=", broker(), " ref=", ref_, " key=", key, " properties=", properties_,
            " instances=", &instances_, " rc=", &rc_));
    expectTraced(capture, "makeSensorEnabledLogicalElementCapInstance", 863, 965,
        listOf(" broker=", broker(), " ref=", ref_, " snsrCap=RECORD properties=", properties_,
            " IsObjPath=0 rc=", &rc_));
}

TEST_F(FactoryTraceTest, ShowsObjectPaths)
{
    const LogCapture capture;
    factory_.getAllSensorCMPIObjPaths(broker(), ref_, paths_, &rc_);
    factory_.getAllSensorEnabledLogicalElementCapCMPIObjPaths(broker(), ref_, paths_, &rc_);
    const std::string parameters =
        listOf(" broker=", broker(), " ref=", ref_, " objectPaths=", &paths_, " status=", &rc_);
    expectTraced(capture, "getAllSensorCMPIObjPaths", 0, 0, parameters);
    expectTraced(
        capture, "getAllSensorEnabledLogicalElementCapCMPIObjPaths", 1041, 1093, parameters);
}

TEST_F(FactoryTraceTest, ShowsTheLookUpOfATarget)
{
    const CMPIObjectPath* const source = path("ZUMLO_NumericSensor").handle();
    const LogCapture capture;
    SensorFactory::get_assoc_targetClass_ObjectPath(
        broker(), source, "ZUMLO_SensorSystemDevice", "Result", &rc_);
    const std::string parameters = listOf(" broker=", broker(), " ref=", source,
        " _RefLeftClass=ZUMLO_SensorSystemDevice _RefRightClass=Result rc=", &rc_);
    expectTraced(capture, "get_assoc_targetClass_ObjectPath", 1288, 1316, parameters);
    expectTraced(capture, "get_assoc_targetClass_Name", 1185, 1221, parameters);
}

} // namespace FactoryTraceTests
