// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The only state that a module keeps between requests: its broker, which the factory functions set.

#include "tests/providers/Factories.h"
#include "tests/support/ProviderTest.h"

#include <gmock/gmock.h>

#include <utility>

namespace ProviderLifeTests {

using namespace Testing;
using namespace ::testing;
using Vorn::NodeReading;
using Vorn::NodeLexicon::NodeType;

struct Module {
    const char* name;
    InstanceFactory instances;
    AssociationFactory associations; // null where the module has none
};

constexpr Module sensors = {"Sensors", SensorProfileProvider_Create_InstanceMI, nullptr};
constexpr Module capabilitiesSource = {
    "Capabilities", SensorEnabledLogicalElementCapabilitiesProvider_Create_InstanceMI, nullptr};
constexpr Module elementCapabilities = {"ElementCapabilities",
    SensorElementCapabilitiesProvider_Create_InstanceMI,
    SensorElementCapabilitiesProvider_Create_AssociationMI};
constexpr Module systemDevice = {"SystemDevice", SensorSystemDeviceProvider_Create_InstanceMI,
    SensorSystemDeviceProvider_Create_AssociationMI};

// Another handle of the embedded broker. Records the handles through which paths are made.
class RecordedBroker {
public:
    explicit RecordedBroker(const CMPIBroker* broker) : functions_(*broker->eft), handle_(*broker)
    {
        real_ = broker->eft;
        functions_.newObjectPath = [](const CMPIBroker* asked, const char* nameSpace,
                                       const char* className, CMPIStatus* rc) {
            asked_.push_back(asked);
            return real_->newObjectPath(asked, nameSpace, className, rc);
        };
        handle_.eft = &functions_;
    }
    ~RecordedBroker() { asked_.clear(); }
    RecordedBroker(const RecordedBroker&) = delete;
    RecordedBroker& operator=(const RecordedBroker&) = delete;

    const CMPIBroker* handle() const { return &handle_; }
    // Returns the handles through which paths were made since the previous call.
    static std::vector<const CMPIBroker*> asked() { return std::exchange(asked_, {}); }

private:
    inline static const CMPIBrokerEncFT* real_ = nullptr;
    inline static std::vector<const CMPIBroker*> asked_;
    CMPIBrokerEncFT functions_;
    CMPIBroker handle_;
};

class ProviderLifeTest : public ProviderTest, public ::testing::WithParamInterface<Module> {
protected:
    void request(CMPIInstanceMI* mi)
    {
        mi->ft->enumerateInstanceNames(mi, context(), result(), sensor());
    }

    void request(CMPIAssociationMI* mi)
    {
        mi->ft->referenceNames(mi, context(), result(), sensor(), nullptr, nullptr);
    }

    // Expects a request to make its paths, at least one, through the given broker.
    template <typename MI>
    void expectRequestOf(MI* mi, const RecordedBroker& broker)
    {
        RecordedBroker::asked();
        request(mi);
        const auto asked = RecordedBroker::asked();
        EXPECT_THAT(asked, Not(IsEmpty()));
        EXPECT_THAT(asked, Each(broker.handle()));
    }

    void expectUntouched(const LogCapture& capture) const
    {
        EXPECT_FALSE(answer_.isDone());
        EXPECT_TRUE(answer_.instances().empty());
        EXPECT_TRUE(answer_.paths().empty());
        EXPECT_EQ(answer_.refused(), 0U);
        EXPECT_TRUE(messages_.empty());
        EXPECT_TRUE(capture.log().empty());
        EXPECT_TRUE(capture.trace().empty());
    }

    const CMPIObjectPath* sensor() { return path("ZUMLO_NumericSensor").handle(); }

    ScriptedMachine machine_{{{NodeType::Tachometer, "/f", "Fan", NodeReading{}}}};
    RecordedBroker first_{broker()};
    RecordedBroker second_{broker()};
};

constexpr auto moduleName = [](const auto& info) { return info.param.name; };

INSTANTIATE_TEST_SUITE_P(EveryModule, ProviderLifeTest,
    ::testing::Values(sensors, capabilitiesSource, elementCapabilities, systemDevice), moduleName);

TEST_P(ProviderLifeTest, ARequestAfterCleanupIsServedAsBefore)
{
    CMPIInstanceMI* const instances = GetParam().instances(first_.handle(), nullptr, nullptr);
    for (const CMPIBoolean terminating : {CMPIBoolean{0}, CMPIBoolean{1}}) {
        instances->ft->cleanup(instances, context(), terminating);
        expectRequestOf(instances, first_);
    }
}

TEST_P(ProviderLifeTest, WritingAndQueryingTouchNoResultAndWriteNoLine)
{
    CMPIInstanceMI* const mi = GetParam().instances(broker(), nullptr, nullptr);
    const CMPIObjectPath* const ref = sensor();
    const CMPIInstance* const instance =
        request_->makeInstance(request_->makePath(testNameSpace, "ZUMLO_NumericSensor")).handle();
    const LogCapture capture;
    mi->ft->createInstance(mi, context(), result(), ref, instance);
    mi->ft->modifyInstance(mi, context(), result(), ref, instance, nullptr);
    mi->ft->deleteInstance(mi, context(), result(), ref);
    mi->ft->execQuery(mi, context(), result(), ref, "SELECT *", "WQL");
    mi->ft->cleanup(mi, context(), 1);
    expectUntouched(capture);
}

// ---- Modules with an MI of each kind ----

class BothKindsTest : public ProviderLifeTest {};

INSTANTIATE_TEST_SUITE_P(
    BothModules, BothKindsTest, ::testing::Values(elementCapabilities, systemDevice), moduleName);

TEST_P(BothKindsTest, ARequestForAssociationsAfterCleanupIsServedAsBefore)
{
    CMPIAssociationMI* const associations =
        GetParam().associations(first_.handle(), nullptr, nullptr);
    for (const CMPIBoolean terminating : {CMPIBoolean{0}, CMPIBoolean{1}}) {
        associations->ft->cleanup(associations, context(), terminating);
        expectRequestOf(associations, first_);
    }
}

TEST_P(BothKindsTest, TheAssociationFactorysBrokerIsAlsoThatOfTheInstances)
{
    CMPIInstanceMI* const instances = GetParam().instances(first_.handle(), nullptr, nullptr);
    CMPIAssociationMI* const associations =
        GetParam().associations(second_.handle(), nullptr, nullptr);
    expectRequestOf(instances, second_);
    expectRequestOf(associations, second_);
}

TEST_P(BothKindsTest, TheInstanceFactorysBrokerIsAlsoThatOfTheAssociations)
{
    CMPIAssociationMI* const associations =
        GetParam().associations(first_.handle(), nullptr, nullptr);
    CMPIInstanceMI* const instances = GetParam().instances(second_.handle(), nullptr, nullptr);
    expectRequestOf(associations, second_);
    expectRequestOf(instances, second_);
}

} // namespace ProviderLifeTests
