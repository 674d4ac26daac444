// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/broker/CollectedResult.h"

#include "host/broker/Enumeration.h"
#include "host/broker/Error.h"
#include "host/broker/Instance.h"
#include "host/broker/ObjectPath.h"

namespace Host {

namespace {

template <typename Objects>
Enumeration& enumerationOf(const Objects& objects, CMPIType type)
{
    Enumeration& enumeration = Enumeration::make(Arena::required(), type);
    for (const auto* const object : objects)
        enumeration.add(Value::of(*object));
    return enumeration;
}

} // namespace

void CollectedResult::instance(const Instance& instance)
{
    instances_.push_back(&instance.copiedTo(Arena::required()));
}

void CollectedResult::path(const ObjectPath& path)
{
    paths_.push_back(&path.copiedTo(Arena::required()));
}

void CollectedResult::data(const Value& value)
{
    values_.push_back(value.copiedTo(Arena::required()));
}

void CollectedResult::error(const Error& error)
{
    errors_.push_back(&error.copiedTo(Arena::required()));
}

Enumeration& CollectedResult::pathEnumeration() const
{
    return enumerationOf(paths_, CMPI_ref);
}

Enumeration& CollectedResult::instanceEnumeration() const
{
    return enumerationOf(instances_, CMPI_instance);
}

} // namespace Host
