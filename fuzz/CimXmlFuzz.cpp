// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// For any bytes of a request, the reader returns an operation or throws a RequestError or a
// Refusal, and a path that was read is the same after it was written and read again.

#include "host/broker/Broker.h"
#include "host/broker/ObjectPath.h"
#include "host/broker/Refusal.h"
#include "host/broker/Request.h"
#include "host/cimxml/Message.h"
#include "host/cimxml/RequestError.h"
#include "host/cimxml/ResponseWriter.h"
#include "host/repository/Compiler.h"

#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <optional>

namespace {

using Host::CimXml::Message;
using Host::CimXml::Operation;

const Host::Repository& classes()
{
    static const auto compiled = [] {
        Host::Compiler compiler;
        compiler.compileText(R"(
Qualifier Key : boolean = false, Scope(property, reference), Flavor(DisableOverride);
Qualifier Association : boolean = false, Scope(association), Flavor(DisableOverride);
class A {
    [Key] string S;
    [Key] uint16 N;
    sint8 L[];
    datetime D;
    boolean B;
    real32 R;
    char16 C;
};
class One { [Key] string Id; };
[Association]
class Link { [Key] A ref Owner; [Key] One ref Part; };
)",
            "self.mof", "root/test");
        return std::move(compiler).finish();
    }();
    return *compiled;
}

std::optional<Operation> tryRead(std::string_view text)
{
    try {
        return readOperation(Message(text), classes());
    } catch (const Host::CimXml::RequestError& error) {
        if (error.line() == 0 || error.offset() > text.size())
            std::abort();
    } catch (const Host::Refusal& refusal) {
        if (refusal.code() == CMPI_RC_OK)
            std::abort();
    }
    return std::nullopt;
}

// The response to an operation is well-formed XML, and no request.
void requireWellFormedResponse(std::string_view request, const Operation& operation)
{
    Host::CimXml::ResponseWriter writer(Message(request), operation.kind, classes(),
        {"host", operation.nameSpace}, operation.selection);
    std::string response;
    writer.begin(response);
    if (operation.path != nullptr)
        writer.path(response, *operation.path);
    writer.finish(response);
    try {
        const Message none(response);
        std::abort();
    } catch (const Host::CimXml::RequestError& error) {
        if (error.outcome() == Host::CimXml::Outcome::requestNotWellFormed)
            std::abort();
    }
}

void requireRoundTrip(const Host::ObjectPath& path)
{
    std::string name = "<CIM CIMVERSION='2.0' DTDVERSION='2.0'><MESSAGE ID='1' "
                       "PROTOCOLVERSION='1.0'><SIMPLEREQ><IMETHODCALL NAME='GetInstance'>"
                       "<LOCALNAMESPACEPATH><NAMESPACE NAME='root/test'/></LOCALNAMESPACEPATH>"
                       "<IPARAMVALUE NAME='InstanceName'>";
    Host::CimXml::writeInstanceName(name, path);
    name += "</IPARAMVALUE></IMETHODCALL></SIMPLEREQ></MESSAGE></CIM>";
    const auto again = tryRead(name);
    if (!again || again->path->toText() != path.toText())
        std::abort();
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size);

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    static const Host::Broker broker;
    const Host::Request request(broker);
    const std::string_view text(reinterpret_cast<const char*>(data), size);
    if (const auto operation = tryRead(text)) {
        requireWellFormedResponse(text, *operation);
        if (operation->path != nullptr)
            requireRoundTrip(*operation->path);
    }
    return 0;
}
