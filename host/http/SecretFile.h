// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <string>

namespace Host::Http {

// The content of a file that keeps a secret. Throws std::runtime_error naming the file and the
// reason when it cannot be read, is no regular file or larger than a megabyte, when it belongs
// neither to root nor to the process's effective user, or when others than its owner and its group
// can reach it, or others than its owner change it.
std::string readSecretFile(const std::string& file);

// The same for what is no secret: anybody may read it.
std::string readPublicFile(const std::string& file);

} // namespace Host::Http
