// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// A text behind a CMPIString. It is immutable and may be shared.

#pragma once

#include "host/broker/Object.h"

#include <optional>
#include <string_view>

namespace Host {

class String : public Encapsulated<String, CMPIString, Object::Kind::string> {
public:
    static String& make(Arena& arena, std::string_view text);
    // Makes a string object whose character pointer is null, as some object managers return for
    // the host of a path.
    static String& makeWithoutText(Arena& arena);

    // Returns nothing when the character pointer is null.
    std::optional<std::string_view> text() const noexcept
    {
        return text_.data() == nullptr ? std::nullopt : std::optional{text_};
    }
    // Zero-terminated, or null.
    const char* characters() const noexcept { return text_.data(); }

    static const CMPIStringFT functions;

private:
    friend class Arena;
    explicit String(std::string_view text) : text_(text) {}

    std::string_view text_;
};

} // namespace Host
