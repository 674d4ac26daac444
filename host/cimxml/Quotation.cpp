// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/cimxml/Quotation.h"

namespace Host::CimXml {

std::string quotation(std::string_view text)
{
    constexpr std::size_t maximumQuote = 40;
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

} // namespace Host::CimXml
