// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/http/HeaderCheck.h"

#include "host/broker/Names.h"
#include "host/cimxml/Message.h"
#include "platform/text/Trim.h"

#include <microhttpd.h>

#include <algorithm>
#include <charconv>
#include <string_view>
#include <system_error>

namespace Host::Http {

namespace {

constexpr std::string_view mismatch = "header-mismatch"; // a CIMError of DSP0200

// The extension that an M-POST declares, as DSP0200 names it.
constexpr std::string_view mappingExtension = "http://www.dmtf.org/cim/mapping/http/v1.0";

// Returns whether the text is a token as RFC 9110, 5.6.2 defines it.
bool isToken(std::string_view text)
{
    constexpr std::string_view punctuation = "!#$%&'*+-.^_`|~";
    return !text.empty() && std::all_of(text.begin(), text.end(), [&](char c) {
        return (c >= '0' && c <= '9') || (foldCase(c) >= 'a' && foldCase(c) <= 'z') ||
               punctuation.find(c) != std::string_view::npos;
    });
}

bool isControl(char c)
{
    return (c >= '\0' && c < ' ' && c != '\t') || c == '\x7F';
}

// Refuses what a proxy may parse differently: white space in a name (RFC 9112, 5.1) and control
// characters in a value (RFC 9110, 5.5). libmicrohttpd ends values at a zero.
void checkFields(const RequestHead& head)
{
    for (const HeaderField& field : head.fields) {
        if (!isToken(field.name))
            throw HttpError::closing(
                MHD_HTTP_BAD_REQUEST, "the name of a header field holds a character it must not");
        if (std::any_of(field.value.begin(), field.value.end(), isControl))
            throw HttpError::closing(MHD_HTTP_BAD_REQUEST,
                "the header field " + field.name + " holds a control character");
    }
}

// Decodes percent signs (RFC 3986, 2.1); one that is not followed by two digits stays.
std::string decoded(std::string_view text)
{
    std::string result(text);
    result.resize(::MHD_http_unescape(result.data()));
    return result;
}

// Returns the path of a target in origin form or in absolute form (RFC 9112, 3.2).
std::string_view pathIn(std::string_view target)
{
    const std::size_t schemeEnd = target.find("://");
    const std::string_view scheme = target.substr(0, schemeEnd);
    if (schemeEnd != std::string_view::npos &&
        (equalNames(scheme, "http") || equalNames(scheme, "https"))) {
        target.remove_prefix(schemeEnd + 3);
        const std::size_t hostEnd = std::min(target.find_first_of("/?"), target.size());
        if (hostEnd == 0)
            return {};
        target.remove_prefix(hostEnd);
        if (!target.starts_with('/'))
            return "/";
    }
    return target.substr(0, target.find('?'));
}

void checkTargetAndMethod(const RequestHead& head)
{
    const bool isPost = head.method == "POST" || head.method == "M-POST";
    const bool isAsterisk = head.target == "*" && !isPost;
    const std::string path = pathOf(head);
    if (!isAsterisk && path != "/cimom" && path != "/")
        throw HttpError(MHD_HTTP_NOT_FOUND, "requests go to /cimom");
    if (!isPost)
        throw HttpError(MHD_HTTP_METHOD_NOT_ALLOWED, "requests are made by POST or M-POST", {},
            {{"Allow", "POST, M-POST"}});
}

// Returns the two digits that stand before the field names of an M-POST (RFC 2774, 5).
std::string extensionPrefixOf(const RequestHead& head)
{
    const auto declared = head.find("Man");
    if (!declared)
        throw HttpError(MHD_HTTP_BAD_REQUEST, "an M-POST must have the header field Man");
    const auto [extension, parameters] = parseParameters(*declared);
    if (withoutQuotes(extension) != mappingExtension)
        throw HttpError(MHD_HTTP_NOT_EXTENDED,
            "the only mandatory extension is " + std::string(mappingExtension));
    const bool isNamespace = parameters.size() == 1 && equalNames(parameters[0].name, "ns");
    const std::string_view prefix = isNamespace ? parameters[0].value : "";
    if (prefix.size() != 2 || prefix.find_first_not_of("0123456789") != std::string_view::npos)
        throw HttpError(
            MHD_HTTP_BAD_REQUEST, "the header field Man must end with ;ns= and two digits");
    return std::string(prefix);
}

bool isXmlInUtf8(std::string_view contentType)
{
    const auto [type, parameters] = parseParameters(contentType);
    return (equalNames(type, "application/xml") || equalNames(type, "text/xml")) &&
           std::none_of(parameters.begin(), parameters.end(), [](const auto& parameter) {
               return equalNames(parameter.name, "charset") &&
                      !equalNames(withoutQuotes(parameter.value), "utf-8");
           });
}

// DSP0200 allows no other encoding.
void checkContent(const RequestHead& head)
{
    const auto type = head.find("Content-Type");
    if (!type || !isXmlInUtf8(*type))
        throw HttpError(MHD_HTTP_UNSUPPORTED_MEDIA_TYPE,
            "the Content-Type must be application/xml or text/xml, in utf-8");
    const auto coding = head.find("Content-Encoding");
    if (coding && !equalNames(*coding, "identity"))
        throw HttpError(MHD_HTTP_UNSUPPORTED_MEDIA_TYPE, "the body must not be compressed");
}

void checkOperation(const RequestHead& head, const std::string& prefix)
{
    const auto operation = head.find(prefix + "CIMOperation");
    if (!operation || !equalNames(*operation, "MethodCall"))
        throw HttpError(MHD_HTTP_BAD_REQUEST, "the header field CIMOperation must be MethodCall",
            "unsupported-operation");
    const auto version = head.find(prefix + "CIMProtocolVersion");
    if (version && !version->starts_with("1."))
        throw HttpError(MHD_HTTP_NOT_IMPLEMENTED, "the CIMProtocolVersion must be 1.x",
            "unsupported-protocol-version");
}

// DSP0200 has clients encode what a field must not contain.
std::optional<std::string> findDecoded(const RequestHead& head, const std::string& name)
{
    const auto value = head.find(name);
    return value ? std::optional(decoded(*value)) : std::nullopt;
}

// Returns the namespace of an object path with or without host, class and keys.
std::string_view nameSpaceIn(std::string_view object)
{
    if (object.starts_with("//")) {
        const std::size_t end = object.find('/', 2);
        object.remove_prefix(end == std::string_view::npos ? object.size() : end);
    }
    return Text::trimmed(object.substr(0, object.find(':')), "/");
}

} // namespace

// RFC 9112, 6.3: a message whose length others may compute differently is refused.
BodySize bodySizeOf(const RequestHead& head)
{
    checkFields(head);
    BodySize body;
    if (const auto expectation = head.find("Expect")) {
        if (!equalNames(*expectation, "100-continue"))
            throw HttpError::closing(
                MHD_HTTP_EXPECTATION_FAILED, "the only expectation met is 100-continue");
        body.isAwaited = true;
    }
    const auto length = head.find("Content-Length");
    if (const auto coding = head.find("Transfer-Encoding")) {
        if (!equalNames(*coding, "chunked"))
            throw HttpError::closing(
                MHD_HTTP_NOT_IMPLEMENTED, "the only Transfer-Encoding is chunked");
        if (length)
            throw HttpError::closing(
                MHD_HTTP_BAD_REQUEST, "both Content-Length and Transfer-Encoding are there");
        if (head.version == "HTTP/1.0")
            throw HttpError::closing(MHD_HTTP_BAD_REQUEST, "HTTP/1.0 knows no Transfer-Encoding");
        return body;
    }
    body.bytes = 0;
    if (!length)
        return body;
    const char* const end = length->data() + length->size();
    const auto [stop, error] = std::from_chars(length->data(), end, *body.bytes);
    if (error == std::errc::result_out_of_range)
        throw HttpError::closing(MHD_HTTP_CONTENT_TOO_LARGE, "the body is far too large");
    if (error != std::errc{} || stop != end)
        throw HttpError::closing(MHD_HTTP_BAD_REQUEST, "the Content-Length is no number");
    return body;
}

void checkHost(const RequestHead& head)
{
    if (!head.find("Host") && head.version != "HTTP/1.0")
        throw HttpError::closing(MHD_HTTP_BAD_REQUEST, "the header field Host is missing");
}

std::string pathOf(const RequestHead& head)
{
    return decoded(pathIn(head.target));
}

CallHead checkHead(const RequestHead& head, const BodySize& body, const Limits& limits)
{
    checkHost(head);
    checkTargetAndMethod(head);
    CallHead call;
    if (head.method == "M-POST")
        call.extension = extensionPrefixOf(head);
    const std::string prefix = call.extension ? *call.extension + "-" : "";
    checkContent(head);
    if (body.bytes && !head.find("Content-Length"))
        throw HttpError::closing(MHD_HTTP_LENGTH_REQUIRED,
            "neither Content-Length nor Transfer-Encoding says where the body ends");
    if (body.bytes && *body.bytes > limits.maximumBody)
        throw HttpError(MHD_HTTP_CONTENT_TOO_LARGE,
            "a body holds at most " + std::to_string(limits.maximumBody) + " bytes");
    checkOperation(head, prefix);
    call.method = findDecoded(head, prefix + "CIMMethod");
    call.object = findDecoded(head, prefix + "CIMObject");
    return call;
}

void requireMatch(const CallHead& head, const CimXml::Message& message)
{
    const auto refuse = [](const std::string& reason) {
        throw HttpError(MHD_HTTP_BAD_REQUEST, reason, mismatch);
    };
    if (!head.method)
        refuse("the header field CIMMethod is missing");
    if (!head.object)
        refuse("the header field CIMObject is missing");
    if (!equalNames(*head.method, message.methodName()))
        refuse("CIMMethod is " + *head.method + ", but the body calls " + message.methodName());
    if (!equalNames(nameSpaceIn(*head.object), message.nameSpace()))
        refuse("CIMObject is " + *head.object + ", but the body is for " + message.nameSpace());
}

std::vector<HeaderField> answerFieldsFor(const CallHead& head)
{
    std::vector<HeaderField> fields{{"Content-Type", "application/xml; charset=utf-8"}};
    if (!head.extension) {
        fields.push_back({"CIMOperation", "MethodResponse"});
        return fields;
    }
    fields.push_back({"Man", std::string(mappingExtension) + ";ns=" + *head.extension});
    fields.push_back({"Ext", ""});
    fields.push_back({"Cache-Control", "no-cache"});
    fields.push_back({*head.extension + "-CIMOperation", "MethodResponse"});
    return fields;
}

} // namespace Host::Http
