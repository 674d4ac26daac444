// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The provider of computer systems, which answers the up-calls of the association with them.

#pragma once

#include "host/broker/BrokerUpcalls.h"
#include "host/broker/Context.h"
#include "host/broker/Enumeration.h"
#include "host/broker/Instance.h"
#include "host/broker/ObjectPath.h"
#include "host/broker/Refusal.h"

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
    std::string nameSpace = "root/cimv2"; // of the paths that it returns
    CMPIrc refusal = CMPI_RC_OK;          // the code of its failure
    bool isMixed = false;                 // returns elements of all other types between them, too
    std::vector<Upcall> calls;

    Host::Enumeration& enumerateInstanceNames(
        const Host::Context& context, const Host::ObjectPath& path) override
    {
        record("enumerateInstanceNames", context, path, nullptr);
        std::vector<Host::Value> answer;
        for (const std::string& name : names) {
            addStrangers(answer, CMPI_ref, Host::Value::of(instance(name)));
            answer.push_back(Host::Value::of(pathTo(name)));
        }
        return Host::Enumeration::make(Host::Arena::required(), answer);
    }

    Host::Enumeration& enumerateInstances(const Host::Context& context,
        const Host::ObjectPath& path, const char** properties) override
    {
        record("enumerateInstances", context, path, properties);
        std::vector<Host::Value> answer;
        for (const std::string& name : names) {
            addStrangers(answer, CMPI_instance, Host::Value::of(pathTo(name)));
            answer.push_back(Host::Value::of(instance(name)));
        }
        return Host::Enumeration::make(Host::Arena::required(), answer);
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
        std::vector<Host::Value>& answer, CMPIType type, const Host::Value& theOtherKind) const
    {
        if (!isMixed)
            return;
        answer.push_back(Host::Value::text(Host::Arena::required(), "a text"));
        answer.push_back(Host::Value::integer(CMPI_uint64, 7));
        answer.push_back(Host::Value::null(type));
        answer.push_back(Host::Value::absent());
        answer.push_back(theOtherKind);
    }
};

} // namespace Testing
