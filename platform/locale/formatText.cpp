// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/locale/formatText.h"

#include "platform/utilities/ProviderUtilities.h"

#include <algorithm>

namespace Vorn {

// Not the C library's swprintf, which reads a %s in the encoding of the process's locale and
// fails altogether when a text is too long.
std::wstring formatText(
    const std::wstring& format, const std::string& argument, std::size_t capacity)
{
    std::wstring text;
    text.reserve(format.size() + argument.size());
    for (std::size_t position = 0; position < format.size();) {
        const std::size_t percent = std::min(format.find(L'%', position), format.size());
        text.append(format, position, percent - position);
        if (percent == format.size())
            break;
        const wchar_t conversion = percent + 1 < format.size() ? format[percent + 1] : L'\0';
        text += conversion == L's' ? make_wstring(argument) : L"%";
        position = percent + (conversion == L's' || conversion == L'%' ? 2 : 1);
    }
    text.resize(std::min(text.size(), capacity - std::min<std::size_t>(capacity, 1)));
    return text;
}

} // namespace Vorn
