// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <string>

namespace Host::Http {

// sensor-profile where there is such a user, else nobody.
std::string unprivilegedUser();

bool isRoot();

// Whether the process runs as this user. False where there is none of that name.
bool isUser(const std::string& name);

// Makes the process run as the user, with the user's groups, for good: it cannot come back, nor
// can a program it executes. Throws std::runtime_error with the reason when that fails; the
// process may be neither then and must end. REQUIRES: isRoot(), and no other thread waits for
// the rights of before.
void becomeUser(const std::string& name);

} // namespace Host::Http
