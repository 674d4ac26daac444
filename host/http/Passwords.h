// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Who may sign in: a file of `user:hash` lines.

#pragma once

#include <map>
#include <string>
#include <string_view>

namespace Host::Http {

// Immutable; may be asked from any thread.
class Passwords {
public:
    // Empty lines and those that begin with # count for nothing. Throws std::runtime_error with
    // file, line and reason for any other that is no `user:hash`, for a second line of a user and
    // for a file without users; and what readSecretFile throws.
    static Passwords read(const std::string& file);

    // The same for the content of a file.
    Passwords(std::string_view text, const std::string& file);

    // Takes long, as the hashes mean it to; for a user that is not there as long as for the one
    // whose hash is the dearest.
    bool matches(const std::string& user, const std::string& password) const;

private:
    std::map<std::string, std::string, std::less<>> hashes_; // by user
    std::string dearestHash_;
};

} // namespace Host::Http
