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

ObjectPath::ObjectPath(
    Arena& home, const String& nameSpace, const String& host, const String& className)
    : Encapsulated(&home), nameSpace_(&nameSpace), host_(&host), className_(&className)
{
}

ObjectPath& ObjectPath::make(Arena& arena, std::string_view nameSpace, std::string_view className)
{
    return arena.make<ObjectPath>(
        arena, arena.name(nameSpace), arena.name({}), arena.name(className));
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
    nameSpace_ = &nameOrNone(memory(), nameSpace);
}

void ObjectPath::setHost(const char* host)
{
    host_ = &nameOrNone(memory(), host);
}

void ObjectPath::setClassName(const char* className)
{
    className_ = &memory().name(requiredText(className, "the class name"));
}

void ObjectPath::addKey(std::string_view name, const Value& value)
{
    if (isArrayType(value.type()) || value.type() == CMPI_instance)
        throw Refusal(CMPI_RC_ERR_INVALID_DATA_TYPE,
            "key " + std::string(name) + " cannot be of CMPI type " + std::to_string(value.type()));
    keys_.set(memory(), name, value.asKey());
}

std::string ObjectPath::toText() const
{
    return Host::toText(*this);
}

ObjectPath& ObjectPath::copiedTo(Arena& arena) const
{
    const bool livesThere = home_ == &arena;
    const auto copied = [&](const String& name) -> const String& {
        return livesThere ? name : nameOrNone(arena, name.characters());
    };
    ObjectPath& copy =
        arena.make<ObjectPath>(arena, copied(*nameSpace_), copied(*host_), copied(*className_));
    copy.keys_ = keys_.copiedTo(arena, livesThere);
    return copy;
}

void ObjectPath::addProviderKey(const char* name, const CMPIValue* value, CMPIType type)
{
    addKey(requiredText(name, "the key's name"), Value::from(memory(), value, type));
}

CMPIData ObjectPath::getKey(const char* name) const
{
    return keys_.get(name, CMPI_RC_ERR_NOT_FOUND);
}

CMPIData ObjectPath::getKeyAt(CMPICount position, CMPIString** name) const
{
    return keys_.getAt(position, name);
}

void ObjectPath::setNameSpaceFrom(const CMPIObjectPath* other)
{
    setNameSpace(required<ObjectPath>(other).nameSpace_->characters());
}

void ObjectPath::setHostAndNameSpaceFrom(const CMPIObjectPath* other)
{
    setNameSpaceFrom(other);
    setHost(required<ObjectPath>(other).host_->characters());
}

const CMPIObjectPathFT ObjectPath::functions = {
    .ftVersion = CMPIVersion200,
    .release = slot<&ObjectPath::release>,
    .clone = slot<&ObjectPath::cloned>,
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
    .setNameSpaceFromObjectPath = slot<&ObjectPath::setNameSpaceFrom>,
    .setHostAndNameSpaceFromObjectPath = slot<&ObjectPath::setHostAndNameSpaceFrom>,
    .getClassQualifier = notOffered,
    .getPropertyQualifier = notOffered,
    .getMethodQualifier = notOffered,
    .getParameterQualifier = notOffered,
    .toString = slot<+[](const ObjectPath& path) -> const String& {
        return String::make(Arena::required(), path.toText());
    }>,
};

} // namespace Host
