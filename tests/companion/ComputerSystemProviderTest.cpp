// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The requests of ZUMLO_ComputerSystem, as an object manager sends them.

#include "tests/companion/Factory.h"
#include "tests/support/ProviderTest.h"

#include <gmock/gmock.h>

namespace ComputerSystemProviderTests {

constexpr const char* Class = "ZUMLO_ComputerSystem";

using Keys = std::vector<std::pair<std::string, std::string>>;

class ComputerSystemProviderTest : public Testing::ProviderTest {
protected:
    ComputerSystemProviderTest()
        : mi_(ComputerSystemProvider_Create_InstanceMI(broker(), nullptr, nullptr))
    {
    }

    Keys keys() const { return {{"CreationClassName", Class}, {"Name", systemName_}}; }

    CMPIStatus get(const Host::ObjectPath& ref, const char** properties = nullptr)
    {
        return mi_->ft->getInstance(mi_, context(), result(), ref.handle(), properties);
    }

    void expectFound(const CMPIStatus& status) const
    {
        EXPECT_EQ(status.rc, CMPI_RC_OK);
        ASSERT_EQ(answer_.instances().size(), 1U);
        EXPECT_EQ(
            Testing::property(*answer_.instances()[0], "Name"), "string \"" + systemName_ + "\"");
        EXPECT_TRUE(answer_.isDone());
    }

    void expectNotFound(const CMPIStatus& status) const
    {
        EXPECT_EQ(status.rc, CMPI_RC_ERR_NOT_FOUND);
        EXPECT_EQ(Testing::textOf(status.msg), "no such computer system");
        EXPECT_TRUE(answer_.instances().empty());
    }

    CMPIInstanceMI* mi_;
};

TEST_F(ComputerSystemProviderTest, ThereIsOneNameInTheRequestsNamespace)
{
    const CMPIStatus status = mi_->ft->enumerateInstanceNames(
        mi_, context(), result(), path(Class, {}, "root/other").handle());
    EXPECT_EQ(status.rc, CMPI_RC_OK);
    ASSERT_EQ(answer_.paths().size(), 1U);
    EXPECT_EQ(answer_.paths()[0]->nameSpace(), "root/other");
    EXPECT_EQ(answer_.paths()[0]->host(), systemName_);
    EXPECT_EQ(answer_.paths()[0]->key("Name")->text(), systemName_);
    EXPECT_TRUE(answer_.isDone());
}

TEST_F(ComputerSystemProviderTest, ThereIsOneInstance)
{
    expectFound(
        mi_->ft->enumerateInstances(mi_, context(), result(), path(Class).handle(), nullptr));
    EXPECT_EQ(answer_.instances()[0]->objectPath().toText(),
        path(Class, keys()).toText().insert(0, "//" + systemName_ + "/"));
}

TEST_F(ComputerSystemProviderTest, TheListedPropertiesAndTheKeysAreReturned)
{
    const char* properties[] = {"Dedicated", nullptr};
    expectFound(get(path(Class, keys()), properties));
    EXPECT_THAT(Testing::namesOf(answer_.instances()[0]->properties()),
        ::testing::ElementsAre("CreationClassName", "Name", "Dedicated"));
}

TEST_F(ComputerSystemProviderTest, ItsKeysFindIt)
{
    expectFound(get(path(Class, keys())));
}

TEST_F(ComputerSystemProviderTest, LettersOfClassAndKeyNamesMayBeOfEitherCase)
{
    expectFound(
        get(path("zumlo_computersystem", {{"NAME", systemName_}, {"creationclassname", Class}})));
}

TEST_F(ComputerSystemProviderTest, KeysThatAClientLeftOutAreNotThere)
{
    Host::ObjectPath& ref = path(Class, {{"Name", systemName_}});
    ref.addKey("CreationClassName", Host::Value::absent());
    expectNotFound(get(ref));
}

TEST_F(ComputerSystemProviderTest, AnExtraKeyWithoutValueDoesNotMatter)
{
    Host::ObjectPath& ref = path(Class, keys());
    ref.addKey("Other", Host::Value::absent());
    expectFound(get(ref));
}

TEST_F(ComputerSystemProviderTest, TheHostOfARequestDoesNotMatter)
{
    Host::ObjectPath& ref = path(Class, keys());
    ref.setHost(nullptr);
    expectFound(get(ref));
}

TEST_F(ComputerSystemProviderTest, OtherKeysFindNothing)
{
    expectNotFound(get(path(Class)));
    expectNotFound(get(path(Class, {{"CreationClassName", Class}, {"Name", "elsewhere"}})));
    expectNotFound(get(path(Class, {{"CreationClassName", "Other"}, {"Name", systemName_}})));
    expectNotFound(get(path("Other", keys())));
    Host::ObjectPath& number = path(Class, {{"CreationClassName", Class}});
    number.addKey("Name", Host::Value::integer(CMPI_uint64, 1));
    expectNotFound(get(number));
}

TEST_F(ComputerSystemProviderTest, WithoutANamespaceNothingCanBeMade)
{
    Host::ObjectPath& ref = path(Class);
    ref.setNameSpace(nullptr);
    const CMPIStatus status =
        mi_->ft->enumerateInstanceNames(mi_, context(), result(), ref.handle());
    EXPECT_EQ(status.rc, CMPI_RC_ERR_FAILED);
    EXPECT_EQ(Testing::textOf(status.msg), "the object path cannot be made");
}

TEST_F(ComputerSystemProviderTest, WritingAndQueryingAreNotSupported)
{
    const auto expectNotSupported = [](const CMPIStatus& status) {
        EXPECT_EQ(status.rc, CMPI_RC_ERR_NOT_SUPPORTED);
        EXPECT_EQ(status.msg, nullptr);
    };
    expectNotSupported(mi_->ft->createInstance(mi_, nullptr, nullptr, nullptr, nullptr));
    expectNotSupported(mi_->ft->modifyInstance(mi_, nullptr, nullptr, nullptr, nullptr, nullptr));
    expectNotSupported(mi_->ft->deleteInstance(mi_, nullptr, nullptr, nullptr));
    expectNotSupported(mi_->ft->execQuery(mi_, nullptr, nullptr, nullptr, "SELECT *", "WQL"));
    EXPECT_EQ(mi_->ft->cleanup(mi_, nullptr, 0).rc, CMPI_RC_OK);
}

TEST_F(ComputerSystemProviderTest, TheFactoryReturnsTheSameRecordAtEveryCall)
{
    const Host::Broker other;
    EXPECT_EQ(ComputerSystemProvider_Create_InstanceMI(other.handle(), nullptr, nullptr), mi_);
    EXPECT_EQ(mi_->ft->ftVersion, 200U);
    EXPECT_STREQ(mi_->ft->miName, "instanceComputerSystemProvider");
}

TEST_F(ComputerSystemProviderTest, TheFactoryRefusesToWorkWithoutABroker)
{
    CMPIStatus status{};
    EXPECT_EQ(ComputerSystemProvider_Create_InstanceMI(nullptr, nullptr, &status), nullptr);
    EXPECT_EQ(status.rc, CMPI_RC_ERR_INVALID_PARAMETER);
    expectFound(get(path(Class, keys()))); // with the former broker
}

} // namespace ComputerSystemProviderTests
