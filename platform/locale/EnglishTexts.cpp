// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/locale/EnglishTexts.h"

namespace Vorn {

std::wstring_view englishText(std::wstring_view messageId) noexcept
{
    if (messageId == L"MSGID_SENSOR_CAPTION")
        return L"Sensor %s";
    if (messageId == L"MSGID_SENSOR_DESCRIPTION")
        return L"Numeric sensor %s, read from this computer's hardware";
    return L"%s";
}

} // namespace Vorn
