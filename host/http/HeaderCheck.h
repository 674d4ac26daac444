// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Checks the head of a request before its body is read, and then whether both agree.

#pragma once

#include "host/http/Limits.h"
#include "host/http/RequestHead.h"

#include <cstdint>
#include <optional>
#include <string>
#include <vector>

namespace Host::CimXml {
class Message;
}

namespace Host::Http {

// What the head says of the call.
struct CallHead {
    std::optional<std::string> extension; // the prefix of an M-POST's field names, such as 73
    std::optional<std::string> method;    // CIMMethod, decoded
    std::optional<std::string> object;    // CIMObject, decoded
};

struct BodySize {
    std::optional<std::uint64_t> bytes; // nothing for a body in chunks
    bool isAwaited = false;             // the client waits for 100 (Continue) before it sends it
};

// Throws HttpError when the head does not say where the body ends.
BodySize bodySizeOf(const RequestHead& head);

// Throws HttpError for a request of HTTP/1.1 without a Host (RFC 9112, 3.2).
void checkHost(const RequestHead& head);

// Returns the path of the target, decoded.
std::string pathOf(const RequestHead& head);

// Throws HttpError with the answer to a head that breaks a rule of RFC 9110, RFC 9112 or DSP0200.
CallHead checkHead(const RequestHead& head, const BodySize& body, const Limits& limits);

// Throws HttpError (header-mismatch) when the head names another operation or namespace than the
// body, or none: proxies filter requests by CIMMethod and CIMObject.
void requireMatch(const CallHead& head, const CimXml::Message& message);

// Returns the fields that every answer to the call has.
std::vector<HeaderField> answerFieldsFor(const CallHead& head);

} // namespace Host::Http
