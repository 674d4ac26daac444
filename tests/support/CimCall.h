// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The texts of calls in CIM-XML; the namespace is root/cimv2 by default.

#pragma once

#include <string>
#include <utility>
#include <vector>

namespace Testing {

// Returns a message with one call. The namespace has two components, of which the second is cimv2.
inline std::string cimCall(const std::string& operation, const std::string& parameters = {},
    const std::string& firstName = "root")
{
    return R"(<?xml version="1.0" encoding="utf-8"?><CIM CIMVERSION="2.0" DTDVERSION="2.0">)"
           R"(<MESSAGE ID="1" PROTOCOLVERSION="1.0"><SIMPLEREQ><IMETHODCALL NAME=")" +
           operation + R"("><LOCALNAMESPACEPATH><NAMESPACE NAME=")" + firstName +
           R"("/><NAMESPACE NAME="cimv2"/></LOCALNAMESPACEPATH>)" + parameters +
           "</IMETHODCALL></SIMPLEREQ></MESSAGE></CIM>";
}

inline std::string cimParameter(const std::string& name, const std::string& content)
{
    return "<IPARAMVALUE NAME=\"" + name + "\">" + content + "</IPARAMVALUE>";
}

inline std::string cimClassParameter(const std::string& className)
{
    return cimParameter("ClassName", "<CLASSNAME NAME=\"" + className + "\"/>");
}

inline std::string cimInstanceName(
    const std::string& className, const std::vector<std::pair<std::string, std::string>>& keys)
{
    std::string text = "<INSTANCENAME CLASSNAME=\"" + className + "\">";
    for (const auto& [key, value] : keys)
        text += "<KEYBINDING NAME=\"" + key + "\"><KEYVALUE>" + value + "</KEYVALUE></KEYBINDING>";
    return text + "</INSTANCENAME>";
}

// Returns the header fields that a server requires of a call, except for its length.
inline std::string cimFields(const std::string& operation)
{
    return "Host: localhost\r\nContent-Type: application/xml\r\nCIMOperation: MethodCall\r\n"
           "CIMMethod: " +
           operation + "\r\nCIMObject: root/cimv2\r\n";
}

inline std::string lengthField(const std::string& body)
{
    return "Content-Length: " + std::to_string(body.size()) + "\r\n";
}

// Returns a whole HTTP request.
inline std::string cimRequest(const std::string& operation, const std::string& parameters = {},
    const std::string& moreFields = {})
{
    const std::string body = cimCall(operation, parameters);
    return "POST /cimom HTTP/1.1\r\n" + cimFields(operation) + lengthField(body) + moreFields +
           "\r\n" + body;
}

} // namespace Testing
