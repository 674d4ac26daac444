// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/locale/FormatText.h"

#include "platform/utilities/ProviderUtilities.h"

#include <algorithm>
#include <string_view>

namespace Vorn {

// The C library's swprintf would read the argument in the encoding of the process's locale, and
// fail where the text is too long.
std::wstring formatText(
    const std::wstring& format, const std::string& argument, std::size_t capacity)
{
    constexpr std::wstring_view insert = L"%s";
    std::wstring text = format;
    text.replace(format.find(insert), insert.size(), make_wstring(argument));
    text.resize(std::min(text.size(), capacity - std::min<std::size_t>(capacity, 1)));
    return text;
}

} // namespace Vorn
