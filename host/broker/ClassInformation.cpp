// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/broker/ClassInformation.h"

#include "host/broker/Names.h"

#include <utility>

namespace Host {

std::vector<ReferenceProperty> ClassInformation::referencesOf(
    std::string_view, std::string_view) const
{
    return {};
}

void ClassTable::add(std::string className, std::vector<std::string> keys, std::string superclass,
    std::vector<ReferenceProperty> references)
{
    classes_.push_back(
        {std::move(className), std::move(keys), std::move(superclass), std::move(references)});
}

const std::vector<std::string>* ClassTable::keysOf(
    std::string_view, std::string_view className) const
{
    const Class* const found = find(className);
    return found == nullptr ? nullptr : &found->keys;
}

bool ClassTable::isDerivedFrom(
    std::string_view, std::string_view className, std::string_view ancestor) const
{
    // No chain is longer than the table, whatever circle somebody put into it.
    const Class* current = find(className);
    for (std::size_t steps = 0; current != nullptr && steps < classes_.size(); ++steps) {
        if (equalNames(current->superclass, ancestor))
            return true;
        current = find(current->superclass);
    }
    return false;
}

std::vector<ReferenceProperty> ClassTable::referencesOf(
    std::string_view, std::string_view className) const
{
    const Class* const found = find(className);
    return found == nullptr ? std::vector<ReferenceProperty>{} : found->references;
}

const ClassTable::Class* ClassTable::find(std::string_view className) const
{
    for (const Class& known : classes_)
        if (equalNames(known.name, className))
            return &known;
    return nullptr;
}

} // namespace Host
