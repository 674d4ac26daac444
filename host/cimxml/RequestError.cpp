// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/cimxml/RequestError.h"

namespace Host::CimXml {

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
    Outcome outcome, std::size_t line, std::size_t offset, const std::string& why)
    : std::runtime_error(
          "line " + std::to_string(line) + ", byte " + std::to_string(offset) + ": " + why),
      outcome_(outcome), line_(line), offset_(offset)
{
}

} // namespace Host::CimXml
