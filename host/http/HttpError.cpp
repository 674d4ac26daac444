// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/http/HttpError.h"

#include "host/cimxml/RequestError.h"

#include <microhttpd.h>

#include <utility>

namespace Host::Http {

using CimXml::Outcome;

namespace {

unsigned statusOf(Outcome outcome)
{
    switch (outcome) {
    case Outcome::unsupportedCimVersion:
    case Outcome::unsupportedDtdVersion:
    case Outcome::unsupportedProtocolVersion:
    case Outcome::multipleRequestsUnsupported:
        return MHD_HTTP_NOT_IMPLEMENTED;
    default:
        return MHD_HTTP_BAD_REQUEST;
    }
}

} // namespace

HttpError::HttpError(unsigned status, const std::string& reason, std::string_view cimError,
    std::vector<HeaderField> fields)
    : std::runtime_error(reason), status_(status), cimError_(cimError), fields_(std::move(fields))
{
}

HttpError::HttpError(const CimXml::RequestError& error)
    : HttpError(statusOf(error.outcome()), error.what(), nameOf(error.outcome()))
{
    // The body may have another end than its length says (RFC 9112, 11.2).
    endsConnection_ = error.outcome() == Outcome::requestNotWellFormed;
}

HttpError HttpError::closing(
    unsigned status, const std::string& reason, std::vector<HeaderField> fields)
{
    HttpError error(status, reason, {}, std::move(fields));
    error.endsConnection_ = true;
    return error;
}

} // namespace Host::Http
