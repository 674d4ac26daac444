// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/locale/MessageCatalog.h"

#include "platform/locale/MessageFile.h"

#include <boost/locale/gnu_gettext.hpp>

namespace Vorn {

namespace {

using Messages = boost::locale::message_format<wchar_t>;
namespace gettext = boost::locale::gnu_gettext;

// The caller owns the result, as every facet that a std::locale takes.
Messages* load(const std::vector<std::string>& roots, const CatalogName& name)
{
    gettext::messages_info info;
    const auto underscore = name.language.find('_');
    info.language = name.language.substr(0, underscore);
    if (underscore != std::string::npos)
        info.country = name.language.substr(underscore + 1);
    info.encoding = "UTF-8";
    info.domains.emplace_back(name.domain);
    info.paths = roots;
    info.callback = [](const std::string& path, const std::string&) {
        return readMessageFile(path);
    };
    return gettext::create_messages_facet<wchar_t>(info);
}

} // namespace

MessageCatalog::MessageCatalog(const std::vector<std::string>& roots, const CatalogName& name)
    : owner_(std::locale::classic(), load(roots, name)), messages_(std::use_facet<Messages>(owner_))
{
}

const wchar_t* MessageCatalog::find(const std::wstring& messageId) const
{
    if (messageId.empty()) // the key of the catalog's header
        return nullptr;
    return messages_.get(0, nullptr, messageId.c_str());
}

} // namespace Vorn
