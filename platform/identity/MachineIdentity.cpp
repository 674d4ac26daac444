// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/identity/MachineIdentity.h"

#include <nettle/hmac.h>

#include <charconv>
#include <cstddef>
#include <fstream>
#include <string_view>

namespace Vorn {

namespace {

using Identifier = std::array<std::uint8_t, 16>;

constexpr std::size_t digits = 2 * Identifier{}.size();

// The first line, cut where it is too long to be an identifier.
std::string firstLineOf(const char* file)
{
    std::ifstream in(file, std::ios::binary);
    std::array<char, digits + 2> line{};
    in.getline(line.data(), line.size());
    return line.data();
}

std::optional<Identifier> parsed(std::string_view text)
{
    if (text.size() != digits)
        return std::nullopt;
    Identifier identifier{};
    for (std::size_t i = 0; i < identifier.size(); ++i) {
        const char* const first = text.data() + 2 * i;
        const auto [end, error] = std::from_chars(first, first + 2, identifier[i], 16);
        if (error != std::errc{} || end != first + 2)
            return std::nullopt;
    }
    return identifier;
}

Identifier keyedHash(const Identifier& key, const ApplicationId& application)
{
    hmac_sha256_ctx hash;
    hmac_sha256_set_key(&hash, key.size(), key.data());
    hmac_sha256_update(&hash, application.size(), application.data());
    Identifier digest{};
    hmac_sha256_digest(&hash, digest.size(), digest.data());
    return digest;
}

// As RFC 9562 writes a UUID of version 4, the random one.
std::string uuidText(Identifier identifier)
{
    identifier[6] = static_cast<std::uint8_t>((identifier[6] & 0x0F) | 0x40);
    identifier[8] = static_cast<std::uint8_t>((identifier[8] & 0x3F) | 0x80);
    constexpr std::string_view hexadecimal = "0123456789abcdef";
    std::string text;
    for (std::size_t i = 0; i < identifier.size(); ++i) {
        if (i == 4 || i == 6 || i == 8 || i == 10)
            text += '-';
        text += hexadecimal[identifier[i] >> 4];
        text += hexadecimal[identifier[i] & 0x0F];
    }
    return text;
}

} // namespace

std::optional<std::string> machineIdFor(const ApplicationId& application, const char* file)
{
    const auto machine = parsed(firstLineOf(file));
    if (!machine)
        return std::nullopt;
    return uuidText(keyedHash(*machine, application));
}

} // namespace Vorn
