// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Requests to an association provider, for a broker that injects faults.

#pragma once

#include "tests/providers/ComputerSystems.h"
#include "tests/providers/Factories.h"
#include "tests/providers/FaultyRequest.h"
#include "tests/providers/ProfileClasses.h"
#include "tests/providers/RequestTrace.h"

#include <algorithm>
#include <array>
#include <string>
#include <vector>

namespace Testing {

using SourceMaker = std::function<Host::ObjectPath&(const Host::Request&)>;

// Returns a function that makes a path with at most one text key, which is enough for a source.
inline SourceMaker pathMaker(
    const std::string& className, const std::string& key = {}, const std::string& text = {})
{
    return [=](const Host::Request& request) -> Host::ObjectPath& {
        Host::ObjectPath& made = request.makePath("root/cimv2", className);
        if (!key.empty())
            made.addKey(key, Host::Value::text(request.arena(), text));
        return made;
    };
}

inline SourceMaker pairMaker(const std::string& className, const std::string& one,
    const SourceMaker& first, const std::string& other, const SourceMaker& second)
{
    return [=](const Host::Request& request) -> Host::ObjectPath& {
        Host::ObjectPath& made = request.makePath("root/cimv2", className);
        made.addKey(one, Host::Value::of(first(request)));
        made.addKey(other, Host::Value::of(second(request)));
        return made;
    };
}

inline SourceMaker sensorMaker(const std::string& deviceID)
{
    return [=](const Host::Request& request) -> Host::ObjectPath& {
        Host::ObjectPath& made = request.makePath("root/cimv2", SensorClass);
        for (const auto& [key, text] : std::vector<std::pair<std::string, std::string>>{
                 {"CreationClassName", SensorClass}, {"DeviceID", deviceID},
                 {"SystemCreationClassName", SystemClass}, {"SystemName", Vorn::getSystemName()}})
            made.addKey(key, Host::Value::text(request.arena(), text));
        return made;
    };
}

enum Which { Associators, AssociatorNames, References, ReferenceNames };
using AssociationRequests = std::array<RequestKind, 4>;

// Makes the kinds of requests to the provider with these factories.
struct RequestKinds {
    InstanceFactory instanceFactory;
    AssociationFactory associationFactory;

    RequestKind names(const SourceMaker& ref) const
    {
        return kind("names", ref, instanceFactory,
            [](auto* mi, auto... all) { return mi->ft->enumerateInstanceNames(mi, all...); });
    }

    RequestKind instances(const SourceMaker& ref) const
    {
        return kind("instances", ref, instanceFactory,
            [](auto* mi, auto... all) { return mi->ft->enumerateInstances(mi, all..., nullptr); });
    }

    RequestKind one(const std::string& name, const SourceMaker& ref) const
    {
        return kind(name, ref, instanceFactory,
            [](auto* mi, auto... all) { return mi->ft->getInstance(mi, all..., nullptr); });
    }

    // Returns the requests along the association in the order of Which.
    AssociationRequests along(const std::string& name, const SourceMaker& source) const
    {
        const auto of = [&](const std::string& operation, const auto& call) {
            return kind(operation + "Of" + name, source, associationFactory, call);
        };
        return {of("associators",
                    [](auto* mi, auto... all) {
                        return mi->ft->associators(
                            mi, all..., nullptr, nullptr, nullptr, nullptr, nullptr);
                    }),
            of("associatorNames",
                [](auto* mi, auto... all) {
                    return mi->ft->associatorNames(mi, all..., nullptr, nullptr, nullptr, nullptr);
                }),
            of("references",
                [](auto* mi, auto... all) {
                    return mi->ft->references(mi, all..., nullptr, nullptr, nullptr);
                }),
            of("referenceNames", [](auto* mi, auto... all) {
                return mi->ft->referenceNames(mi, all..., nullptr, nullptr);
            })};
    }

private:
    // Returns a kind of request that `call` sends to the MI of the factory.
    template <typename Factory, typename Call>
    static RequestKind kind(
        const std::string& name, const SourceMaker& source, Factory make, Call call)
    {
        return {name, source, [=](auto* broker, auto* context, auto* result, auto* path) {
                    return call(make(broker, nullptr, nullptr), context, result, path);
                }};
    }
};

// One end of an association: the name of its reference, and the class it refers to.
struct End {
    const char* role;
    const char* className;
};

// Expects a reference that is set to refer to an object of its class.
inline void expectEnd(const Host::Value* value, const End& end)
{
    if (value == nullptr || value->isNull())
        return;
    ASSERT_NE(value->path(), nullptr) << end.role << " is " << describe(*value);
    EXPECT_EQ(value->path()->className(), end.className) << end.role;
}

// Expects what holds for every result, whatever failed: all objects are of the association or of
// one of its ends, and each association refers to objects of the right classes.
inline void expectWellFormed(
    const FaultyRequest& request, const char* association, const std::vector<End>& ends)
{
    const auto isKnown = [&](std::string_view name) {
        return name == association || std::any_of(ends.begin(), ends.end(),
                                          [&](const End& end) { return end.className == name; });
    };
    for (const Host::ObjectPath* const path : request.answer.paths()) {
        EXPECT_TRUE(isKnown(path->className())) << path->toText();
        EXPECT_EQ(path->nameSpace(), "root/cimv2");
        if (path->className() == association)
            for (const End& end : ends)
                expectEnd(path->key(end.role), end);
    }
    for (const Host::Instance* const instance : request.answer.instances()) {
        EXPECT_TRUE(isKnown(instance->className())) << instance->className();
        if (instance->className() == association)
            for (const End& end : ends)
                expectEnd(instance->property(end.role), end);
    }
    EXPECT_TRUE(request.status.rc == CMPI_RC_OK || request.status.rc == CMPI_RC_ERR_FAILED)
        << request.status.rc;
}

// A machine with two sensors and the given systems.
class AssociationFaultTest : public FaultTest {
protected:
    explicit AssociationFaultTest(std::vector<std::string> systems)
        : systems_(std::move(systems)),
          machine_({{Vorn::NodeLexicon::NodeType::Tachometer, "/1", "A", Vorn::NodeReading{}},
              {Vorn::NodeLexicon::NodeType::Tachometer, "/2", "B", Vorn::NodeReading{}}})
    {
        broker_.setClassInformation(&profileClasses());
        broker_.setUpcalls(&systems_);
    }

    struct TracedRequest {
        std::unique_ptr<FaultyRequest> request;
        Lines lines; // the trace lines of the provider
    };
    TracedRequest runTraced(const RequestKind& kind, const Fault& fault)
    {
        TracedRequest traced;
        traced.lines = ownLines(traceOf([&] { traced.request = run(kind, fault); }));
        return traced;
    }

    // Expects that failures to read a namespace or its characters do not change the status.
    void expectNamespacesLeaveTheStatus(const RequestKind& kind)
    {
        const auto unread = runWithLast(kind, BrokerCall::getNameSpace, FaultManner::nullResult);
        EXPECT_EQ(unread->status.rc, CMPI_RC_OK) << kind;
        EXPECT_EQ(runWithLast(kind, BrokerCall::getCharPtr)->status.rc, CMPI_RC_OK) << kind;
    }

    // Expects that an enumeration of names sets the namespaces of both ends in this order before it
    // makes the first association.
    void expectNameSpacesInOrder(const RequestKind& names, const std::string& association,
        const std::string& first, const std::string& second)
    {
        run(names, std::vector<Fault>{});
        std::vector<std::string> settings;
        for (const std::string& call : faulty_->pathCalls())
            if (call.starts_with("setNameSpace "))
                settings.push_back(call.substr(call.find(' ') + 1));
        const auto made = std::find(settings.begin(), settings.end(), association);
        ASSERT_GE(made - settings.begin(), 2);
        EXPECT_EQ(*(made - 2), first);
        EXPECT_EQ(*(made - 1), second);
    }

    // Expects references to have the right values. The faulty broker reads each CMPIValue
    // completely, so that AddressSanitizer reports one that is shorter.
    void expectWholeValues(const RequestKind& names, const RequestKind& instances, const End& end)
    {
        const auto paths = run(names, std::vector<Fault>{});
        EXPECT_GE(faulty_->count(BrokerCall::addKey), 4U);
        ASSERT_FALSE(paths->answer.paths().empty());
        expectEnd(paths->answer.paths()[0]->key(end.role), end);
        const auto objects = run(instances, std::vector<Fault>{});
        EXPECT_GE(faulty_->count(BrokerCall::setProperty), 4U);
        ASSERT_FALSE(objects->answer.instances().empty());
        expectEnd(objects->answer.instances()[0]->property(end.role), end);
    }

    // Expects a failed status with this text, and a result that is not closed.
    static void expectBrokenOff(const FaultyRequest& request, const std::string& statusText)
    {
        EXPECT_EQ(request.status.rc, CMPI_RC_ERR_FAILED);
        EXPECT_EQ(request.message(), statusText);
        EXPECT_FALSE(request.answer.isDone());
    }

    // Expects an empty result with status OK; only a string and a trace message report the failure.
    static void expectEmptyAnswer(
        const FaultyRequest& request, const std::string& lastString, const BrokerMessage& message)
    {
        EXPECT_EQ(request.status.rc, CMPI_RC_OK);
        EXPECT_EQ(request.status.msg, nullptr);
        EXPECT_TRUE(request.answer.paths().empty());
        EXPECT_TRUE(request.answer.instances().empty());
        EXPECT_EQ(request.answer.refused(), 0U);
        EXPECT_TRUE(request.answer.isDone());
        EXPECT_EQ(request.lastString(), lastString);
        EXPECT_EQ(request.lastMessage(), message);
    }

    ComputerSystems systems_;
    ScriptedMachine machine_;
};

} // namespace Testing
