// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/http/Passwords.h"

#include "host/http/SecretFile.h"

#include <crypt.h>
#include <gnutls/gnutls.h>

#include <algorithm>
#include <charconv>
#include <cmath>
#include <cstddef>
#include <memory>
#include <stdexcept>

namespace Host::Http {

namespace {

bool isUserName(std::string_view text)
{
    return !text.empty() && std::none_of(text.begin(), text.end(), [](char c) {
        return static_cast<unsigned char>(c) < 0x20 || c == 0x7F;
    });
}

// The alphabet of libcrypt, in the order of the values that its characters encode.
constexpr std::string_view alphabet =
    "./0123456789ABCDEFGHIJKLMNOPQRSTUVWXYZabcdefghijklmnopqrstuvwxyz";

// Returns whether the last field, which is the hash itself, is of the length and the alphabet.
bool endsWithHash(std::string_view text, std::size_t length)
{
    const std::size_t last = text.rfind('$');
    return text.size() - last - 1 == length &&
           text.find_first_not_of(alphabet, last + 1) == std::string_view::npos;
}

// Returns the decimal number at the beginning.
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

} // namespace

Passwords Passwords::read(const std::string& file)
{
    return {readSecretFile(file), file};
}

Passwords::Passwords(std::string_view text, const std::string& file)
{
    for (std::size_t number = 1; !text.empty(); ++number) {
        std::string_view line = text.substr(0, text.find('\n'));
        text.remove_prefix(std::min(line.size() + 1, text.size()));
        if (line.ends_with('\r'))
            line.remove_suffix(1);
        if (line.empty() || line.starts_with('#'))
            continue;
        const auto fail = [&](const std::string& reason) {
            throw std::runtime_error(file + ":" + std::to_string(number) + ": " + reason);
        };
        const std::size_t colon = line.find(':');
        if (colon == std::string_view::npos)
            fail("it is no user:hash");
        const std::string_view user = line.substr(0, colon);
        if (!isUserName(user))
            fail("the user has no name, or one with control characters");
        if (!isPasswordHash(line.substr(colon + 1)))
            fail("the password of " + std::string(user) +
                 " is no yescrypt ($y$), bcrypt ($2b$) or SHA-512 ($6$) hash");
        if (!hashes_.emplace(user, line.substr(colon + 1)).second)
            fail("a second line for " + std::string(user));
    }
    if (hashes_.empty())
        throw std::runtime_error(file + ": it names no user");
    costliestHash_ =
        std::max_element(hashes_.begin(), hashes_.end(), [](const auto& a, const auto& b) {
            return costOf(a.second) < costOf(b.second);
        })->second;
}

bool Passwords::matches(const std::string& user, const std::string& password) const
{
    const auto found = hashes_.find(user);
    const std::string& hash = found == hashes_.end() ? costliestHash_ : found->second;
    const bool isRight = matchesHash(password, hash);
    return isRight && found != hashes_.end();
}

double costOf(std::string_view hash)
{
    constexpr double block = 0.2;         // of yescrypt, which takes N * r of them
    constexpr double expensiveSetup = 80; // of bcrypt, which takes 2 to the power of its cost
    constexpr double round = 0.5;         // of SHA-512
    if (hash.starts_with("$y$")) { // a flavor, the logarithm of N and r follow, each less one
        const auto digit = [hash](std::size_t at) {
            return static_cast<double>(alphabet.find(hash[at]) + 1);
        };
        return block * std::exp2(digit(4)) * digit(5);
    }
    if (hash.starts_with("$2"))
        return expensiveSetup * std::exp2(numberIn(hash.substr(4)));
    constexpr std::string_view rounds = "$6$rounds=";
    constexpr double usualRounds = 5000;
    return round * (hash.starts_with(rounds) ? numberIn(hash.substr(rounds.size())) : usualRounds);
}

} // namespace Host::Http
