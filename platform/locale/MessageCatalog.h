// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// One message catalog, loaded.

#pragma once

#include "platform/locale/CatalogName.h"

#include <locale>
#include <string>
#include <vector>

namespace boost::locale {
template <typename CharType>
class message_format;
}

namespace Vorn {

// Thread-safe once constructed.
class MessageCatalog {
public:
    // Looks in <root>/<language>/LC_MESSAGES/<domain>.mo of each root in turn, then, for
    // a language with a country ("de_AT"), for the language alone ("de"). Without a sound file
    // the catalog is empty.
    MessageCatalog(const std::vector<std::string>& roots, const CatalogName& name);

    // The text of a message; null when the catalog has none. Lives as long as the catalog.
    const wchar_t* find(const std::wstring& messageId) const;

private:
    std::locale owner_; // of the messages; never made global
    const boost::locale::message_format<wchar_t>& messages_;
};

} // namespace Vorn
