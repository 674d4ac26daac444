// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/cimxml/RequestError.h"

#include <algorithm>

namespace Host::CimXml {

namespace {

std::size_t lineOf(std::string_view text, std::size_t offset)
{
    const std::string_view before = text.substr(0, offset);
    return 1 + static_cast<std::size_t>(std::count(before.begin(), before.end(), '\n'));
}

} // namespace

std::string_view nameOf(Outcome outcome)
{
    switch (outcome) {
    case Outcome::requestNotWellFormed:
        return "request-not-well-formed";
    case Outcome::requestNotLooselyValid:
        return "request-not-loosely-valid";
    case Outcome::requestNotValid:
        return "request-not-valid";
    case Outcome::unsupportedCimVersion:
        return "unsupported-cim-version";
    case Outcome::unsupportedDtdVersion:
        return "unsupported-dtd-version";
    case Outcome::unsupportedProtocolVersion:
        return "unsupported-protocol-version";
    case Outcome::multipleRequestsUnsupported:
        return "multiple-requests-unsupported";
    case Outcome::unsupportedOperation:
        break;
    }
    return "unsupported-operation";
}

RequestError::RequestError(
    Outcome outcome, std::string_view text, std::size_t offset, std::string_view why)
    : RequestError(outcome, offset, lineOf(text, offset), std::string(why))
{
}

RequestError::RequestError(
    Outcome outcome, std::size_t offset, std::size_t line, const std::string& why)
    : std::runtime_error(
          "line " + std::to_string(line) + ", byte " + std::to_string(offset) + ": " + why),
      outcome_(outcome), offset_(offset), line_(line)
{
}

} // namespace Host::CimXml
