// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The name of a message catalog: its language and its gettext domain.

#pragma once

#include <optional>
#include <string>
#include <string_view>

namespace Vorn {

// Whether a name holds nothing but letters, digits, '_' and '-', and at most 64 of them. Names
// come from the environment and become parts of file names.
bool isPlainName(std::string_view name);

struct CatalogName {
    std::string language; // "de_AT"
    std::string domain;   // "sensor-profile"

    // "de_AT/sensor-profile".
    static std::wstring join(const std::string& language, const std::wstring& domain);

    // The parts of a joined name; nothing when they are not plain names.
    static std::optional<CatalogName> split(const std::wstring& name);
};

} // namespace Vorn
