// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The instance that is built from a capabilities record: its properties, their types and values.

#include "factory/SensorFactory.h"
#include "tests/support/FaultyBroker.h"
#include "tests/support/ProviderTest.h"

#include <gmock/gmock.h>

namespace CapabilitiesInstanceBuilderTests {

using namespace Vorn::SensorProfileProvider;
using namespace Testing;
using namespace ::testing;

constexpr const char* Class = "ZUMLO_SensorEnabledLogicalElementCapabilities";
constexpr const char* provider = "SensorEnabledLogicalElementCapabilitiesProvider";
const std::string wideColumnGap(25, ' ');

class CapabilitiesInstanceBuilderTest : public ProviderTest {
protected:
    CMPIInstance* build(const char** properties = nullptr, bool isObjPath = false,
        const SensorEnabledLogCap& record = {})
    {
        SensorFactory factory;
        return factory.makeSensorEnabledLogicalElementCapInstance(
            broker(), path("ANY_Class").handle(), record, properties, isObjPath, &rc_);
    }

    const Host::Instance& make(const char** properties = nullptr, bool isObjPath = false,
        const SensorEnabledLogCap& record = {})
    {
        const Host::Instance* const instance =
            Host::Instance::of(build(properties, isObjPath, record));
        if (instance == nullptr)
            throw std::runtime_error("no instance was made");
        return *instance;
    }

    std::vector<std::string> namesWith(std::vector<const char*> properties, bool isObjPath = false)
    {
        properties.push_back(nullptr);
        return namesOf(make(properties.data(), isObjPath).properties());
    }

    // Builds an instance with a broker that fails. Returns it also where it is null or has no
    // handle.
    CMPIInstance* buildWith(const Testing::Fault& fault, CMPIStatus* rc,
        const char** properties = nullptr, bool isObjPath = false)
    {
        faulty_.reset();
        faulty_ = std::make_unique<FaultyBroker>(broker_);
        faulty_->plan(fault);
        SensorFactory factory;
        CMPIInstance* const made =
            factory.makeSensorEnabledLogicalElementCapInstance(faulty_->handle(),
                faulty_->watch(path("ANY_Class").handle()), {}, properties, isObjPath, rc);
        EXPECT_EQ(faulty_->fired(), 1U);
        return made;
    }

    std::unique_ptr<FaultyBroker> faulty_;
    CMPIStatus rc_ = {CMPI_RC_OK, nullptr};
};

TEST_F(CapabilitiesInstanceBuilderTest, AllPropertiesComeInOrder)
{
    EXPECT_THAT(describe(make().properties()),
        ElementsAre("InstanceID = string \"ZUMLO:SensorEnabledLogicalElementCap1\"",
            "RequestedStatesSupported = [uint16 0, uint16 1, uint16 2]",
            "ElementNameEditSupported = false"));
    EXPECT_EQ(rc_.rc, CMPI_RC_OK);
    EXPECT_TRUE(messages_.empty());
}

TEST_F(CapabilitiesInstanceBuilderTest, TheRecordIsReadAsACopy)
{
    const SensorEnabledLogCap record;
    make(nullptr, false, record);
    EXPECT_EQ(property(make(nullptr, false, record), "RequestedStatesSupported"),
        "[uint16 0, uint16 1, uint16 2]");
}

TEST_F(CapabilitiesInstanceBuilderTest, ARecordThatWasReadBeforeCarriesItsStatesAgain)
{
    SensorEnabledLogCap record;
    record.getStatesSupported();
    EXPECT_EQ(property(make(nullptr, false, record), "RequestedStatesSupported"),
        "[uint16 0, uint16 1, uint16 2, uint16 0, uint16 1, uint16 2]");
}

TEST_F(CapabilitiesInstanceBuilderTest, AnObjectPathNeedsNoStates)
{
    EXPECT_THAT(namesOf(make(nullptr, true).properties()),
        ElementsAre("InstanceID", "ElementNameEditSupported"));
}

TEST_F(CapabilitiesInstanceBuilderTest, APropertyListDecidesWhateverTheObjectPathFlagSays)
{
    for (const bool isObjPath : {false, true})
        EXPECT_THAT(namesWith({"RequestedStatesSupported", "ElementNameEditSupported"}, isObjPath),
            ElementsAre("InstanceID", "RequestedStatesSupported", "ElementNameEditSupported"));
}

// The broker's filter has the list as well, so that the broker drops properties that it does not
// name.
TEST_F(CapabilitiesInstanceBuilderTest, AListSelectsItsPropertiesAndTheKey)
{
    EXPECT_THAT(namesWith({"RequestedStatesSupported"}),
        ElementsAre("InstanceID", "RequestedStatesSupported"));
    EXPECT_THAT(namesWith({"ElementNameEditSupported"}),
        ElementsAre("InstanceID", "ElementNameEditSupported"));
    EXPECT_THAT(namesWith({"ElementName"}), ElementsAre("InstanceID"));
    EXPECT_THAT(namesWith({}), ElementsAre("InstanceID"));
}

TEST_F(CapabilitiesInstanceBuilderTest, TheEditFlagIsSetWhateverTheListNames)
{
    const char* lists[][2] = {{"ElementName", nullptr}, {nullptr, nullptr}};
    for (const char** const list : lists) {
        const CMPIInstance* const made =
            buildWith({BrokerCall::setPropertyFilter, 1, FaultManner::errorStatus}, &rc_, list);
        EXPECT_THAT(namesOf(Host::Instance::of(made)->properties()),
            ElementsAre("InstanceID", "ElementNameEditSupported"));
    }
}

TEST_F(CapabilitiesInstanceBuilderTest, AListIsReadToItsNullEntry)
{
    EXPECT_THAT(namesWith({"A", "B", "RequestedStatesSupported", "C"}),
        ElementsAre("InstanceID", "RequestedStatesSupported"));
    const char* list[] = {"A", nullptr, "RequestedStatesSupported", nullptr};
    EXPECT_THAT(namesOf(make(list).properties()), ElementsAre("InstanceID"));
}

TEST_F(CapabilitiesInstanceBuilderTest, NamesAreComparedLetterForLetter)
{
    for (const char* const name :
        {"requestedstatessupported", "RequestedStatesSupported ", "RequestedStatesSupporte"})
        EXPECT_THAT(namesWith({name}), ElementsAre("InstanceID")) << name;
}

TEST_F(CapabilitiesInstanceBuilderTest, ThePathHasTheRequestsNamespaceAndThisSystemAsHost)
{
    SensorFactory factory;
    const Host::Instance* const instance =
        Host::Instance::of(factory.makeSensorEnabledLogicalElementCapInstance(
            broker(), path("ANY_Class", {}, "root/other").handle(), {}, nullptr, false, &rc_));
    ASSERT_NE(instance, nullptr);
    const Host::ObjectPath& made = instance->objectPath();
    EXPECT_EQ(made.nameSpace(), "root/other");
    EXPECT_EQ(made.host(), systemName_);
    EXPECT_EQ(made.className(), Class);
    // The key list of the filter contains the key.
    EXPECT_THAT(describe(made.keys()),
        ElementsAre("InstanceID = string \"ZUMLO:SensorEnabledLogicalElementCap1\""));
}

// ---- Failures of the broker ----

TEST_F(CapabilitiesInstanceBuilderTest, WithoutAPathThereIsNoInstance)
{
    for (const FaultManner manner : {FaultManner::nullResult, FaultManner::handleless}) {
        const LogCapture capture;
        CMPIStatus rc = {CMPI_RC_OK, nullptr};
        const Testing::Fault fault = {
            BrokerCall::newObjectPath, 1, manner, CMPI_RC_ERR_INVALID_NAMESPACE};
        EXPECT_EQ(buildWith(fault, &rc), nullptr);
        EXPECT_EQ(rc.rc, CMPI_RC_ERR_INVALID_NAMESPACE); // as the broker left it
        EXPECT_TRUE(messages_.empty());
        EXPECT_EQ(capture.log().size(), 2U); // entering and exiting
    }
}

TEST_F(CapabilitiesInstanceBuilderTest, AnInstanceTheBrokerDoesNotMakeIsReturnedAsItCame)
{
    EXPECT_EQ(buildWith({BrokerCall::newInstance, 1, FaultManner::nullResult}, &rc_), nullptr);
    EXPECT_EQ(rc_.rc, CMPI_RC_OK); // the status is not passed to the broker
    const CMPIInstance* const made =
        buildWith({BrokerCall::newInstance, 1, FaultManner::handleless}, &rc_);
    ASSERT_NE(made, nullptr);
    EXPECT_EQ(made->hdl, nullptr);
    EXPECT_TRUE(messages_.empty());
}

TEST_F(CapabilitiesInstanceBuilderTest, AnArrayThatCannotBeMadeIsReportedAndLeftOut)
{
    for (const FaultManner manner : {FaultManner::nullResult, FaultManner::handleless}) {
        const LogCapture capture;
        messages_.clear();
        const CMPIInstance* const made =
            buildWith({BrokerCall::newArray, 1, manner, CMPI_RC_OK}, &rc_);
        EXPECT_THAT(namesOf(Host::Instance::of(made)->properties()),
            ElementsAre("InstanceID", "ElementNameEditSupported"));
        EXPECT_EQ(rc_.rc, CMPI_RC_ERR_FAILED);
        EXPECT_EQ(Testing::textOf(rc_.msg),
            "Creating array for Property" + wideColumnGap + "RequestedStatesSupported failed.");
        EXPECT_THAT(messages_, ElementsAre(BrokerMessage{2, provider,
                                   "Creating Array for Property" + wideColumnGap +
                                       "RequestedStatesSupported failed."}));
        EXPECT_EQ(capture.log().size(), 2U); // entering and exiting
    }
}

TEST_F(CapabilitiesInstanceBuilderTest, WithoutAStatusAMissingArrayIsTracedOnly)
{
    const CMPIInstance* const made =
        buildWith({BrokerCall::newArray, 1, FaultManner::nullResult}, nullptr);
    EXPECT_EQ(Host::Instance::of(made)->properties().size(), 2U);
    EXPECT_EQ(messages_.size(), 1U);
}

} // namespace CapabilitiesInstanceBuilderTests
