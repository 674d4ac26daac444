// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/http/PasswordHash.h"

#include <crypt.h>
#include <gnutls/gnutls.h>

#include <algorithm>
#include <cstddef>
#include <memory>

namespace Host::Http {

namespace {

// In the alphabet of libcrypt, which all three schemes use.
bool isEncoded(std::string_view text)
{
    return std::all_of(text.begin(), text.end(), [](char c) {
        return (c >= 'a' && c <= 'z') || (c >= 'A' && c <= 'Z') || (c >= '0' && c <= '9') ||
               c == '.' || c == '/';
    });
}

// The fields behind the scheme's, the last of which is the hash itself.
bool endsWithHash(std::string_view text, std::size_t length)
{
    const std::size_t last = text.rfind('$');
    return text.size() - last - 1 == length && isEncoded(text.substr(last + 1));
}

bool hasShape(std::string_view text)
{
    constexpr std::size_t yescryptHash = 43;
    constexpr std::size_t bcryptSaltAndHash = 53;
    constexpr std::size_t sha512Hash = 86;
    if (text.starts_with("$y$"))
        return endsWithHash(text, yescryptHash) && std::count(text.begin(), text.end(), '$') == 4;
    if (text.starts_with("$2b$") || text.starts_with("$2a$") || text.starts_with("$2y$"))
        return endsWithHash(text, bcryptSaltAndHash);
    if (text.starts_with("$6$"))
        return endsWithHash(text, sha512Hash) && std::count(text.begin(), text.end(), '$') >= 3;
    return false;
}

} // namespace

bool isPasswordHash(std::string_view text)
{
    if (!hasShape(text))
        return false;
    const int verdict = ::crypt_checksalt(std::string(text).c_str());
    return verdict == CRYPT_SALT_OK || verdict == CRYPT_SALT_TOO_CHEAP;
}

bool matchesHash(const std::string& password, const std::string& hash)
{
    const auto work = std::make_unique<crypt_data>(); // far too large for a stack
    const char* const made = ::crypt_r(password.c_str(), hash.c_str(), work.get());
    if (made == nullptr)
        return false;
    const std::string_view text = made;
    return text.size() == hash.size() &&
           ::gnutls_memcmp(text.data(), hash.data(), hash.size()) == 0;
}

} // namespace Host::Http
