// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Classes for the tests, and functions that complete, read and answer requests.

#pragma once

#include "host/broker/Broker.h"
#include "host/broker/Refusal.h"
#include "host/broker/Request.h"
#include "host/cimxml/Message.h"
#include "host/cimxml/RequestError.h"
#include "host/cimxml/ResponseWriter.h"
#include "tests/host/repository/MofTest.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <string>
#include <string_view>

namespace CimXmlTests {

using Host::CimXml::Message;
using Host::CimXml::Operation;

inline constexpr std::string_view Classes = R"(
[Description("A <thing>")]
class Thing {
    [Key] string Name;
    [Key] uint16 Index;
    string Label = "none";
    boolean IsOn;
    sint32 Levels[];
    datetime Since;
    real64 Reading;
};
class Gauge : Thing {
    uint8 Percent;
    [Override("Label")] string Label = "gauge";
};
class Single { [Key] string InstanceID; };
class Flag { [Key] boolean On; [Key] sint8 Level; [Key] datetime At; };
[Association]
class Link { [Key] Thing ref Owner; [Key] Single ref Part; };
)";

inline std::string withHead(const std::string& body)
{
    return R"(<?xml version="1.0" encoding="utf-8" ?>)"
           "\n"
           R"(<CIM CIMVERSION="2.0" DTDVERSION="2.0"><MESSAGE ID="4711" PROTOCOLVERSION="1.0">)" +
           body + "</MESSAGE></CIM>";
}

inline std::string call(const std::string& operation, const std::string& parameters = {})
{
    return withHead("<SIMPLEREQ><IMETHODCALL NAME=\"" + operation +
                    "\"><LOCALNAMESPACEPATH><NAMESPACE NAME=\"root\"/><NAMESPACE NAME=\"test\"/>"
                    "</LOCALNAMESPACEPATH>" +
                    parameters + "</IMETHODCALL></SIMPLEREQ>");
}

inline std::string parameter(const std::string& name, const std::string& content)
{
    return "<IPARAMVALUE NAME=\"" + name + "\">" + content + "</IPARAMVALUE>";
}

inline std::string valueOf(const std::string& name, const std::string& value)
{
    return parameter(name, "<VALUE>" + value + "</VALUE>");
}

inline std::string classOf(const std::string& name, const std::string& className)
{
    return parameter(name, "<CLASSNAME NAME=\"" + className + "\"/>");
}

inline std::string binding(const std::string& name, const std::string& value)
{
    return "<KEYBINDING NAME=\"" + name + "\"><KEYVALUE>" + value + "</KEYVALUE></KEYBINDING>";
}

inline std::string instanceName(const std::string& className, const std::string& keys)
{
    return "<INSTANCENAME CLASSNAME=\"" + className + "\">" + keys + "</INSTANCENAME>";
}

inline std::string thing()
{
    return instanceName("Thing", binding("Name", "a") + binding("Index", "7"));
}

// Returns the outcome as text; "read" when the request is accepted.
inline std::string outcomeOf(const std::string& body)
{
    try {
        const Message message(body);
        return "read";
    } catch (const Host::CimXml::RequestError& error) {
        return std::string(nameOf(error.outcome()));
    }
}

inline std::string errorOf(const std::string& body)
{
    try {
        const Message message(body);
        return "read";
    } catch (const Host::CimXml::RequestError& error) {
        return error.what();
    }
}

class CimXmlTest : public testing::Test {
protected:
    Operation read(const std::string& body) { return readOperation(Message(body), *repository); }

    // Returns the code and the reason of a refusal, the outcome of an error, or "read".
    std::string refusalOf(const std::string& body)
    {
        try {
            read(body);
            return "read";
        } catch (const Host::Refusal& refusal) {
            return std::to_string(refusal.code()) + " " + refusal.what();
        } catch (const Host::CimXml::RequestError& error) {
            return std::string(nameOf(error.outcome())) + " " + error.what();
        }
    }

    std::string pathText(const std::string& name)
    {
        return read(call("GetInstance", parameter("InstanceName", name))).path->toText();
    }
    std::string pathRefusal(const std::string& name)
    {
        return refusalOf(call("GetInstance", parameter("InstanceName", name)));
    }

    // Returns classes that all tests share, since compiling them takes longer than any test.
    static const Host::Repository& classes()
    {
        static const auto compiled = Testing::compile(Classes);
        return *compiled;
    }

    const Host::Repository* repository = &classes();
    Host::Broker broker;
    Host::Request request{broker};
};

} // namespace CimXmlTests
