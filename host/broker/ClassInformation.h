// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// What the host knows about classes and the broker makes use of.

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

// Asked from any thread at any time, without locks: what it says does not change while the
// broker uses it.
class ClassInformation {
public:
    virtual ~ClassInformation() = default;

    // The names of the class's key properties; null when the class is not known. The list
    // lives as long as this object.
    virtual const std::vector<std::string>* keysOf(
        std::string_view nameSpace, std::string_view className) const = 0;

    // Whether the class is derived from the other one, at any distance.
    virtual bool isDerivedFrom(std::string_view nameSpace, std::string_view className,
        std::string_view ancestor) const = 0;

    // The reference properties of an association class, inherited ones included. None for any
    // other class, for one that is not known, and for all where nothing is known of associations.
    virtual std::vector<ReferenceProperty> referencesOf(
        std::string_view nameSpace, std::string_view className) const;
};

// A table of classes, the same in every namespace.
class ClassTable : public ClassInformation {
public:
    // REQUIRES: no broker uses the table yet.
    void add(std::string className, std::vector<std::string> keys, std::string superclass = {},
        std::vector<ReferenceProperty> references = {});

    const std::vector<std::string>* keysOf(
        std::string_view nameSpace, std::string_view className) const override;
    bool isDerivedFrom(std::string_view nameSpace, std::string_view className,
        std::string_view ancestor) const override;
    std::vector<ReferenceProperty> referencesOf(
        std::string_view nameSpace, std::string_view className) const override;

private:
    struct Class {
        std::string name;
        std::vector<std::string> keys;
        std::string superclass;
        std::vector<ReferenceProperty> references;
    };

    const Class* find(std::string_view className) const;

    std::vector<Class> classes_;
};

} // namespace Host
