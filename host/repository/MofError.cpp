// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/repository/MofError.h"

#include <utility>

namespace Host {

namespace {

constexpr std::size_t maximumQuote = 40;

} // namespace

MofError::MofError(SourcePosition position, const std::string& reason)
    : std::runtime_error(toText(position) + ": " + reason), position_(std::move(position)),
      reason_(std::make_shared<const std::string>(reason))
{
}

std::string toText(const SourcePosition& position)
{
    return (position.file ? *position.file : std::string()) + ":" + std::to_string(position.line) +
           ":" + std::to_string(position.column);
}

std::string quotation(std::string_view text)
{
    constexpr std::string_view digits = "0123456789abcdef";
    std::string quote = "\"";
    for (const char c : text.substr(0, maximumQuote)) {
        const auto byte = static_cast<unsigned char>(c);
        if (byte < 0x20 || byte >= 0x7F) {
            quote += "\\x";
            quote += digits[byte >> 4U];
            quote += digits[byte & 0xFU];
        } else {
            quote += c;
        }
    }
    return quote + (text.size() > maximumQuote ? "...\"" : "\"");
}

} // namespace Host
