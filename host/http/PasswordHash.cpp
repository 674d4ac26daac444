// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/http/PasswordHash.h"

#include <crypt.h>
#include <gnutls/gnutls.h>

#include <algorithm>
#include <charconv>
#include <cmath>
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

// Of a character of that alphabet.
int digitOf(char c)
{
    constexpr std::string_view alphabet =
        "./0123456789ABCDEFGHIJKLMNOPQRSTUVWXYZabcdefghijklmnopqrstuvwxyz";
    return static_cast<int>(alphabet.find(c));
}

// What the decimal digits at the beginning say.
double numberIn(std::string_view text)
{
    unsigned long number = 0;
    std::from_chars(text.data(), text.data() + text.size(), number);
    return static_cast<double>(number);
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

double costOf(std::string_view hash)
{
    constexpr double block = 0.2;         // of yescrypt, which takes N * r of them
    constexpr double expensiveSetup = 80; // of bcrypt, which takes 2 to the power of its cost
    constexpr double round = 0.5;         // of SHA-512
    if (hash.starts_with("$y$"))          // $y$, a flavor, the logarithm of N and r, less one each
        return block * std::exp2(digitOf(hash[4]) + 1) * (digitOf(hash[5]) + 1);
    if (hash.starts_with("$2"))
        return expensiveSetup * std::exp2(numberIn(hash.substr(4)));
    constexpr std::string_view rounds = "$6$rounds=";
    constexpr double usualRounds = 5000;
    return round * (hash.starts_with(rounds) ? numberIn(hash.substr(rounds.size())) : usualRounds);
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
