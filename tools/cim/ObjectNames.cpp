// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/cim/ObjectNames.h"

#include "host/broker/Instance.h"
#include "host/broker/Names.h"
#include "host/broker/ObjectPath.h"
#include "host/broker/String.h"
#include "host/broker/Text.h"

#include <algorithm>
#include <map>
#include <string_view>

namespace Tools {

namespace {

std::string folded(std::string_view name)
{
    std::string result(name);
    std::transform(result.begin(), result.end(), result.begin(), Host::foldCase);
    return result;
}

std::string identityOf(const Host::Value& value)
{
    const Host::ObjectPath* const path = value.path();
    return path == nullptr ? Host::toText(value) : Tools::identityOf(*path);
}

} // namespace

std::string shortName(const Host::ObjectPath& path)
{
    for (const char* const key : {"DeviceID", "InstanceID", "Name"})
        if (const Host::Value* const value = path.key(key); value != nullptr && value->text())
            return std::string(*value->text());
    return path.toText();
}

std::string nameOf(const Host::Instance& instance)
{
    const Host::Value* const name = instance.property("ElementName");
    const std::string_view text =
        name == nullptr ? std::string_view{} : name->text().value_or(std::string_view{});
    return std::string(text.empty() ? instance.className() : text);
}

std::string identityOf(const Host::ObjectPath& path)
{
    std::map<std::string, std::string> keys;
    for (const Host::NamedValue& key : path.keys())
        keys[folded(*key.name->text())] = identityOf(key.value);
    std::string identity = folded(path.className());
    for (const auto& [name, value] : keys)
        identity.append("\n").append(name).append("=").append(value);
    return identity;
}

} // namespace Tools
