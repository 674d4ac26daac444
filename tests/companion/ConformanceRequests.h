// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Requests to the provider of ZUMLO_SensorElementConformsToProfile, as an object manager sends
// them.

#pragma once

#include "tests/companion/Factory.h"
#include "tests/companion/ScriptedObjects.h"
#include "tests/support/ClassTable.h"
#include "tests/support/ProviderTest.h"

#include <gmock/gmock.h>

#include <string>
#include <vector>

namespace ElementConformsToProfileTests {

using Testing::ScriptedObjects;

inline constexpr const char* Class = "ZUMLO_SensorElementConformsToProfile";
inline constexpr const char* interop = "root/interop";
inline constexpr const char* cimv2 = "root/cimv2";

struct Filters {
    const char* associationClass = nullptr;
    const char* resultClass = nullptr;
    const char* role = nullptr;
    const char* resultRole = nullptr;
};

struct Reply {
    CMPIStatus status = {};
    Host::CollectedResult found;
};

// Requests whose up-calls the scripted objects answer.
class ElementConformsToProfileTest : public Testing::ProviderTest {
protected:
    ElementConformsToProfileTest()
    {
        broker_.setUpcalls(&objects_);
        classes_.add(Class, {}, "CIM_ElementConformsToProfile");
        classes_.add(ScriptedObjects::ProfileClass, {}, "CIM_RegisteredProfile");
        classes_.add("CIM_RegisteredProfile", {}, "CIM_ManagedElement");
        classes_.add(ScriptedObjects::SensorClass, {}, "CIM_NumericSensor");
        classes_.add("CIM_NumericSensor", {}, "CIM_Sensor");
        broker_.setClassInformation(&classes_);
    }

    const CMPIObjectPath* profile(const char* id = "ZUMLO:DSP1009")
    {
        return path(ScriptedObjects::ProfileClass, {{"InstanceID", id}}, interop).handle();
    }

    const CMPIObjectPath* sensor(const char* id)
    {
        return path(ScriptedObjects::SensorClass, {{"DeviceID", id}}, cimv2).handle();
    }

    const CMPIObjectPath* classIn(const char* nameSpace)
    {
        return path(Class, {}, nameSpace).handle();
    }

    // Returns what `ask(functions, record, result)` delivers.
    template <typename Record, typename Ask>
    static Reply replyOf(Record* mi, const Ask& ask)
    {
        Reply reply;
        Host::Result collecting(reply.found);
        reply.status = ask(*mi->ft, mi, collecting.handle());
        return reply;
    }

    template <typename Ask>
    Reply instances(const Ask& ask) const
    {
        return replyOf(
            SensorElementConformsToProfileProvider_Create_InstanceMI(asked_, nullptr, nullptr),
            ask);
    }

    template <typename Ask>
    Reply associations(const Ask& ask) const
    {
        return replyOf(
            SensorElementConformsToProfileProvider_Create_AssociationMI(asked_, nullptr, nullptr),
            ask);
    }

    Reply enumerateNames(const char* nameSpace)
    {
        return instances([&](auto& ft, auto* mi, auto* result) {
            return ft.enumerateInstanceNames(mi, context(), result, classIn(nameSpace));
        });
    }

    Reply enumerate(const char* nameSpace, const char** properties)
    {
        return instances([&](auto& ft, auto* mi, auto* result) {
            return ft.enumerateInstances(mi, context(), result, classIn(nameSpace), properties);
        });
    }

    Reply get(const Host::ObjectPath& target)
    {
        return instances([&](auto& ft, auto* mi, auto* result) {
            return ft.getInstance(mi, context(), result, target.handle(), nullptr);
        });
    }

    Reply associatorNames(const CMPIObjectPath* source, const Filters& filters = {})
    {
        return associations([&](auto& ft, auto* mi, auto* result) {
            return ft.associatorNames(mi, context(), result, source, filters.associationClass,
                filters.resultClass, filters.role, filters.resultRole);
        });
    }

    Reply associators(const CMPIObjectPath* source, const char** properties = nullptr,
        const char* resultClass = nullptr)
    {
        return associations([&](auto& ft, auto* mi, auto* result) {
            return ft.associators(
                mi, context(), result, source, nullptr, resultClass, nullptr, nullptr, properties);
        });
    }

    Reply referenceNames(const CMPIObjectPath* source, const Filters& filters = {})
    {
        return associations([&](auto& ft, auto* mi, auto* result) {
            return ft.referenceNames(
                mi, context(), result, source, filters.associationClass, filters.role);
        });
    }

    Reply references(const CMPIObjectPath* source, const char** properties)
    {
        return associations([&](auto& ft, auto* mi, auto* result) {
            return ft.references(mi, context(), result, source, nullptr, nullptr, properties);
        });
    }

    // Returns the returned paths without their hosts.
    static std::vector<std::string> pathsIn(const Reply& reply)
    {
        std::vector<std::string> texts;
        for (const Host::ObjectPath* const each : reply.found.paths())
            texts.push_back(local(*each));
        return texts;
    }

    static std::string local(const Host::ObjectPath& path)
    {
        const std::string text = path.toText();
        return path.host().empty() ? text : text.substr(path.host().size() + 3);
    }

    static std::string end(const Host::ObjectPath* association, const char* role)
    {
        return local(*association->key(role)->path());
    }

    Testing::ClassTable classes_;
    ScriptedObjects objects_;
    const CMPIBroker* asked_ = broker();
};

inline constexpr const char* profilePath =
    "root/interop:ZUMLO_SensorRegisteredProfile.InstanceID=\"ZUMLO:DSP1009\"";
inline constexpr const char* cpuPath = "root/cimv2:ZUMLO_NumericSensor.DeviceID=\"CPU\"";
inline constexpr const char* fanPath = "root/cimv2:ZUMLO_NumericSensor.DeviceID=\"Fan\"";

} // namespace ElementConformsToProfileTests
