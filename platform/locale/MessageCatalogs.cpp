// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/locale/MessageCatalogs.h"

#include "platform/locale/EnglishTexts.h"
#include "platform/locale/OwnFolder.h"
#include "platform/locale/TextFormat.h"

#include <exception>
#include <new>
#include <utility>

namespace Vorn {

namespace {

// More languages than a process ever asks for; a bound on what it keeps all the same.
constexpr std::size_t mostCatalogs = 64;

std::shared_ptr<const MessageCatalog> load(
    const std::vector<std::string>& roots, const std::wstring& library)
{
    const auto name = CatalogName::split(library);
    return name ? std::make_shared<const MessageCatalog>(roots, *name) : nullptr;
}

std::vector<std::string> installedRoots()
{
    const std::string folder = ownFolder();
    if (folder.empty())
        return {};
    return {folder + "/../share/locale", folder + "/../../share/locale",
        folder + "/../../../share/locale"};
}

} // namespace

MessageCatalogs::MessageCatalogs(std::vector<std::string> roots) : roots_(std::move(roots)) {}

std::wstring MessageCatalogs::text(const std::wstring& library, const std::wstring& messageId)
{
    if (const auto found = catalog(library)) {
        const wchar_t* const text = found->find(messageId);
        if (text != nullptr && hasOneInsert(text))
            return text;
    }
    return std::wstring(englishText(messageId));
}

std::shared_ptr<const MessageCatalog> MessageCatalogs::catalog(const std::wstring& library)
{
    const std::lock_guard lock(guard_);
    if (const auto found = loaded_.find(library); found != loaded_.end())
        return found->second;
    if (loaded_.size() >= mostCatalogs)
        loaded_.clear();
    std::shared_ptr<const MessageCatalog> fresh;
    try {
        fresh = load(roots_, library);
    } catch (const std::bad_alloc&) {
        throw;
    } catch (const std::exception&) {
        // A catalog that cannot be loaded is none: the texts stay English.
    }
    return loaded_.emplace(library, std::move(fresh)).first->second;
}

MessageCatalogs& installedCatalogs()
{
    static MessageCatalogs catalogs(installedRoots());
    return catalogs;
}

} // namespace Vorn
