// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/repository/ClassDeclaration.h"

#include "host/broker/Names.h"

namespace Host {

const PropertyDeclaration* ClassDeclaration::property(std::string_view propertyName) const
{
    for (const auto& each : properties)
        if (equalNames(each->name, propertyName))
            return each.get();
    return nullptr;
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
