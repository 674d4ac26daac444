// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The six factory functions, their tables, and the handlers without an effect.

#include "tests/providers/Factories.h"
#include "tests/support/LogCapture.h"

#include <gtest/gtest.h>

#include <string>

namespace EntryPointsTests {

template <typename Factory>
struct Entry {
    const char* miName;
    Factory factory;
};
using InstanceEntry = Entry<Testing::InstanceFactory>;
using AssociationEntry = Entry<Testing::AssociationFactory>;

const InstanceEntry instanceEntries[] = {
    {"instanceSensorProfileProvider", SensorProfileProvider_Create_InstanceMI},
    {"instanceSensorEnabledLogicalElementCapabilitiesProvider",
        SensorEnabledLogicalElementCapabilitiesProvider_Create_InstanceMI},
    {"instanceSensorElementCapabilitiesProvider",
        SensorElementCapabilitiesProvider_Create_InstanceMI},
    {"instanceSensorSystemDeviceProvider", SensorSystemDeviceProvider_Create_InstanceMI},
};

const AssociationEntry associationEntries[] = {
    {"associationSensorElementCapabilitiesProvider",
        SensorElementCapabilitiesProvider_Create_AssociationMI},
    {"associationSensorSystemDeviceProvider", SensorSystemDeviceProvider_Create_AssociationMI},
};

const CMPIBroker noBroker = {};

template <typename EntryType>
class EntryTest : public ::testing::TestWithParam<EntryType> {
protected:
    auto* create(CMPIStatus* status = nullptr) const
    {
        return this->GetParam().factory(&noBroker, nullptr, status);
    }
};

template <typename EntryType>
std::string entryName(const ::testing::TestParamInfo<EntryType>& info)
{
    return info.param.miName;
}

using InstanceEntryTest = EntryTest<InstanceEntry>;
using AssociationEntryTest = EntryTest<AssociationEntry>;

INSTANTIATE_TEST_SUITE_P(
    All, InstanceEntryTest, ::testing::ValuesIn(instanceEntries), entryName<InstanceEntry>);
INSTANTIATE_TEST_SUITE_P(All, AssociationEntryTest, ::testing::ValuesIn(associationEntries),
    entryName<AssociationEntry>);

TEST_P(InstanceEntryTest, TheTableHasItsVersionsNameAndHandlers)
{
    const CMPIInstanceMI* const mi = create();
    EXPECT_EQ(mi->hdl, nullptr);
    EXPECT_EQ(mi->ft->ftVersion, 200U);
    EXPECT_EQ(mi->ft->miVersion, 200);
    EXPECT_STREQ(mi->ft->miName, GetParam().miName);
    EXPECT_NE(mi->ft->cleanup, nullptr);
    EXPECT_NE(mi->ft->enumerateInstanceNames, nullptr);
    EXPECT_NE(mi->ft->enumerateInstances, nullptr);
    EXPECT_NE(mi->ft->getInstance, nullptr);
}

TEST_P(AssociationEntryTest, TheTableHasItsVersionsNameAndHandlers)
{
    const CMPIAssociationMI* const mi = create();
    EXPECT_EQ(mi->hdl, nullptr);
    EXPECT_EQ(mi->ft->ftVersion, 200U);
    EXPECT_EQ(mi->ft->miVersion, 200);
    EXPECT_STREQ(mi->ft->miName, GetParam().miName);
    EXPECT_NE(mi->ft->associators, nullptr);
    EXPECT_NE(mi->ft->associatorNames, nullptr);
    EXPECT_NE(mi->ft->references, nullptr);
    EXPECT_NE(mi->ft->referenceNames, nullptr);
}

template <typename EntryType>
void expectTheSameRecordAtEveryCall(const EntryType& entry)
{
    const CMPIBroker other = {};
    auto* const first = entry.factory(&noBroker, nullptr, nullptr);
    EXPECT_NE(first, nullptr);
    EXPECT_EQ(entry.factory(&other, nullptr, nullptr), first);
}

TEST_P(InstanceEntryTest, EveryCallReturnsTheSameRecord)
{
    expectTheSameRecordAtEveryCall(GetParam());
}

TEST_P(AssociationEntryTest, EveryCallReturnsTheSameRecord)
{
    expectTheSameRecordAtEveryCall(GetParam());
}

template <typename EntryType>
void expectAnUntouchedStatus(const EntryType& entry)
{
    CMPIStatus status = {CMPI_RC_ERR_ACCESS_DENIED, nullptr};
    entry.factory(&noBroker, nullptr, &status);
    EXPECT_EQ(status.rc, CMPI_RC_ERR_ACCESS_DENIED);
}

TEST_P(InstanceEntryTest, TheStatusIsNotWritten)
{
    expectAnUntouchedStatus(GetParam());
}

TEST_P(AssociationEntryTest, TheStatusIsNotWritten)
{
    expectAnUntouchedStatus(GetParam());
}

void expectStatus(const CMPIStatus& status, CMPIrc code)
{
    EXPECT_EQ(status.rc, code);
    EXPECT_EQ(status.msg, nullptr);
}

template <typename MI>
void expectSilentCleanup(MI* mi)
{
    const Testing::LogCapture capture;
    expectStatus(mi->ft->cleanup(mi, nullptr, 0), CMPI_RC_OK);
    expectStatus(mi->ft->cleanup(mi, nullptr, 1), CMPI_RC_OK);
    EXPECT_TRUE(capture.log().empty());
    EXPECT_TRUE(capture.trace().empty());
}

TEST_P(InstanceEntryTest, CleanupIsOkWhetherTerminatingOrNotAndSilent)
{
    expectSilentCleanup(create());
}

TEST_P(AssociationEntryTest, CleanupIsOkWhetherTerminatingOrNotAndSilent)
{
    expectSilentCleanup(create());
}

TEST_P(InstanceEntryTest, WritingAndQueryingAreNotSupportedWhateverTheArgumentsAndSilent)
{
    const Testing::LogCapture capture;
    CMPIInstanceMI* const mi = create();
    const CMPIrc refused = CMPI_RC_ERR_NOT_SUPPORTED;
    expectStatus(mi->ft->createInstance(mi, nullptr, nullptr, nullptr, nullptr), refused);
    expectStatus(mi->ft->modifyInstance(mi, nullptr, nullptr, nullptr, nullptr, nullptr), refused);
    expectStatus(mi->ft->deleteInstance(mi, nullptr, nullptr, nullptr), refused);
    expectStatus(mi->ft->execQuery(mi, nullptr, nullptr, nullptr, "SELECT *", "WQL"), refused);
    EXPECT_TRUE(capture.log().empty());
}

} // namespace EntryPointsTests
