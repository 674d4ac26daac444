// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <optional>
#include <string>

namespace Tools {

// Makes a process of root run as the wanted user, or as sensor-profile where there is such a user,
// else as nobody, with the user's groups. Neither the process nor a program that it executes can
// undo that. Returns who serves, for the log. Throws std::runtime_error with the reason when that
// fails, and when a process of another user is wanted to change; the process may have changed
// partly then and must end.
std::string renounceRoot(const std::optional<std::string>& wanted);

} // namespace Tools
