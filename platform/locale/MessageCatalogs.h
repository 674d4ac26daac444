// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The message catalogs below some folders, each loaded once.

#pragma once

#include "platform/locale/MessageCatalog.h"

#include <map>
#include <memory>
#include <mutex>
#include <string>
#include <vector>

namespace Vorn {

// Thread-safe.
class MessageCatalogs {
public:
    // Each root is a folder such as /usr/share/locale.
    explicit MessageCatalogs(std::vector<std::string> roots);

    // The text of a message in the catalog that Locale::getResourceLibrary named: always one
    // with exactly one %s. The built-in English one where there is no catalog or no such text.
    std::wstring text(const std::wstring& library, const std::wstring& messageId);

private:
    std::shared_ptr<const MessageCatalog> catalog(const std::wstring& library);

    const std::vector<std::string> roots_;
    std::mutex guard_;
    // By library name; null for a name that no catalog can have.
    std::map<std::wstring, std::shared_ptr<const MessageCatalog>> loaded_;
};

// Those installed with the binary that holds this code, whether it lies in a build tree, in
// <prefix>/bin, in <prefix>/lib/cmpi or in <prefix>/lib/<architecture>/cmpi. No other folder is
// consulted.
MessageCatalogs& installedCatalogs();

} // namespace Vorn
