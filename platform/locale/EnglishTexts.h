// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The texts that stand in for what no catalog has.

#pragma once

#include <string_view>

namespace Vorn {

// The built-in English text of a message; "%s", the insert alone, for an unknown one.
std::wstring_view englishText(std::wstring_view messageId) noexcept;

} // namespace Vorn
