// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// An instance behind a CMPIInstance: a path and properties, with the filter its provider
// put on them.

#pragma once

#include "host/broker/NamedValues.h"
#include "host/broker/Object.h"

#include <span>
#include <string_view>

namespace Host {

class ClassInformation;
class ObjectPath;

class Instance : public Encapsulated<Instance, CMPIInstance, Object::Kind::instance> {
public:
    // An instance without properties at the path, which is copied. The class information
    // may be null; it must outlive the instance.
    static Instance& make(Arena& arena, const ObjectPath& path, const ClassInformation* classes);

    std::string_view className() const noexcept;
    const NamedValues& properties() const noexcept { return properties_; }
    // Null when there is no such property.
    const Value* property(std::string_view name) const noexcept;

    // A property that the filter leaves out is passed over. The value must live as long as
    // the instance's request.
    void setProperty(std::string_view name, const Value& value);

    // A new path of this thread's request: the one the instance was made with, with the values its
    // key properties have now. Keys are those of the class where it is known, in the order of the
    // properties, else those the provider named in its filter; one without a value is left out.
    ObjectPath& objectPath() const;

    // A new instance, equal to this one.
    Instance& copiedTo(Arena& arena) const;

    static const CMPIInstanceFT functions;

private:
    friend class Arena;
    using Names = std::span<const String* const>;

    Instance(Arena& home, const ObjectPath& path, const ClassInformation* classes);

    bool isKey(std::string_view name) const;
    bool isWanted(std::string_view name) const;
    void setPropertyFilter(const char** properties, const char** keys);
    void setProviderProperty(const char* name, const CMPIValue* value, CMPIType type);
    void setPropertyWithOrigin(
        const char* name, const CMPIValue* value, CMPIType type, const char* origin);
    CMPIData getProperty(const char* name) const;
    CMPIData getPropertyAt(CMPICount position, CMPIString** name) const;
    void setObjectPath(const CMPIObjectPath* path);

    const ObjectPath* path_;
    const ClassInformation* classes_;
    NamedValues properties_;
    bool isFiltered_ = false;
    Names wanted_;   // by the filter
    Names keyNames_; // according to the filter
};

} // namespace Host
