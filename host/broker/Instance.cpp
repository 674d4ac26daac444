// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/broker/Instance.h"

#include "host/broker/ClassInformation.h"
#include "host/broker/Names.h"
#include "host/broker/ObjectPath.h"
#include "host/broker/PropertyFilter.h"
#include "host/broker/Slot.h"
#include "host/broker/String.h"
#include "host/broker/Types.h"

#include <algorithm>

namespace Host {

namespace {

void addKeyIfSet(ObjectPath& path, std::string_view name, const Value& value)
{
    if (!value.isNull() && !isArrayType(value.type()) && value.type() != CMPI_instance)
        path.addKey(name, value.copiedTo(Arena::required()));
}

} // namespace

Instance& Instance::make(Arena& arena, const ObjectPath& path, const ClassInformation* classes)
{
    return arena.make<Instance>(path.copiedTo(arena), classes);
}

std::string_view Instance::nameSpace() const noexcept
{
    return path_->nameSpace();
}

std::string_view Instance::className() const noexcept
{
    return path_->className();
}

const Value* Instance::property(std::string_view name) const noexcept
{
    const NamedValue* const found = properties_.find(name);
    return found == nullptr ? nullptr : &found->value;
}

void Instance::setProperty(std::string_view name, const Value& value)
{
    if (isWanted(name))
        properties_.set(Arena::required(), name, value);
}

ObjectPath& Instance::objectPath() const
{
    ObjectPath& path = path_->copiedTo(Arena::required());
    const auto* const known =
        classes_ == nullptr ? nullptr : classes_->keysOf(path.nameSpace(), path.className());
    if (known == nullptr && filter_ != nullptr)
        for (const String* const name : filter_->keys())
            if (const NamedValue* const key = properties_.find(*name->text()))
                addKeyIfSet(path, *name->text(), key->value);
    if (known == nullptr)
        return path;
    // The keys keep the order in which they were set, which is that of the provider's paths. Most
    // providers set them before all other properties, so that the search ends early.
    std::size_t missing = known->size();
    for (const NamedValue& property : properties_) {
        if (missing == 0)
            break;
        for (const std::string& key : *known)
            if (equalNames(key, *property.name->text())) {
                addKeyIfSet(path, key, property.value);
                --missing;
            }
    }
    return path;
}

Instance& Instance::copiedTo(Arena& arena) const
{
    Instance& copy = make(arena, *path_, classes_);
    copy.properties_ = properties_.shared();
    copy.filter_ = filter_;
    return copy;
}

bool Instance::isKeyOfClass(std::string_view name) const
{
    const auto* const known =
        classes_ == nullptr ? nullptr : classes_->keysOf(path_->nameSpace(), path_->className());
    return known != nullptr && std::any_of(known->begin(), known->end(),
                                   [name](const auto& key) { return equalNames(key, name); });
}

bool Instance::isWanted(std::string_view name) const
{
    return filter_ == nullptr || !filter_->hasProperties() || filter_->lists(name) ||
           isKeyOfClass(name);
}

void Instance::setPropertyFilter(const char** properties, const char** keys)
{
    Arena& arena = Arena::required();
    filter_ = &PropertyFilter::of(arena, properties, keys);
    if (filter_->hasProperties() && properties_.size() != 0)
        properties_.retain(
            arena, [this](const NamedValue& property) { return isWanted(*property.name->text()); });
}

void Instance::setProviderProperty(const char* name, const CMPIValue* value, CMPIType type)
{
    const std::string_view wanted = requiredText(name, "the property's name");
    if (isWanted(wanted))
        properties_.set(Arena::required(), wanted, Value::from(Arena::required(), value, type));
}

const CMPIInstanceFT Instance::functions = {
    .ftVersion = CMPIVersion200,
    .release = notOffered,
    .clone = notOffered,
    .getProperty = notOffered,
    .getPropertyAt = notOffered,
    .getPropertyCount = notOffered,
    .setProperty = slot<&Instance::setProviderProperty>,
    .getObjectPath = slot<&Instance::objectPath>,
    .setPropertyFilter = slot<&Instance::setPropertyFilter>,
    .setObjectPath = notOffered,
    .setPropertyWithOrigin = notOffered,
};

} // namespace Host
