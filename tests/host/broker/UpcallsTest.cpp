// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/broker/BrokerUpcalls.h"

#include "host/broker/CollectedResult.h"
#include "host/broker/Enumeration.h"
#include "host/broker/Instance.h"
#include "host/broker/Refusal.h"
#include "host/broker/Result.h"
#include "tests/host/broker/BrokerTest.h"

namespace HostTests {

namespace {

std::string orNull(const char* text)
{
    return text == nullptr ? "(null)" : text;
}

// Answers from a request nested in the caller's, as a manager does, and keeps what it saw.
class Manager : public Host::BrokerUpcalls {
public:
    explicit Manager(const Host::Broker& broker) : broker_(broker) {}

    unsigned capabilities() const noexcept override { return CMPI_MB_AssociationTraversal; }

    Host::Enumeration& enumerateInstanceNames(
        const Host::Context& context, const Host::ObjectPath& path) override
    {
        seenContext = &context;
        Host::Request nested(broker_);
        Host::CollectedResult collected;
        Host::Result result(collected);
        Host::ObjectPath& answer = nested.makePath(path.nameSpace(), path.className());
        for (const char* const name : {"a", "b"}) {
            answer.addKey("Name", Host::Value::text(nested.arena(), name));
            CMReturnObjectPath(result.handle(), answer.handle());
        }
        return collected.pathEnumeration();
    }

    Host::Instance& getInstance(
        const Host::Context&, const Host::ObjectPath& path, const char** properties) override
    {
        if (path.className() == "Missing")
            throw Host::Refusal(CMPI_RC_ERR_NOT_FOUND, "nobody there");
        Host::Request nested(broker_);
        Host::Instance& answer = nested.makeInstance(path);
        answer.setProperty("Asked", Host::Value::boolean(properties != nullptr));
        return answer;
    }

    Host::Enumeration& associators(const Host::Context&, const Host::ObjectPath&,
        const Association& association, const char**) override
    {
        return remember(association);
    }
    Host::Enumeration& referenceNames(
        const Host::Context&, const Host::ObjectPath&, const Association& association) override
    {
        return remember(association);
    }

    const Host::Context* seenContext = nullptr;
    std::string seenAssociation;

private:
    Host::Enumeration& remember(const Association& association)
    {
        seenAssociation = orNull(association.associationClass) + ' ' +
                          orNull(association.resultClass) + ' ' + orNull(association.role) + ' ' +
                          orNull(association.resultRole);
        return Host::Enumeration::make(Host::Arena::required(), CMPI_ref);
    }

    const Host::Broker& broker_;
};

} // namespace

class UpcallsTest : public BrokerTest {
protected:
    Manager manager{broker};
    const CMPIContext* context = request.context().handle();
};

TEST_F(UpcallsTest, WithNobodyBehindThemAnswerNotSupported)
{
    const CMPIObjectPath* const target = path();
    EXPECT_EQ(CBEnumInstanceNames(mb, context, target, &rc), nullptr);
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_NOT_SUPPORTED);
    EXPECT_EQ(textOf(rc.msg), "enumerateInstanceNames is not offered by this object manager");
    EXPECT_EQ(CBEnumInstances(mb, context, target, nullptr, &rc), nullptr);
    EXPECT_EQ(CBGetInstance(mb, context, target, nullptr, &rc), nullptr);
    EXPECT_EQ(CBCreateInstance(mb, context, target, instance(), &rc), nullptr);
    EXPECT_EQ(CBExecQuery(mb, context, target, "q", "l", &rc), nullptr);
    EXPECT_EQ(CBAssociators(mb, context, target, nullptr, nullptr, nullptr, nullptr, nullptr, &rc),
        nullptr);
    EXPECT_EQ(
        CBAssociatorNames(mb, context, target, nullptr, nullptr, nullptr, nullptr, &rc), nullptr);
    EXPECT_EQ(CBReferences(mb, context, target, nullptr, nullptr, nullptr, &rc), nullptr);
    EXPECT_EQ(CBReferenceNames(mb, context, target, nullptr, nullptr, &rc), nullptr);
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_NOT_SUPPORTED);
    EXPECT_EQ(
        CBModifyInstance(mb, context, target, instance(), nullptr).rc, CMPI_RC_ERR_NOT_SUPPORTED);
    EXPECT_EQ(CBDeleteInstance(mb, context, target).rc, CMPI_RC_ERR_NOT_SUPPORTED);
    EXPECT_EQ(
        CBDeliverIndication(mb, context, "root/cimv2", instance()).rc, CMPI_RC_ERR_NOT_SUPPORTED);
    EXPECT_EQ(CBInvokeMethod(mb, context, target, "M", nullptr, nullptr, &rc).state, absentState);
    EXPECT_EQ(CBGetProperty(mb, context, target, "P", &rc).state, absentState);
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_NOT_SUPPORTED);
    EXPECT_EQ(
        CBSetProperty(mb, context, target, "P", "x", CMPI_chars).rc, CMPI_RC_ERR_NOT_SUPPORTED);
}

TEST_F(UpcallsTest, ReachTheHostWithTheCallersContext)
{
    broker.setUpcalls(&manager);
    const CMPIEnumeration* const names = CBEnumInstanceNames(mb, context, path(), &rc);
    ASSERT_NE(names, nullptr);
    EXPECT_EQ(rc.rc, CMPI_RC_OK);
    EXPECT_EQ(manager.seenContext, &request.context());
    std::string all;
    while (CMHasNext(names, nullptr))
        all += textOf(CMGetKey(CMGetNext(names, nullptr).value.ref, "Name", nullptr));
    EXPECT_EQ(all, "ab");
}

TEST_F(UpcallsTest, AnswersOfANestedRequestAreTheCallers)
{
    broker.setUpcalls(&manager);
    const char* properties[] = {nullptr};
    CMPIInstance* const answer = CBGetInstance(mb, context, path(), properties, &rc);
    ASSERT_NE(answer, nullptr);
    EXPECT_EQ(CMGetProperty(answer, "Asked", nullptr).value.boolean, 1);
    EXPECT_EQ(CMSetProperty(answer, "More", "x", CMPI_chars).rc, CMPI_RC_OK);
}

TEST_F(UpcallsTest, ARefusalIsTheCallersStatus)
{
    broker.setUpcalls(&manager);
    EXPECT_EQ(CBGetInstance(mb, context, path("Missing"), nullptr, &rc), nullptr);
    EXPECT_EQ(rc.rc, CMPI_RC_ERR_NOT_FOUND);
    EXPECT_EQ(textOf(rc.msg), "nobody there");
    EXPECT_EQ(CBGetInstance(mb, context, path("Missing"), nullptr, nullptr), nullptr);
}

TEST_F(UpcallsTest, AssociationArgumentsArriveInTheirPlaces)
{
    broker.setUpcalls(&manager);
    CBAssociators(mb, context, path(), "Assoc", "Result", "Role", "ResultRole", nullptr, &rc);
    EXPECT_EQ(manager.seenAssociation, "Assoc Result Role ResultRole");
    CBReferenceNames(mb, context, path(), "Result", nullptr, &rc);
    EXPECT_EQ(manager.seenAssociation, "(null) Result (null) (null)");
}

TEST_F(UpcallsTest, TheBrokerClaimsWhatTheHostOffers)
{
    broker.setUpcalls(&manager);
    EXPECT_TRUE(mb->bft->brokerCapabilities & CMPI_MB_BasicRead);
    broker.setUpcalls(nullptr);
    EXPECT_FALSE(mb->bft->brokerCapabilities & CMPI_MB_BasicRead);
}

} // namespace HostTests
