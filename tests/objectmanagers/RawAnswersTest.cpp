// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// OpenPegasus, sfcb and `sensorctl serve` answer requests that wbemcli cannot send.

#include "tests/objectmanagers/InstalledManager.h"
#include "tests/support/CimCall.h"
#include "tests/support/HttpClient.h"
#include "tests/tools/ServerProcess.h"
#include "tests/tools/ToolTest.h"

#include <cstdint>
#include <memory>
#include <string>
#include <utility>

namespace {

using namespace Testing;

const std::string sensorClass = cimClassParameter("ZUMLO_NumericSensor");

std::string value(const std::string& name, const std::string& content)
{
    return cimParameter(name, "<VALUE>" + content + "</VALUE>");
}

std::string query(const std::string& language)
{
    return value("QueryLanguage", language) + value("Query", "SELECT * FROM ZUMLO_NumericSensor");
}

// The object managers with the providers and a small model.
class Machine : public ToolTest {
public:
    Machine()
    {
        for (const InstalledManager* each :
            {&InstalledManager::openPegasus(), &InstalledManager::sfcb()}) {
            each->reset();
            each->startWithProviders(settings_);
        }
    }

    unsigned servicePort() const { return service_.port(); }

private:
    void TestBody() override {}

    const std::map<std::string, std::string> settings_ = {
        {"RYNLOG_LOG", "off"}, {"VORN_INSTRUMENTATION", "model:" + smallModel()}};
    ServerProcess service_{{}, settings_};
};

class RawAnswersTest : public testing::Test {
protected:
    static void SetUpTestSuite() { machine_ = std::make_unique<Machine>(); }
    static void TearDownTestSuite() { machine_.reset(); }

    static std::string fromOpenPegasus(const std::string& operation, const std::string& parameters)
    {
        return answer(InstalledManager::openPegasus().port(), operation, parameters);
    }
    static std::string fromSfcb(const std::string& operation, const std::string& parameters)
    {
        return answer(InstalledManager::sfcb().port(), operation, parameters);
    }
    static std::string fromService(const std::string& operation, const std::string& parameters)
    {
        return answer(machine_->servicePort(), operation, parameters);
    }

    static std::string bodyOf(
        unsigned port, const std::string& operation, const std::string& parameters)
    {
        HttpClient client(static_cast<std::uint16_t>(port));
        client.send(cimRequest(operation, parameters));
        return client.receive().body;
    }

    // Returns the code of an error; else how many instances there are, and whether they have the
    // property CurrentReading and qualifiers.
    static std::string answer(
        unsigned port, const std::string& operation, const std::string& parameters)
    {
        const std::string body = bodyOf(port, operation, parameters);
        const std::string error = "<ERROR CODE=\"";
        if (const auto at = body.find(error); at != std::string::npos)
            return "error " + std::to_string(std::stoi(body.substr(at + error.size())));
        const auto has = [&](const char* text) { return body.find(text) != std::string::npos; };
        return std::to_string(countOf(body, "<INSTANCE ")) + " instances" +
               (has("NAME=\"CurrentReading\"") ? " with readings" : "") +
               (has("<QUALIFIER ") ? " and qualifiers" : "");
    }

    static inline std::unique_ptr<Machine> machine_;
};

TEST_F(RawAnswersTest, AreInstancesForQueriesInSfcbOnly)
{
    for (const char* language : {"WQL", "CIM:CQL", "DMTF:CQL"}) {
        EXPECT_EQ(fromOpenPegasus("ExecQuery", query(language)), "error 7") << language;
        EXPECT_EQ(fromSfcb("ExecQuery", query(language)), "5 instances with readings") << language;
        EXPECT_EQ(fromService("ExecQuery", query(language)), "error 7") << language;
    }
}

TEST_F(RawAnswersTest, AreErrorsForPulledEnumerationsInSfcbOnly)
{
    const std::string parameters = sensorClass + value("MaxObjectCount", "10");
    EXPECT_EQ(fromOpenPegasus("OpenEnumerateInstances", parameters), "5 instances with readings");
    EXPECT_EQ(fromSfcb("OpenEnumerateInstances", parameters), "error 1");
    EXPECT_EQ(fromService("OpenEnumerateInstances", parameters), "5 instances with readings");
}

TEST_F(RawAnswersTest, LeaveOutPropertiesOfSubclassesButInSfcb)
{
    const std::string parameters =
        cimClassParameter("CIM_Sensor") + value("DeepInheritance", "FALSE");
    EXPECT_EQ(fromOpenPegasus("EnumerateInstances", parameters), "5 instances");
    EXPECT_EQ(fromSfcb("EnumerateInstances", parameters), "5 instances with readings");
    EXPECT_EQ(fromService("EnumerateInstances", parameters), "5 instances");
}

TEST_F(RawAnswersTest, HaveQualifiersButInSfcb)
{
    const std::string parameters = sensorClass + value("IncludeQualifiers", "TRUE");
    EXPECT_EQ(fromOpenPegasus("EnumerateInstances", parameters),
        "5 instances with readings and qualifiers");
    EXPECT_EQ(fromSfcb("EnumerateInstances", parameters), "5 instances with readings");
    EXPECT_EQ(
        fromService("EnumerateInstances", parameters), "5 instances with readings and qualifiers");
}

TEST_F(RawAnswersTest, HaveHostsAtBothEndsOfReferencesButInSfcb)
{
    const std::string parameters =
        cimParameter("ObjectName", cimInstanceName("ZUMLO_SensorEnabledLogicalElementCapabilities",
                                       {{"InstanceID", "ZUMLO:SensorEnabledLogicalElementCap1"}})) +
        cimParameter("ResultClass", "<CLASSNAME NAME=\"ZUMLO_SensorElementCapabilities\"/>");
    for (const auto& [operation, references] :
        {std::pair("References", 20U), {"ReferenceNames", 10U}})
        for (const unsigned port : {InstalledManager::openPegasus().port(),
                 InstalledManager::sfcb().port(), machine_->servicePort()}) {
            const std::string body = replaced(bodyOf(port, operation, parameters), "\n", "");
            EXPECT_EQ(countOf(body, "<VALUE.REFERENCE>"), references) << operation << port;
            EXPECT_EQ(countOf(body, "<VALUE.REFERENCE><INSTANCEPATH><NAMESPACEPATH><HOST>"),
                port == InstalledManager::sfcb().port() ? 0U : references)
                << operation << port;
        }
}

} // namespace
