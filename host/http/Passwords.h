// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <map>
#include <string>
#include <string_view>

namespace Host::Http {

// The users of a file of `user:hash` lines, with hashes as libcrypt makes them by yescrypt ($y$),
// bcrypt ($2b$, $2a$, $2y$) and SHA-512 ($6$). Immutable, and therefore thread-safe.
class Passwords {
public:
    // Ignores empty lines and those that begin with #. Throws std::runtime_error with file, line
    // and reason for any other line that is no `user:hash`, for a second line of a user and for a
    // file without users; and what readSecretFile throws.
    static Passwords read(const std::string& file);

    // Parses the content of such a file, which errors name.
    Passwords(std::string_view text, const std::string& file);

    // Takes as long as the user's hash demands, whether the password is right or not. An unknown
    // user takes as long as the one whose hash costs most.
    bool matches(const std::string& user, const std::string& password) const;

private:
    std::map<std::string, std::string, std::less<>> hashes_; // by user
    std::string costliestHash_;
};

// Returns about how many microseconds it takes to check a password against the hash, for comparison
// with others. REQUIRES: a hash of one of the three schemes.
double costOf(std::string_view hash);

} // namespace Host::Http
