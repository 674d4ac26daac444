// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Tests of the requests of ZUMLO_SensorRegisteredProfile.

#include "tests/companion/Factory.h"
#include "tests/support/ProviderTest.h"

#include <gmock/gmock.h>

namespace RegisteredProfileTests {

using ::testing::ElementsAre;

constexpr const char* Class = "ZUMLO_SensorRegisteredProfile";
constexpr const char* interop = "root/PG_InterOp";

class RegisteredProfileTest : public Testing::ProviderTest {
protected:
    RegisteredProfileTest()
        : mi_(SensorRegisteredProfileProvider_Create_InstanceMI(broker(), nullptr, nullptr))
    {
    }

    CMPIStatus get(const std::string& id, const char** properties = nullptr)
    {
        return mi_->ft->getInstance(mi_, context(), result(),
            path(Class, {{"InstanceID", id}}, interop).handle(), properties);
    }

    CMPIInstanceMI* mi_;
};

TEST_F(RegisteredProfileTest, HasEveryPropertyThatTheStandardRequires)
{
    const CMPIStatus status = mi_->ft->enumerateInstances(
        mi_, context(), result(), path(Class, {}, interop).handle(), nullptr);
    EXPECT_EQ(status.rc, CMPI_RC_OK);
    ASSERT_EQ(answer_.instances().size(), 1U);
    EXPECT_THAT(Testing::describe(answer_.instances()[0]->properties()),
        ElementsAre("InstanceID = string \"ZUMLO:DSP1009\"", "ElementName = string \"Sensors\"",
            "RegisteredOrganization = uint16 2", "RegisteredName = string \"Sensors\"",
            "RegisteredVersion = string \"1.0.2\"", "AdvertiseTypes = [uint16 2]"));
    EXPECT_TRUE(answer_.isDone());
}

TEST_F(RegisteredProfileTest, HasOneNameInTheNamespaceOfTheRequest)
{
    mi_->ft->enumerateInstanceNames(mi_, context(), result(), path(Class, {}, interop).handle());
    ASSERT_EQ(answer_.paths().size(), 1U);
    EXPECT_EQ(answer_.paths()[0]->toText(),
        "//" + systemName_ +
            "/root/PG_InterOp:ZUMLO_SensorRegisteredProfile.InstanceID=\"ZUMLO:DSP1009\"");
}

TEST_F(RegisteredProfileTest, IsFoundByItsKey)
{
    EXPECT_EQ(get("ZUMLO:DSP1009").rc, CMPI_RC_OK);
    EXPECT_EQ(answer_.instances().size(), 1U);
}

TEST_F(RegisteredProfileTest, IsNotFoundByAnotherKey)
{
    const CMPIStatus status = get("zumlo:dsp1009");
    EXPECT_EQ(status.rc, CMPI_RC_ERR_NOT_FOUND);
    EXPECT_EQ(Testing::textOf(status.msg), "no such registered profile");
    EXPECT_TRUE(answer_.instances().empty());
}

TEST_F(RegisteredProfileTest, HasItsKeyAndTheListedProperties)
{
    const char* properties[] = {"registeredname", "Unheard", nullptr};
    get("ZUMLO:DSP1009", properties);
    ASSERT_EQ(answer_.instances().size(), 1U);
    EXPECT_THAT(Testing::namesOf(answer_.instances()[0]->properties()),
        ElementsAre("InstanceID", "RegisteredName"));
}

} // namespace RegisteredProfileTests
