// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// What the head of a request must say before its body is read, and whether both say the same.

#pragma once

#include "host/http/Limits.h"
#include "host/http/RequestHead.h"

#include <cstdint>
#include <optional>
#include <string>

namespace Host::CimXml {
class Message;
}

namespace Host::Http {

// What counts of a head that is in order.
struct CallHead {
    // What precedes the names of header fields in an M-POST, such as 73; nothing for a POST.
    std::optional<std::string> extension;
    std::optional<std::string> method; // where the client says it, decoded
    std::optional<std::string> object; // likewise
    std::string acceptLanguage;
};

// A body's size, as far as the head tells.
struct BodySize {
    std::optional<std::uint64_t> bytes; // nothing when it comes in chunks
    bool isAwaited = false;             // the client waits for a sign before it sends the body
};

// Throws HttpError when the head does not say where the body ends.
BodySize bodySizeOf(const RequestHead& head);

// Throws HttpError with the answer to give when the head is not in order.
CallHead checkHead(const RequestHead& head, const BodySize& body, const Limits& limits);

// Throws HttpError (header-mismatch) when the head names another operation or namespace, or none:
// who filters or counts requests on their way by CIMMethod and CIMObject sees every one.
void requireMatch(const CallHead& head, const CimXml::Message& message);

// The fields that every answer to the call has.
std::vector<HeaderField> answerFieldsFor(const CallHead& head);

} // namespace Host::Http
