// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// What the host knows about classes and the broker makes use of.

#pragma once

#include <string>
#include <string_view>
#include <vector>

namespace Host {

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
};

// A table of classes, the same in every namespace.
class ClassTable : public ClassInformation {
public:
    // REQUIRES: no broker uses the table yet.
    void add(std::string className, std::vector<std::string> keys, std::string superclass = {});

    const std::vector<std::string>* keysOf(
        std::string_view nameSpace, std::string_view className) const override;
    bool isDerivedFrom(std::string_view nameSpace, std::string_view className,
        std::string_view ancestor) const override;

private:
    struct Class {
        std::string name;
        std::vector<std::string> keys;
        std::string superclass;
    };

    const Class* find(std::string_view className) const;

    std::vector<Class> classes_;
};

} // namespace Host
