// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// What is wrong with a request as a message, before any operation is attempted.

#pragma once

#include <cstddef>
#include <stdexcept>
#include <string>
#include <string_view>

namespace Host::CimXml {

// What the answer's CIMError header says.
enum class Outcome {
    requestNotWellFormed,
    requestNotLooselyValid, // something that must be there is not, or something stands elsewhere
    requestNotValid,        // no request, or one beyond the limits
    unsupportedCimVersion,
    unsupportedDtdVersion,
    unsupportedProtocolVersion,
    multipleRequestsUnsupported,
    unsupportedOperation, // an export message
};

// As the header writes it: request-not-well-formed and so on.
std::string_view nameOf(Outcome outcome);

// what() reads `line N, byte M: reason`.
class RequestError : public std::runtime_error {
public:
    // The offset is a place in the text.
    RequestError(Outcome outcome, std::string_view text, std::size_t offset, std::string_view why);

    Outcome outcome() const noexcept { return outcome_; }
    std::size_t offset() const noexcept { return offset_; } // bytes before the place
    std::size_t line() const noexcept { return line_; }     // counts from 1

private:
    RequestError(Outcome outcome, std::size_t offset, std::size_t line, const std::string& why);

    Outcome outcome_;
    std::size_t offset_;
    std::size_t line_;
};

} // namespace Host::CimXml
