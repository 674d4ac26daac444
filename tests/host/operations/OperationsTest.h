// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Sends messages to a handler and reads its responses.

#pragma once

#include "host/cimxml/Message.h"
#include "host/cimxml/OperationHandler.h"
#include "tests/host/cimxml/CimXmlTest.h"
#include "tests/support/Texts.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <string>
#include <string_view>

namespace OperationTests {

using CimXmlTests::classOf;
using CimXmlTests::parameter;
using CimXmlTests::valueOf;
using Host::CimXml::Caller;
using Host::CimXml::Message;
using Host::CimXml::OperationHandler;
using Host::CimXml::Response;
using Testing::countOf;

inline std::string callIn(
    const std::string& nameSpace, const std::string& operation, const std::string& parameters = {})
{
    std::string parts;
    for (std::size_t at = 0; at < nameSpace.size();) {
        const std::size_t end = std::min(nameSpace.find('/', at), nameSpace.size());
        parts += "<NAMESPACE NAME=\"" + nameSpace.substr(at, end - at) + "\"/>";
        at = end + 1;
    }
    return CimXmlTests::withHead("<SIMPLEREQ><IMETHODCALL NAME=\"" + operation +
                                 "\"><LOCALNAMESPACEPATH>" + parts + "</LOCALNAMESPACEPATH>" +
                                 parameters + "</IMETHODCALL></SIMPLEREQ>");
}

inline std::string textOf(Response& answer)
{
    std::string text;
    while (answer.append(text)) {}
    return text;
}

inline std::string answerTo(
    OperationHandler& handler, const std::string& body, const Caller& caller = {})
{
    return textOf(*handler.answer(Message(body), caller));
}

// Returns the text between the first occurrences of two texts; an empty text when they do not
// occur.
inline std::string between(
    const std::string& text, const std::string& begin, const std::string& end)
{
    const auto from = text.find(begin);
    if (from == std::string::npos)
        return {};
    const auto to = text.find(end, from + begin.size());
    return text.substr(from + begin.size(), to - from - begin.size());
}

// Returns the code and the description of an error, such as `6: there is no ...`; an empty text for
// any other response.
inline std::string errorIn(const std::string& answer)
{
    const std::string code = between(answer, "<ERROR CODE=\"", "\"");
    return code.empty() ? "" : code + ": " + between(answer, " DESCRIPTION=\"", "\">");
}

inline std::string contextIn(const std::string& answer)
{
    return between(
        answer, "<PARAMVALUE NAME=\"EnumerationContext\" PARAMTYPE=\"string\"><VALUE>", "</VALUE>");
}

inline bool isEndOfSequence(const std::string& answer)
{
    return between(answer, "<PARAMVALUE NAME=\"EndOfSequence\" PARAMTYPE=\"boolean\"><VALUE>",
               "</VALUE>") == "TRUE";
}

} // namespace OperationTests
