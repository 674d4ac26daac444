// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/broker/ObjectPath.h"

#include "host/broker/Slot.h"
#include "host/broker/String.h"
#include "host/broker/Text.h"
#include "host/broker/Types.h"

namespace Host {

namespace {

const String& nameOrNone(Arena& arena, const char* text)
{
    return text == nullptr ? String::makeWithoutText(arena) : arena.name(text);
}

} // namespace

ObjectPath& ObjectPath::make(Arena& arena, std::string_view nameSpace, std::string_view className)
{
    return arena.make<ObjectPath>(arena.name(nameSpace), arena.name({}), arena.name(className));
}

std::string_view ObjectPath::nameSpace() const noexcept
{
    return nameSpace_->text().value_or("");
}

std::string_view ObjectPath::host() const noexcept
{
    return host_->text().value_or("");
}

std::string_view ObjectPath::className() const noexcept
{
    return className_->text().value_or("");
}

const Value* ObjectPath::key(std::string_view name) const noexcept
{
    const NamedValue* const found = keys_.find(name);
    return found == nullptr ? nullptr : &found->value;
}

void ObjectPath::setNameSpace(const char* nameSpace)
{
    nameSpace_ = &nameOrNone(Arena::required(), nameSpace);
}

void ObjectPath::setHost(const char* host)
{
    host_ = &nameOrNone(Arena::required(), host);
}

void ObjectPath::setClassName(const char* className)
{
    className_ = &Arena::required().name(requiredText(className, "the class name"));
}

void ObjectPath::addKey(std::string_view name, const Value& value)
{
    if (isArrayType(value.type()) || value.type() == CMPI_instance)
        throw Refusal(CMPI_RC_ERR_INVALID_DATA_TYPE,
            "key " + std::string(name) + " cannot be of CMPI type " + std::to_string(value.type()));
    keys_.set(Arena::required(), name, value.asKey());
}

std::string ObjectPath::toText() const
{
    return Host::toText(*this);
}

ObjectPath& ObjectPath::copiedTo(Arena& arena) const
{
    auto& copy = arena.make<ObjectPath>(*nameSpace_, *host_, *className_);
    copy.keys_ = keys_.shared();
    return copy;
}

void ObjectPath::addProviderKey(const char* name, const CMPIValue* value, CMPIType type)
{
    addKey(requiredText(name, "the key's name"), Value::from(Arena::required(), value, type));
}

CMPIData ObjectPath::getKey(const char* name) const
{
    return keys_.get(name, CMPI_RC_ERR_NOT_FOUND);
}

CMPIData ObjectPath::getKeyAt(CMPICount position, CMPIString** name) const
{
    return keys_.getAt(position, name);
}

const CMPIObjectPathFT ObjectPath::functions = {
    .ftVersion = CMPIVersion200,
    .release = notOffered,
    .clone = notOffered,
    .setNameSpace = slot<&ObjectPath::setNameSpace>,
    .getNameSpace = slot<+[](const ObjectPath& path) { return path.nameSpace_->handle(); }>,
    .setHostname = slot<&ObjectPath::setHost>,
    .getHostname = slot<+[](const ObjectPath& path) { return path.host_->handle(); }>,
    .setClassName = slot<&ObjectPath::setClassName>,
    .getClassName = slot<+[](const ObjectPath& path) { return path.className_->handle(); }>,
    .addKey = slot<&ObjectPath::addProviderKey>,
    .getKey = slot<&ObjectPath::getKey>,
    .getKeyAt = slot<&ObjectPath::getKeyAt>,
    .getKeyCount = slot<+[](const ObjectPath& path) { return path.keys_.size(); }>,
    .setNameSpaceFromObjectPath = notOffered,
    .setHostAndNameSpaceFromObjectPath = notOffered,
    .getClassQualifier = notOffered,
    .getPropertyQualifier = notOffered,
    .getMethodQualifier = notOffered,
    .getParameterQualifier = notOffered,
    .toString = notOffered,
};

} // namespace Host
