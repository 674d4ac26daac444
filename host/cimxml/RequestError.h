// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Errors of a request as a message, before any operation is attempted.

#pragma once

#include <cstddef>
#include <stdexcept>
#include <string>
#include <string_view>

namespace Host::CimXml {

// The values of the header CIMError (DSP0200).
enum class Outcome {
    requestNotWellFormed,
    requestNotLooselyValid, // an element or attribute is missing or misplaced
    requestNotValid,        // no request, or one beyond the bounds
    unsupportedCimVersion,
    unsupportedDtdVersion,
    unsupportedProtocolVersion,
    multipleRequestsUnsupported,
    unsupportedOperation, // an export message
};

// Returns the value as the header spells it, such as request-not-well-formed.
std::string_view nameOf(Outcome outcome);

// what() reads `line N, byte M: reason`.
class RequestError : public std::runtime_error {
public:
    RequestError(Outcome outcome, std::size_t line, std::size_t offset, const std::string& why);

    Outcome outcome() const noexcept { return outcome_; }
    std::size_t line() const noexcept { return line_; }     // counts from 1
    std::size_t offset() const noexcept { return offset_; } // bytes before the place

private:
    Outcome outcome_;
    std::size_t line_;
    std::size_t offset_;
};

} // namespace Host::CimXml
