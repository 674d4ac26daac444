// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/http/Passwords.h"

#include "host/http/PasswordHash.h"
#include "host/http/SecretFile.h"

#include <algorithm>
#include <cstddef>
#include <stdexcept>

namespace Host::Http {

namespace {

bool isUserName(std::string_view text)
{
    return !text.empty() && std::none_of(text.begin(), text.end(), [](char c) {
        return static_cast<unsigned char>(c) < 0x20 || c == 0x7F;
    });
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
    dearestHash_ =
        std::max_element(hashes_.begin(), hashes_.end(), [](const auto& a, const auto& b) {
            return costOf(a.second) < costOf(b.second);
        })->second;
}

bool Passwords::matches(const std::string& user, const std::string& password) const
{
    const auto found = hashes_.find(user);
    const std::string& hash = found == hashes_.end() ? dearestHash_ : found->second;
    const bool isRight = matchesHash(password, hash);
    return isRight && found != hashes_.end();
}

} // namespace Host::Http
