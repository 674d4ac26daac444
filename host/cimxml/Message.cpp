// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/cimxml/Message.h"

#include "host/cimxml/MessageParts.h"

#include <algorithm>

namespace Host::CimXml {

namespace {

void requireMajorVersion(
    const Element& element, const char* attribute, std::string_view major, Outcome outcome)
{
    const std::string_view version = element.attribute(attribute);
    if (!version.starts_with(std::string(major) + "."))
        element.fail(std::string(attribute) + " is not " + std::string(major) + ".x", outcome);
}

Element messageOf(const Element& root)
{
    if (!root.is("CIM"))
        root.fail("the outermost element must be CIM");
    requireMajorVersion(root, "CIMVERSION", "2", Outcome::unsupportedCimVersion);
    requireMajorVersion(root, "DTDVERSION", "2", Outcome::unsupportedDtdVersion);
    const Element message = root.child({"MESSAGE", "DECLARATION"});
    if (message.is("DECLARATION"))
        message.fail("declarations are no request", Outcome::requestNotValid);
    requireMajorVersion(message, "PROTOCOLVERSION", "1", Outcome::unsupportedProtocolVersion);
    return message;
}

// The single request, which is not looked into when there are several or it is of another kind.
Element requestOf(const Element& message)
{
    const Element request = message.child({"SIMPLEREQ", "MULTIREQ", "SIMPLEEXPREQ", "MULTIEXPREQ",
        "SIMPLERSP", "MULTIRSP", "SIMPLEEXPRSP", "MULTIEXPRSP", "SIMPLEREQACK"});
    if (request.is("MULTIREQ") || request.is("MULTIEXPREQ"))
        request.fail("several requests in one message", Outcome::multipleRequestsUnsupported);
    if (request.is("SIMPLEEXPREQ"))
        request.fail("indications are not received here", Outcome::unsupportedOperation);
    if (!request.is("SIMPLEREQ"))
        request.fail("it is no request", Outcome::requestNotValid);
    return request;
}

Element onlyCallOf(const Element& request)
{
    std::optional<Element> call;
    for (const Element& child : request.children({"CORRELATOR", "IMETHODCALL", "METHODCALL"})) {
        if (child.is("CORRELATOR"))
            continue;
        if (call)
            child.fail("a second call");
        call = child;
    }
    if (!call)
        request.fail("it holds no call");
    return *call;
}

} // namespace

Element callOf(const Document& document)
{
    return onlyCallOf(document.root().child({"MESSAGE"}).child({"SIMPLEREQ"}));
}

Element pathOf(const Element& call)
{
    std::optional<Element> path;
    for (const Element& child : call.children()) {
        const bool isPath = call.is("IMETHODCALL")
                                ? child.is("LOCALNAMESPACEPATH")
                                : child.is("LOCALCLASSPATH") || child.is("LOCALINSTANCEPATH");
        if (!isPath)
            continue;
        if (path)
            child.fail("a second path");
        path = child;
    }
    if (!path)
        call.fail("it says nowhere which namespace or object it is for");
    return *path;
}

std::string nameSpaceOf(const Element& localNameSpacePath)
{
    std::string all;
    for (const Element& part : localNameSpacePath.children({"NAMESPACE"})) {
        // Some clients write a path of several names into one.
        std::string_view rest = part.attribute("NAME");
        while (!rest.empty()) {
            const std::string_view name = rest.substr(0, rest.find('/'));
            if (!name.empty())
                all.append(all.empty() ? "" : "/").append(name);
            rest.remove_prefix(std::min(name.size() + 1, rest.size()));
        }
    }
    if (all.empty())
        localNameSpacePath.fail("it names no namespace");
    return all;
}

Message::Message(std::string_view body, std::size_t maximumDepth)
    : document_(std::make_unique<const Document>(body, maximumDepth)), size_(body.size())
{
    const Element message = messageOf(document_->root());
    id_ = message.attribute("ID");
    protocolVersion_ = message.attribute("PROTOCOLVERSION");
    const Element call = onlyCallOf(requestOf(message));
    methodName_ = call.attribute("NAME");
    isIntrinsic_ = call.is("IMETHODCALL");
    const Element path = pathOf(call);
    if (isIntrinsic_) {
        nameSpace_ = nameSpaceOf(path);
        return;
    }
    for (const Element& child : path.children({"LOCALNAMESPACEPATH", "CLASSNAME", "INSTANCENAME"}))
        if (child.is("LOCALNAMESPACEPATH"))
            nameSpace_ = nameSpaceOf(child);
    if (nameSpace_.empty())
        path.fail("it holds no LOCALNAMESPACEPATH");
}

Message::~Message() = default;
Message::Message(Message&&) noexcept = default;
Message& Message::operator=(Message&&) noexcept = default;

} // namespace Host::CimXml
