// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The address of a class or instance, behind a CMPIObjectPath.

#pragma once

#include "host/broker/NamedValues.h"
#include "host/broker/Object.h"

#include <string>
#include <string_view>

namespace Host {

class ObjectPath : public Encapsulated<ObjectPath, CMPIObjectPath, Object::Kind::objectPath> {
public:
    // Makes a path without host and keys.
    static ObjectPath& make(Arena& arena, std::string_view nameSpace, std::string_view className);

    // Empty when there is none.
    std::string_view nameSpace() const noexcept;
    std::string_view host() const noexcept;
    std::string_view className() const noexcept;
    const NamedValues& keys() const noexcept { return keys_; }
    // Returns null when there is no such key.
    const Value* key(std::string_view name) const noexcept;

    // A null text removes the namespace or host: providers then get a string object without
    // characters.
    void setNameSpace(const char* nameSpace);
    void setHost(const char* host);
    // Throws Refusal (CMPI_RC_ERR_INVALID_PARAMETER) for null.
    void setClassName(const char* className);

    // Replaces a key of the same name. The value must live as long as the path. Throws Refusal
    // (CMPI_RC_ERR_INVALID_DATA_TYPE) for an array or an instance.
    void addKey(std::string_view name, const Value& value);

    // Returns the untyped URI of DSP0207 without its scheme:
    // //host/namespace:Class.Key="value",N=1. Texts are quoted, with a backslash before quotes and
    // backslashes; a reference is its own URI, quoted.
    std::string toText() const;

    // Returns a new path, equal to this one. The two share their keys until one of them changes:
    // this one must live as long as the copy.
    ObjectPath& copiedTo(Arena& arena) const;

    static const CMPIObjectPathFT functions;

private:
    friend class Arena;
    ObjectPath(const String& nameSpace, const String& host, const String& className)
        : nameSpace_(&nameSpace), host_(&host), className_(&className)
    {
    }

    void addProviderKey(const char* name, const CMPIValue* value, CMPIType type);
    CMPIData getKey(const char* name) const;
    CMPIData getKeyAt(CMPICount position, CMPIString** name) const;

    const String* nameSpace_;
    const String* host_;
    const String* className_;
    NamedValues keys_;
};

} // namespace Host
