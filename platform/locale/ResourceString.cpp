// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/locale/ResourceString.h"

#include "platform/locale/MessageCatalogs.h"

namespace Vorn {

ResourceString::ResourceString(const std::wstring& library, const std::wstring& messageId)
    : text_(installedCatalogs().text(library, messageId))
{
}

} // namespace Vorn
