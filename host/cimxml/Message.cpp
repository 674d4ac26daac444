// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/cimxml/Message.h"

#include "host/cimxml/PathReader.h"

namespace Host::CimXml {

namespace {

void requireMajorVersion(
    const Element& element, const char* attribute, std::string_view major, Outcome outcome)
{
    const std::string_view version = element.attribute(attribute);
    if (!version.starts_with(std::string(major) + "."))
        element.fail(std::string(attribute) + " is not " + std::string(major) + ".x", outcome);
}

const Element& messageOf(const Element& root)
{
    if (!root.is("CIM"))
        root.fail("the outermost element must be CIM");
    requireMajorVersion(root, "CIMVERSION", "2", Outcome::unsupportedCimVersion);
    requireMajorVersion(root, "DTDVERSION", "2", Outcome::unsupportedDtdVersion);
    const Element& message = root.child({"MESSAGE", "DECLARATION"});
    if (message.is("DECLARATION"))
        message.fail("declarations are no request", Outcome::requestNotValid);
    requireMajorVersion(message, "PROTOCOLVERSION", "1", Outcome::unsupportedProtocolVersion);
    return message;
}

// Returns the single request. Throws RequestError for several requests and for other kinds of
// messages, without reading their contents.
const Element& requestOf(const Element& message)
{
    const Element& request = message.child({"SIMPLEREQ", "MULTIREQ", "SIMPLEEXPREQ", "MULTIEXPREQ",
        "SIMPLERSP", "MULTIRSP", "SIMPLEEXPRSP", "MULTIEXPRSP", "SIMPLEREQACK"});
    if (request.is("MULTIREQ") || request.is("MULTIEXPREQ"))
        request.fail("several requests in one message", Outcome::multipleRequestsUnsupported);
    if (request.is("SIMPLEEXPREQ"))
        request.fail("indications are not received here", Outcome::unsupportedOperation);
    if (!request.is("SIMPLEREQ"))
        request.fail("it is no request", Outcome::requestNotValid);
    return request;
}

const Element& callOf(const Element& request)
{
    const Element* call = nullptr;
    for (const Element& child : request.children({"CORRELATOR", "IMETHODCALL", "METHODCALL"})) {
        if (child.is("CORRELATOR"))
            continue;
        if (call != nullptr)
            child.fail("a second call");
        call = &child;
    }
    if (call == nullptr)
        request.fail("it holds no call");
    return *call;
}

const Element& pathOf(const Element& call)
{
    const Element* path = nullptr;
    for (const Element& child : call.children()) {
        const bool isPath = call.is("IMETHODCALL")
                                ? child.is("LOCALNAMESPACEPATH")
                                : child.is("LOCALCLASSPATH") || child.is("LOCALINSTANCEPATH");
        if (!isPath)
            continue;
        if (path != nullptr)
            child.fail("a second path");
        path = &child;
    }
    if (path == nullptr)
        call.fail("it says nowhere which namespace or object it is for");
    return *path;
}

} // namespace

Message::Message(std::string_view body, std::size_t maximumDepth)
    : root_(readDocument(body, maximumDepth)), size_(body.size())
{
    const Element& message = messageOf(root_);
    id_ = message.attribute("ID");
    protocolVersion_ = message.attribute("PROTOCOLVERSION");
    call_ = &callOf(requestOf(message));
    methodName_ = call_->attribute("NAME");
    isIntrinsic_ = call_->is("IMETHODCALL");
    path_ = &pathOf(*call_);
    if (isIntrinsic_) {
        nameSpace_ = nameSpaceOf(*path_);
        return;
    }
    for (const Element& child :
        path_->children({"LOCALNAMESPACEPATH", "CLASSNAME", "INSTANCENAME"}))
        if (child.is("LOCALNAMESPACEPATH"))
            nameSpace_ = nameSpaceOf(child);
    if (nameSpace_.empty())
        path_->fail("it holds no LOCALNAMESPACEPATH");
}

} // namespace Host::CimXml
