// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The failures of operations.

#include "host/cimxml/RequestError.h"
#include "host/operations/ObjectManager.h"
#include "tests/host/operations/ScriptedManager.h"

namespace OperationTests {

namespace {

using testing::HasSubstr;
using testing::Not;
using testing::StartsWith;

class DispatcherFaultTest : public testing::Test {
protected:
    std::string ask(const std::string& operation, const std::string& parameters = {})
    {
        return answerTo(*manager_, call(operation, parameters));
    }
    std::string errorOf(const std::string& operation, const std::string& parameters = {})
    {
        return errorIn(ask(operation, parameters));
    }
    // Returns the error of an operation whose provider returns this status.
    std::string errorOfProvider(CMPIrc code, const char* message)
    {
        manager_.script("Things",
            [this, code, message](const ProviderCall&) { return manager_.failure(code, message); });
        return errorOf("GetInstance", parameter("InstanceName", thing()));
    }

    ScriptedManager manager_;
    const std::string ofThing_ = classOf("ClassName", "Thing");
};

TEST_F(DispatcherFaultTest, AProvidersCodeAndTextAreTheAnswer)
{
    EXPECT_EQ(errorOfProvider(CMPI_RC_ERR_FAILED, "no luck"), "1: no luck");
    EXPECT_EQ(errorOfProvider(CMPI_RC_ERR_ACCESS_DENIED, "a < b & \"c\""),
        "2: a &lt; b &amp; &quot;c&quot;");
    EXPECT_EQ(errorOfProvider(CMPI_RC_ERR_SERVER_LIMITS_EXCEEDED, "full"), "27: full");
    EXPECT_EQ(errorOfProvider(CMPI_RC_ERR_QUERY_FEATURE_NOT_SUPPORTED, "last"), "29: last");
}

TEST_F(DispatcherFaultTest, CodesThatTheProtocolDoesNotHaveAreFailures)
{
    for (const CMPIrc code : {CMPI_RC_NO_MORE_ELEMENTS, CMPI_RC_DO_NOT_UNLOAD,
             CMPI_RC_ERR_INVALID_HANDLE, CMPI_RC_ERROR_SYSTEM, CMPI_RC_ERROR})
        EXPECT_EQ(errorOfProvider(code, "odd"), "1: odd");
}

TEST_F(DispatcherFaultTest, AfterAFailureNothingIsLeftOfWhatWasDelivered)
{
    manager_.script("Things", [this](const ProviderCall& asked) {
        for (int count = 0; count < 100; ++count)
            manager_.deliver(asked, "Thing", "a");
        return manager_.failure(CMPI_RC_ERR_FAILED, "too late");
    });
    for (const char* const operation : {"EnumerateInstances", "EnumerateInstanceNames",
             "OpenEnumerateInstances", "OpenEnumerateInstancePaths"}) {
        const std::string answer = ask(operation, ofThing_);
        EXPECT_EQ(errorIn(answer), "1: too late");
        EXPECT_THAT(answer, Not(HasSubstr("IRETURNVALUE")));
    }
}

TEST_F(DispatcherFaultTest, AnAnswerThatLacksObjectsIsNone)
{
    manager_.script("Things", [this](const ProviderCall& asked) {
        manager_.deliver(asked, "Thing", "a");
        CMReturnInstance(asked.result, nullptr);
        CMReturnObjectPath(asked.result, nullptr);
        return ok;
    });
    EXPECT_EQ(errorOf("EnumerateInstances", ofThing_),
        "1: the provider could not build 2 of the objects");
}

TEST_F(DispatcherFaultTest, AProviderThatThrowsIsAFailure)
{
    manager_.script(
        "Things", [](const ProviderCall&) -> CMPIStatus { throw std::runtime_error("ouch"); });
    EXPECT_EQ(errorOf("EnumerateInstances", ofThing_), "1: Things: ouch");
}

TEST_F(DispatcherFaultTest, NothingIsReadOfOperationsThatChangeSomethingOrQuery)
{
    manager_.script("Things", [](const ProviderCall&) {
        ADD_FAILURE() << "was asked";
        return ok;
    });
    for (const std::string operation : {"CreateInstance", "ModifyInstance", "DeleteInstance",
             "SetProperty", "CreateClass", "ModifyClass", "DeleteClass", "SetQualifier",
             "DeleteQualifier", "ExecQuery", "OpenQueryInstances"})
        EXPECT_EQ(errorOf(operation, parameter("InstanceName", thing()) + "<IPARAMVALUE/>"),
            "7: operation &quot;" + operation + "&quot; is not offered");
}

TEST_F(DispatcherFaultTest, AMethodOfAClassIsNotAvailable)
{
    EXPECT_EQ(errorIn(answerTo(*manager_,
                  CimXmlTests::withHead(
                      "<SIMPLEREQ><METHODCALL NAME=\"Reset\"><LOCALCLASSPATH><LOCALNAMESPACEPATH>"
                      "<NAMESPACE NAME=\"root\"/><NAMESPACE NAME=\"test\"/></LOCALNAMESPACEPATH>"
                      "<CLASSNAME NAME=\"thing\"/></LOCALCLASSPATH></METHODCALL></SIMPLEREQ>"))),
        "16: class Thing offers no method Reset");
}

TEST_F(DispatcherFaultTest, AnElementThatLacksSomethingIsNoAnswer)
{
    EXPECT_THROW(ask("GetInstance", parameter("InstanceName", "<INSTANCENAME/>")),
        Host::CimXml::RequestError);
    // The failed request has left no state on the thread.
    EXPECT_EQ(errorOf("EnumerateInstances", ofThing_), "");
}

} // namespace

} // namespace OperationTests
