// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The object manager's other provider, which the association with computer systems asks.

#pragma once

#include "host/broker/BrokerUpcalls.h"
#include "host/broker/Context.h"
#include "host/broker/Enumeration.h"
#include "host/broker/Instance.h"
#include "host/broker/ObjectPath.h"
#include "host/broker/Refusal.h"

#include <algorithm>
#include <string>
#include <utility>
#include <vector>

namespace Testing {

struct Upcall {
    std::string operation;
    std::string path;
    const CMPIContext* context;
    bool hasPropertyList;
};

class ComputerSystems : public Host::BrokerUpcalls {
public:
    static constexpr const char* Class = "ZUMLO_ComputerSystem";

    explicit ComputerSystems(std::vector<std::string> systems) : names(std::move(systems)) {}

    std::vector<std::string> names;
    std::string nameSpace = "root/cimv2"; // of the paths it hands out
    CMPIrc refusal = CMPI_RC_OK;          // what it answers with, if not systems
    bool isMixed = false;                 // hands out elements of all other types between them
    std::vector<Upcall> calls;

    Host::Enumeration& enumerateInstanceNames(
        const Host::Context& context, const Host::ObjectPath& path) override
    {
        record("enumerateInstanceNames", context, path, nullptr);
        Host::Enumeration& answer = Host::Enumeration::make(Host::Arena::required(), CMPI_ref);
        for (const std::string& name : names) {
            addStrangers(answer, CMPI_ref, Host::Value::of(instance(name)));
            answer.add(Host::Value::of(pathTo(name)));
        }
        return answer;
    }

    Host::Enumeration& enumerateInstances(const Host::Context& context,
        const Host::ObjectPath& path, const char** properties) override
    {
        record("enumerateInstances", context, path, properties);
        Host::Enumeration& answer = Host::Enumeration::make(Host::Arena::required(), CMPI_instance);
        for (const std::string& name : names) {
            addStrangers(answer, CMPI_instance, Host::Value::of(pathTo(name)));
            answer.add(Host::Value::of(instance(name)));
        }
        return answer;
    }

    Host::Instance& getInstance(const Host::Context& context, const Host::ObjectPath& path,
        const char** properties) override
    {
        record("getInstance", context, path, properties);
        const Host::Value* const name = path.key("Name");
        if (name == nullptr || std::find(names.begin(), names.end(), *name->text()) == names.end())
            throw Host::Refusal(CMPI_RC_ERR_NOT_FOUND, "no such system");
        return instance(std::string(*name->text()));
    }

    Host::ObjectPath& pathTo(const std::string& name) const
    {
        Host::Arena& arena = Host::Arena::required();
        Host::ObjectPath& path = Host::ObjectPath::make(arena, nameSpace, Class);
        path.addKey("CreationClassName", Host::Value::text(arena, Class));
        path.addKey("Name", Host::Value::text(arena, name));
        return path;
    }

private:
    void record(const char* operation, const Host::Context& context, const Host::ObjectPath& path,
        const char** properties)
    {
        calls.push_back({operation, path.toText(), context.handle(), properties != nullptr});
        if (refusal != CMPI_RC_OK)
            throw Host::Refusal(refusal, "no systems today");
    }

    Host::Instance& instance(const std::string& name) const
    {
        Host::Arena& arena = Host::Arena::required();
        Host::Instance& made = Host::Instance::make(arena, pathTo(name), nullptr);
        made.setProperty("CreationClassName", Host::Value::text(arena, Class));
        made.setProperty("Name", Host::Value::text(arena, name));
        return made;
    }

    void addStrangers(
        Host::Enumeration& answer, CMPIType type, const Host::Value& theOtherKind) const
    {
        if (!isMixed)
            return;
        answer.add(Host::Value::text(Host::Arena::required(), "a text"));
        answer.add(Host::Value::integer(CMPI_uint64, 7));
        answer.add(Host::Value::null(type));
        answer.add(Host::Value::absent());
        answer.add(theOtherKind);
    }
};

} // namespace Testing
