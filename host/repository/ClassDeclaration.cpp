// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/repository/ClassDeclaration.h"

#include "host/broker/Names.h"

namespace Host {

namespace {

template <typename List>
auto findNamed(const List& list, std::string_view name) -> decltype(list.front().get())
{
    for (const auto& each : list)
        if (equalNames(each->name, name))
            return each.get();
    return nullptr;
}

} // namespace

const PropertyDeclaration* ClassDeclaration::property(std::string_view propertyName) const
{
    return findNamed(properties, propertyName);
}

const MethodDeclaration* ClassDeclaration::method(std::string_view methodName) const
{
    return findNamed(methods, methodName);
}

bool ClassDeclaration::isDerivedFrom(std::string_view ancestor) const
{
    for (const ClassDeclaration* above = superclass; above != nullptr; above = above->superclass)
        if (equalNames(above->name, ancestor))
            return true;
    return false;
}

bool ClassDeclaration::isDerivedFrom(const ClassDeclaration& ancestor) const
{
    for (const ClassDeclaration* above = superclass; above != nullptr; above = above->superclass)
        if (above == &ancestor)
            return true;
    return false;
}

} // namespace Host
