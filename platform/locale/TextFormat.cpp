// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/locale/TextFormat.h"

#include <cstddef>

namespace Vorn {

bool hasOneInsert(std::wstring_view text) noexcept
{
    int inserts = 0;
    auto percent = text.find(L'%');
    while (percent != std::wstring_view::npos) {
        const wchar_t conversion = percent + 1 < text.size() ? text[percent + 1] : L'\0';
        if (conversion == L's')
            ++inserts;
        else if (conversion != L'%')
            return false;
        percent = text.find(L'%', percent + 2);
    }
    return inserts == 1;
}

} // namespace Vorn
