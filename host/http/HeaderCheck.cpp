// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/http/HeaderCheck.h"

#include "host/broker/Names.h"
#include "host/cimxml/Message.h"
#include "host/http/MandatoryExtension.h"
#include "host/http/MediaType.h"

#include <algorithm>
#include <charconv>
#include <string_view>
#include <system_error>

namespace Host::Http {

namespace {

constexpr std::string_view mismatch = "header-mismatch";

bool isControl(char c)
{
    return (c >= '\0' && c < ' ' && c != '\t') || c == '\x7F';
}

// What others may read otherwise: a name with a blank as the same without, a carriage return in
// a value as its end. A zero is seen here only where no HTTP library was before: to it that is the
// end of the value, and it hands on no more.
void checkFields(const RequestHead& head)
{
    for (const HeaderField& field : head.fields) {
        if (!isToken(field.name))
            throw HttpError::closing(
                Status::badRequest, "the name of a header field holds a character it must not");
        if (std::any_of(field.value.begin(), field.value.end(), isControl))
            throw HttpError::closing(Status::badRequest,
                "the header field " + field.name + " holds a control character");
    }
}

void checkHost(const RequestHead& head)
{
    if (!head.find("Host") && head.version != "HTTP/1.0")
        throw HttpError::closing(Status::badRequest, "the header field Host is missing");
}

// What two hexadecimal digits say.
std::optional<char> octet(std::string_view digits)
{
    unsigned value = 0;
    const char* const end = digits.data() + digits.size();
    const auto [stop, error] = std::from_chars(digits.data(), end, value, 16);
    if (digits.size() != 2 || error != std::errc{} || stop != end)
        return std::nullopt;
    return static_cast<char>(value);
}

// With the octets that stand behind percent signs; nothing where one has no two digits.
std::optional<std::string> decoded(std::string_view text)
{
    std::string result;
    for (std::size_t i = 0; i < text.size(); ++i) {
        if (text[i] != '%') {
            result += text[i];
            continue;
        }
        const auto hidden = octet(text.substr(i + 1, 2));
        if (!hidden)
            return std::nullopt;
        result += *hidden;
        i += 2;
    }
    return result;
}

// Without query, and without scheme and host where the target names them, as it does for proxies.
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
    const bool isForTheWholeServer = head.target == "*" && !isPost;
    const auto path = decoded(pathIn(head.target));
    if (!isForTheWholeServer && path != "/cimom" && path != "/")
        throw HttpError(Status::notFound, "requests go to /cimom");
    if (!isPost)
        throw HttpError(Status::methodNotAllowed, "requests are made by POST or M-POST", {},
            {{"Allow", "POST, M-POST"}});
}

void checkContent(const RequestHead& head)
{
    const auto type = head.find("Content-Type");
    if (!type || !isXmlInUtf8(*type))
        throw HttpError(Status::unsupportedMediaType,
            "the Content-Type must be application/xml or text/xml, in utf-8");
    const auto coding = head.find("Content-Encoding");
    if (coding && !equalNames(*coding, "identity"))
        throw HttpError(Status::unsupportedMediaType, "the body must not be compressed");
}

void checkOperation(const RequestHead& head, const std::string& prefix)
{
    const auto operation = head.find(prefix + "CIMOperation");
    if (!operation || !equalNames(*operation, "MethodCall"))
        throw HttpError(Status::badRequest, "the header field CIMOperation must be MethodCall",
            "unsupported-operation");
    const auto version = head.find(prefix + "CIMProtocolVersion");
    if (version && !version->starts_with("1."))
        throw HttpError(Status::notImplemented, "the CIMProtocolVersion must be 1.x",
            "unsupported-protocol-version");
}

std::optional<std::string> findDecoded(const RequestHead& head, const std::string& name)
{
    const auto value = head.find(name);
    if (!value)
        return std::nullopt;
    auto text = decoded(*value);
    if (!text)
        throw HttpError(Status::badRequest,
            "the header field " + name + " holds a percent sign without two digits", mismatch);
    return text;
}

// Of a path with or without host, class and keys.
std::string_view nameSpaceIn(std::string_view object)
{
    if (object.starts_with("//")) {
        const std::size_t end = object.find('/', 2);
        object.remove_prefix(end == std::string_view::npos ? object.size() : end);
    }
    object = object.substr(0, object.find(':'));
    while (object.starts_with('/'))
        object.remove_prefix(1);
    while (object.ends_with('/'))
        object.remove_suffix(1);
    return object;
}

} // namespace

BodySize bodySizeOf(const RequestHead& head)
{
    checkFields(head);
    BodySize body;
    if (const auto expectation = head.find("Expect")) {
        if (!equalNames(*expectation, "100-continue"))
            throw HttpError::closing(
                Status::expectationFailed, "the only expectation met is 100-continue");
        body.isAwaited = true;
    }
    const auto length = head.find("Content-Length");
    if (const auto coding = head.find("Transfer-Encoding")) {
        if (!equalNames(*coding, "chunked"))
            throw HttpError::closing(
                Status::notImplemented, "the only Transfer-Encoding is chunked");
        if (length)
            throw HttpError::closing(
                Status::badRequest, "both Content-Length and Transfer-Encoding are there");
        if (head.version == "HTTP/1.0")
            throw HttpError::closing(Status::badRequest, "HTTP/1.0 knows no Transfer-Encoding");
        return body;
    }
    body.bytes = 0;
    if (!length)
        return body;
    const char* const end = length->data() + length->size();
    const auto [stop, error] = std::from_chars(length->data(), end, *body.bytes);
    if (error == std::errc::result_out_of_range)
        throw HttpError::closing(Status::contentTooLarge, "the body is far too large");
    if (error != std::errc{} || stop != end)
        throw HttpError::closing(Status::badRequest, "the Content-Length is no number");
    return body;
}

CallHead checkHead(const RequestHead& head, const BodySize& body, const Limits& limits)
{
    checkHost(head);
    checkTargetAndMethod(head);
    CallHead call;
    if (head.method == "M-POST")
        call.extension = mandatoryExtensionOf(head);
    const std::string prefix = call.extension ? *call.extension + "-" : "";
    checkContent(head);
    if (body.bytes && !head.find("Content-Length"))
        throw HttpError::closing(Status::lengthRequired,
            "neither Content-Length nor Transfer-Encoding says where the body ends");
    if (body.bytes && *body.bytes > limits.maximumBody)
        throw HttpError(Status::contentTooLarge,
            "a body holds at most " + std::to_string(limits.maximumBody) + " bytes");
    checkOperation(head, prefix);
    call.method = findDecoded(head, prefix + "CIMMethod");
    call.object = findDecoded(head, prefix + "CIMObject");
    call.acceptLanguage = head.find("Accept-Language").value_or("");
    return call;
}

void requireMatch(const CallHead& head, const CimXml::Message& message)
{
    const auto refuse = [](const std::string& reason) {
        throw HttpError(Status::badRequest, reason, mismatch);
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
    fields.push_back({"Man", std::string(mandatoryExtension) + ";ns=" + *head.extension});
    fields.push_back({"Ext", ""});
    fields.push_back({"Cache-Control", "no-cache"});
    fields.push_back({*head.extension + "-CIMOperation", "MethodResponse"});
    return fields;
}

} // namespace Host::Http
