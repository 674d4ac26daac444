// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <string>

namespace Host::Http {

// Returns the content of a file that keeps a secret. Throws std::runtime_error with the file and
// the reason when it cannot be read, is no regular file or larger than a megabyte, when it belongs
// neither to root nor to the process's effective user, and when others than its owner and its group
// can access it, or others than its owner can change it.
std::string readSecretFile(const std::string& file);

// Does the same for a file that anybody may read, whoever owns it.
std::string readPublicFile(const std::string& file);

} // namespace Host::Http
