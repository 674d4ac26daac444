// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/cimxml/PropertySelection.h"

#include "host/broker/Names.h"
#include "host/repository/ClassDeclaration.h"

#include <algorithm>

namespace Host::CimXml {

bool isListed(const PropertySelection& selection, std::string_view propertyName)
{
    return !selection.properties ||
           std::any_of(selection.properties->begin(), selection.properties->end(),
               [&](const std::string& listed) { return equalNames(listed, propertyName); });
}

bool isSelected(const PropertySelection& selection, const ClassDeclaration* declared,
    std::string_view propertyName)
{
    if (!isListed(selection, propertyName))
        return false;
    if (!selection.localOnly || declared == nullptr)
        return true;
    const PropertyDeclaration* const property = declared->property(propertyName);
    return property == nullptr || property->declaredIn == declared;
}

bool isSelected(const PropertySelection& selection, const Qualifier& qualifier)
{
    return selection.includeQualifiers && (!selection.localOnly || !qualifier.isPropagated);
}

} // namespace Host::CimXml
