// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Classes for tests without a repository.

#pragma once

#include "host/broker/ClassInformation.h"
#include "host/broker/Names.h"

#include <string>
#include <string_view>
#include <utility>
#include <vector>

namespace Testing {

// A table of classes, the same in every namespace.
class ClassTable : public Host::ClassInformation {
public:
    void add(std::string className, std::vector<std::string> keys, std::string superclass = {},
        std::vector<Host::ReferenceProperty> references = {})
    {
        classes_.push_back(
            {std::move(className), std::move(keys), std::move(superclass), std::move(references)});
    }

    const std::vector<std::string>* keysOf(
        std::string_view, std::string_view className) const override
    {
        const Class* const found = find(className);
        return found == nullptr ? nullptr : &found->keys;
    }

    bool isDerivedFrom(std::string_view nameSpace, std::string_view className,
        std::string_view ancestor) const override
    {
        const Class* const found = find(className);
        return found != nullptr && (Host::equalNames(found->superclass, ancestor) ||
                                       isDerivedFrom(nameSpace, found->superclass, ancestor));
    }

    std::vector<Host::ReferenceProperty> referencesOf(
        std::string_view, std::string_view className) const override
    {
        const Class* const found = find(className);
        return found == nullptr ? std::vector<Host::ReferenceProperty>{} : found->references;
    }

private:
    struct Class {
        std::string name;
        std::vector<std::string> keys;
        std::string superclass;
        std::vector<Host::ReferenceProperty> references;
    };

    const Class* find(std::string_view className) const
    {
        for (const Class& known : classes_)
            if (Host::equalNames(known.name, className))
                return &known;
        return nullptr;
    }

    std::vector<Class> classes_;
};

} // namespace Testing
