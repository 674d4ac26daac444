// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The class information that the broker and the manager use.

#pragma once

#include <string>
#include <string_view>
#include <vector>

namespace Host {

// A property of an association class that refers to instances of a class, or of one below it.
struct ReferenceProperty {
    std::string name;
    std::string className;
};

// Immutable; any thread may call it at any time without locks.
class ClassInformation {
public:
    virtual ~ClassInformation() = default;

    // Returns the names of the class's key properties; null when the class is not known. The list
    // lives as long as this object.
    virtual const std::vector<std::string>* keysOf(
        std::string_view nameSpace, std::string_view className) const = 0;

    // Returns whether the class is derived from the other one, at any distance.
    virtual bool isDerivedFrom(std::string_view nameSpace, std::string_view className,
        std::string_view ancestor) const = 0;

    // Returns the reference properties of an association class, inherited ones included; none for
    // any other class and for one that is not known.
    virtual std::vector<ReferenceProperty> referencesOf(
        std::string_view nameSpace, std::string_view className) const = 0;
};

} // namespace Host
