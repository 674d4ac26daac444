// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <concepts>
#include <exception>
#include <string>

namespace Testing {

// Returns the text of the standard exception that an action throws; an empty text if it throws
// none.
template <typename Action>
requires std::invocable<const Action&> std::string errorOf(const Action& action)
{
    try {
        action();
    } catch (const std::exception& error) {
        return error.what();
    }
    return {};
}

} // namespace Testing
