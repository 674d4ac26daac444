// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Up-calls reach the object that the host has set.

#include "host/broker/BrokerUpcalls.h"

#include "host/broker/Enumeration.h"
#include "host/broker/Refusal.h"
#include "tests/host/broker/BrokerTest.h"

#include <vector>

namespace HostTests {

namespace {

// Answers in a request nested in that of the caller, as a manager does, and records its arguments.
class TwoNames : public Host::BrokerUpcalls {
public:
    explicit TwoNames(const Host::Broker& broker) : broker_(broker) {}

    Host::Enumeration& enumerateInstanceNames(
        const Host::Context& context, const Host::ObjectPath& path) override
    {
        seenContext = &context;
        const Host::Request nested(broker_);
        std::vector<Host::Value> names;
        for (const char* const name : {"a", "b"}) {
            Host::ObjectPath& found = nested.makePath(path.nameSpace(), path.className());
            found.addKey("Name", Host::Value::text(nested.arena(), name));
            names.push_back(Host::Value::of(found));
        }
        return Host::Enumeration::make(nested.arena(), names);
    }

    Host::Enumeration& enumerateInstances(
        const Host::Context&, const Host::ObjectPath&, const char**) override
    {
        throw Host::Refusal(CMPI_RC_ERR_NOT_FOUND, "nobody there");
    }

    const Host::Context* seenContext = nullptr;

private:
    const Host::Broker& broker_;
};

} // namespace

class UpcallsTest : public BrokerTest {
protected:
    TwoNames upcalls{broker};
    const CMPIContext* context = request.context().handle();
};

TEST_F(UpcallsTest, WithNobodyBehindThemAnswerNotSupported)
{
    EXPECT_EQ(CBEnumInstanceNames(mb, context, path(), &rc), nullptr);
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_NOT_SUPPORTED);
    EXPECT_EQ(textOf(rc.msg), "enumerateInstanceNames is not offered by this object manager");
    EXPECT_EQ(CBEnumInstances(mb, context, path(), nullptr, &rc), nullptr);
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_NOT_SUPPORTED);
}

TEST_F(UpcallsTest, ReachTheHostWithTheCallersContext)
{
    broker.setUpcalls(&upcalls);
    const CMPIEnumeration* const names = CBEnumInstanceNames(mb, context, path(), &rc);
    ASSERT_NE(names, nullptr);
    EXPECT_EQ(rc.rc, CMPI_RC_OK);
    EXPECT_EQ(upcalls.seenContext, &request.context());
    std::string all;
    while (CMHasNext(names, nullptr))
        all += textOf(CMGetKey(CMGetNext(names, nullptr).value.ref, "Name", nullptr));
    EXPECT_EQ(all, "ab");
}

TEST_F(UpcallsTest, WhatANestedRequestReturnsIsTheCallers)
{
    broker.setUpcalls(&upcalls);
    const CMPIEnumeration* const names = CBEnumInstanceNames(mb, context, path(), nullptr);
    CMPIObjectPath* const first = CMGetNext(names, nullptr).value.ref;
    EXPECT_EQ(CMAddKey(first, "More", "x", CMPI_chars).rc, CMPI_RC_OK);
}

TEST_F(UpcallsTest, ARefusalIsTheCallersStatus)
{
    broker.setUpcalls(&upcalls);
    EXPECT_EQ(CBEnumInstances(mb, context, path("Missing"), nullptr, &rc), nullptr);
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_NOT_FOUND);
    EXPECT_EQ(textOf(rc.msg), "nobody there");
    EXPECT_EQ(CBEnumInstances(mb, context, path("Missing"), nullptr, nullptr), nullptr);
}

} // namespace HostTests
