// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Which texts may serve as formats.

#pragma once

#include <string_view>

namespace Vorn {

// Whether a text holds exactly one %s, and otherwise no percent sign but in "%%".
bool hasOneInsert(std::wstring_view text) noexcept;

} // namespace Vorn
