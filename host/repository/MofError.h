// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// What is wrong with a MOF file, and where.

#pragma once

#include "host/repository/SourcePosition.h"

#include <stdexcept>
#include <string>
#include <string_view>

namespace Host {

// what() reads `file:line:column: reason`.
class MofError : public std::runtime_error {
public:
    MofError(SourcePosition position, const std::string& reason);

    const SourcePosition& position() const noexcept { return position_; }
    const std::string& reason() const noexcept { return *reason_; }

private:
    SourcePosition position_;
    std::shared_ptr<const std::string> reason_; // shared, so that copying the error cannot fail
};

// `file:line:column`
std::string toText(const SourcePosition& position);

// A part of a MOF text between quotation marks, as printable ASCII, and cut when it is long.
std::string quotation(std::string_view text);

} // namespace Host
