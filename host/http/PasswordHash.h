// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Passwords as libcrypt's yescrypt, bcrypt and SHA-512 schemes keep them.

#pragma once

#include <string>
#include <string_view>

namespace Host::Http {

// Whether the text is a whole hash of one of these schemes ($y$, $2b$, $2a$, $2y$, $6$).
bool isPasswordHash(std::string_view text);

// About how many microseconds it takes to check a password against the hash, for comparison with
// others. REQUIRES: isPasswordHash(hash).
double costOf(std::string_view hash);

// Takes as long as the hash demands, whether the password is right or not. Thread-safe.
// REQUIRES: isPasswordHash(hash).
bool matchesHash(const std::string& password, const std::string& hash);

} // namespace Host::Http
