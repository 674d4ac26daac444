// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <exception>
#include <string>

namespace Vorn {

// Reports that a record refused a harvested value; what() names the value.
class ProviderException : public std::exception {
public:
    // Copies the text. REQUIRES: message is not null.
    explicit ProviderException(const char* message) : message_(message) {}
    ProviderException(const ProviderException&) = default;
    ~ProviderException() override = default;

    // Returns the message, which is valid as long as this object lives.
    const char* what() const noexcept override { return message_.c_str(); }

private:
    std::string message_;
};

} // namespace Vorn
