// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Requests to an association provider, as an object manager sends them.

#pragma once

#include "host/broker/Instance.h"
#include "tests/providers/ComputerSystems.h"
#include "tests/providers/Factories.h"
#include "tests/providers/ProfileClasses.h"
#include "tests/support/ProviderTest.h"

#include <string>
#include <vector>

namespace Testing {

constexpr const char* capabilitiesId = "ZUMLO:SensorEnabledLogicalElementCap1";

// The optional parameters of a request for associated objects.
struct Filter {
    const char* associationClass = nullptr;
    const char* resultClass = nullptr;
    const char* role = nullptr;
    const char* resultRole = nullptr;
    const char** properties = nullptr;
};

// The broker with a function table of the test for the instances that it makes. Only one may exist
// at a time.
class BrokerWithInstances {
public:
    BrokerWithInstances(const CMPIBroker* broker, const CMPIInstanceFT& functions)
        : functions_(*broker->eft), broker_(*broker)
    {
        real_ = broker->eft;
        instanceFunctions_ = functions;
        functions_.newInstance = [](const CMPIBroker* handle, const CMPIObjectPath* path,
                                     CMPIStatus* rc) {
            CMPIInstance* const made = real_->newInstance(handle, path, rc);
            made->ft = &instanceFunctions_;
            return made;
        };
        broker_.eft = &functions_;
    }
    BrokerWithInstances(const BrokerWithInstances&) = delete;
    BrokerWithInstances& operator=(const BrokerWithInstances&) = delete;

    const CMPIBroker* handle() const { return &broker_; }

private:
    inline static const CMPIBrokerEncFT* real_ = nullptr;
    inline static CMPIInstanceFT instanceFunctions_ = {};
    CMPIBrokerEncFT functions_;
    CMPIBroker broker_;
};

// The sensors in the order of the harvest: C, B, A.
inline const std::vector<ScriptedNode> threeSensors = {
    {Vorn::NodeLexicon::NodeType::Temperature, "/3", "C", Vorn::NodeReading{}},
    {Vorn::NodeLexicon::NodeType::Voltage, "/2", "B", Vorn::NodeReading{}},
    {Vorn::NodeLexicon::NodeType::Tachometer, "/1", "A", Vorn::NodeReading{}}};

class AssociationTest : public ProviderTest {
protected:
    AssociationTest(InstanceFactory instances, AssociationFactory associations,
        std::vector<ScriptedNode> nodes, std::vector<std::string> systems)
        : machine_(std::move(nodes)), systems_(std::move(systems)),
          instanceMI_(instances(broker(), nullptr, nullptr)),
          associationMI_(associations(broker(), nullptr, nullptr))
    {
        broker_.setClassInformation(&profileClasses());
        broker_.setUpcalls(&systems_);
    }

    // ---- Ends ----

    Host::ObjectPath& sensor(const std::string& deviceID, const char* nameSpace = testNameSpace)
    {
        Host::ObjectPath& made = path(SensorClass,
            {{"CreationClassName", SensorClass}, {"DeviceID", deviceID},
                {"SystemCreationClassName", SystemClass}, {"SystemName", systemName_}},
            nameSpace);
        made.setHost(systemName_.c_str());
        return made;
    }

    Host::ObjectPath& capabilities(const char* nameSpace = testNameSpace)
    {
        Host::ObjectPath& made =
            path(CapabilitiesClass, {{"InstanceID", capabilitiesId}}, nameSpace);
        made.setHost(systemName_.c_str());
        return made;
    }

    Host::ObjectPath& system(const std::string& name, const char* nameSpace = testNameSpace)
    {
        return path(SystemClass, {{"CreationClassName", SystemClass}, {"Name", name}}, nameSpace);
    }

    // ---- Requests ----

    CMPIStatus enumerateNames(const Host::ObjectPath& ref)
    {
        return instanceMI_->ft->enumerateInstanceNames(
            instanceMI_, context(), result(), ref.handle());
    }

    CMPIStatus enumerate(const Host::ObjectPath& ref, const char** properties = nullptr)
    {
        return instanceMI_->ft->enumerateInstances(
            instanceMI_, context(), result(), ref.handle(), properties);
    }

    CMPIStatus get(const Host::ObjectPath& ref, const char** properties = nullptr)
    {
        return instanceMI_->ft->getInstance(
            instanceMI_, context(), result(), ref.handle(), properties);
    }

    CMPIStatus associators(const Host::ObjectPath& source, const Filter& filter = {})
    {
        return associationMI_->ft->associators(associationMI_, context(), result(), source.handle(),
            filter.associationClass, filter.resultClass, filter.role, filter.resultRole,
            filter.properties);
    }

    CMPIStatus associatorNames(const Host::ObjectPath& source, const Filter& filter = {})
    {
        return associationMI_->ft->associatorNames(associationMI_, context(), result(),
            source.handle(), filter.associationClass, filter.resultClass, filter.role,
            filter.resultRole);
    }

    CMPIStatus references(const Host::ObjectPath& source, const Filter& filter = {})
    {
        return associationMI_->ft->references(associationMI_, context(), result(), source.handle(),
            filter.resultClass, filter.role, filter.properties);
    }

    CMPIStatus referenceNames(const Host::ObjectPath& source, const Filter& filter = {})
    {
        return associationMI_->ft->referenceNames(
            associationMI_, context(), result(), source.handle(), filter.resultClass, filter.role);
    }

    // ---- Answers ----

    static void expectOk(const CMPIStatus& status)
    {
        EXPECT_EQ(status.rc, CMPI_RC_OK);
        EXPECT_EQ(status.msg, nullptr);
    }

    static void expectFailure(const CMPIStatus& status, const std::string& text)
    {
        EXPECT_EQ(status.rc, CMPI_RC_ERR_FAILED);
        EXPECT_EQ(textOf(status.msg), text);
    }

    // Expects an empty result, closed or open.
    void expectNothing(bool isDone)
    {
        EXPECT_TRUE(answer_.paths().empty());
        EXPECT_TRUE(answer_.instances().empty());
        EXPECT_EQ(answer_.refused(), 0U);
        EXPECT_EQ(answer_.isDone(), isDone);
    }

    // Expects that all delivered objects are paths of the association with this machine's name and
    // both references.
    void expectAssociationPaths(const std::string& association, const std::string& nameSpace)
    {
        EXPECT_TRUE(answer_.instances().empty());
        for (const Host::ObjectPath* const each : answer_.paths()) {
            EXPECT_EQ(each->className(), association);
            EXPECT_EQ(each->nameSpace(), nameSpace);
            EXPECT_EQ(each->host(), systemName_);
            EXPECT_EQ(each->keys().size(), 2U);
        }
    }

    // Returns the value of the key that identifies a sensor, a system or capabilities.
    static std::string nameOf(const Host::ObjectPath& end)
    {
        for (const char* const key : {"DeviceID", "InstanceID", "Name"})
            if (const Host::Value* const value = end.key(key))
                return std::string(*value->text());
        return "nameless";
    }

    // Returns the names of the delivered objects.
    std::vector<std::string> delivered() const
    {
        std::vector<std::string> names;
        for (const Host::ObjectPath* const each : answer_.paths())
            names.push_back(nameOf(*each));
        for (const Host::Instance* const each : answer_.instances())
            names.push_back(nameOf(each->objectPath()));
        return names;
    }

    // Returns the associations of a result as pairs of the names of the objects that they refer to.
    static std::vector<std::string> pairs(
        const Host::CollectedResult& answer, const char* one, const char* other)
    {
        std::vector<std::string> found;
        for (const Host::ObjectPath* const each : answer.paths())
            found.push_back(
                nameOf(*each->key(one)->path()) + " " + nameOf(*each->key(other)->path()));
        for (const Host::Instance* const each : answer.instances())
            found.push_back(nameOf(*each->property(one)->path()) + " " +
                            nameOf(*each->property(other)->path()));
        return found;
    }

    // Returns the pairs of the delivered associations.
    std::vector<std::string> pairs(const char* one, const char* other) const
    {
        return pairs(answer_, one, other);
    }

    ScriptedMachine machine_;
    ComputerSystems systems_;
    CMPIInstanceMI* instanceMI_;
    CMPIAssociationMI* associationMI_;
};

} // namespace Testing
