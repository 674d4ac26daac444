// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/broker/Object.h"

#include <array>

namespace Host {

namespace {

constexpr std::array typeNames = {"CMPIBroker", "CMPIString", "CMPIArray", "CMPIObjectPath",
    "CMPIInstance", "CMPIEnumeration", "CMPIDateTime", "CMPIContext", "CMPIResult"};

// The layout that every encapsulated object begins with, whatever its function table.
struct AnyHandle {
    const void* hdl;
    const void* ft;
};

std::uint32_t indexOf(Object::Kind kind) noexcept
{
    return static_cast<std::uint32_t>(kind) - static_cast<std::uint32_t>(Object::Kind::broker);
}

} // namespace

const char* Object::typeName(Kind kind) noexcept
{
    return typeNames[indexOf(kind)];
}

const Object* Object::behind(const void* encapsulated) noexcept
{
    const auto* const handle = static_cast<const AnyHandle*>(encapsulated);
    if (handle == nullptr || handle->hdl == nullptr)
        return nullptr;
    const auto* const object = static_cast<const Object*>(handle->hdl);
    return indexOf(object->kind()) < typeNames.size() ? object : nullptr;
}

} // namespace Host
