// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// An instance behind a CMPIInstance: a path and properties, with the filter that its provider set.

#pragma once

#include "host/broker/NamedValues.h"
#include "host/broker/Object.h"

#include <string_view>

namespace Host {

class ClassInformation;
class ObjectPath;
class PropertyFilter;

class Instance : public Encapsulated<Instance, CMPIInstance, Object::Kind::instance> {
public:
    // Makes an instance without properties at the path, which is copied. The class information
    // may be null; it must outlive the instance.
    static Instance& make(Arena& arena, const ObjectPath& path, const ClassInformation* classes);

    std::string_view nameSpace() const noexcept;
    std::string_view className() const noexcept;
    const NamedValues& properties() const noexcept { return properties_; }
    // Returns null when there is no such property.
    const Value* property(std::string_view name) const noexcept;

    // Sets the property unless the filter leaves it out. The value must live as long as the
    // instance.
    void setProperty(std::string_view name, const Value& value);

    // Returns a new path in this thread's arena: the one that the instance was made with, and the
    // current values of its key properties. Keys are those of the class where it is known, in the
    // order of the properties, else those named in the filter; one without a value is left out.
    ObjectPath& objectPath() const;

    // Returns a new instance, equal to this one. The two share their properties until one of them
    // changes: this one must live as long as the copy.
    Instance& copiedTo(Arena& arena) const;

    static const CMPIInstanceFT functions;

private:
    friend class Arena;

    Instance(const ObjectPath& path, const ClassInformation* classes)
        : path_(&path), classes_(classes)
    {
    }

    bool isKeyOfClass(std::string_view name) const;
    bool isWanted(std::string_view name) const;
    void setPropertyFilter(const char** properties, const char** keys);
    void setProviderProperty(const char* name, const CMPIValue* value, CMPIType type);

    const ObjectPath* path_;
    const ClassInformation* classes_;
    NamedValues properties_;
    PropertyFilter* filter_ = nullptr; // null where none was set
};

} // namespace Host
