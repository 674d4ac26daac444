// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/cimxml/ObjectSelection.h"

#include "host/broker/Names.h"
#include "host/repository/ClassDeclaration.h"

#include <algorithm>

namespace Host::CimXml {

bool isListed(const ObjectSelection& selection, std::string_view propertyName)
{
    return !selection.properties ||
           std::any_of(selection.properties->begin(), selection.properties->end(),
               [&](const std::string& listed) { return equalNames(listed, propertyName); });
}

bool isSelected(const ObjectSelection& selection, const ClassDeclaration* declared,
    std::string_view propertyName)
{
    if (!isListed(selection, propertyName))
        return false;
    if (!selection.localOnly || declared == nullptr)
        return true;
    const PropertyDeclaration* const property = declared->property(propertyName);
    return property == nullptr || property->declaredIn == declared;
}

bool isSelected(const ObjectSelection& selection, const Qualifier& qualifier)
{
    return selection.includeQualifiers && (!selection.localOnly || !qualifier.isPropagated);
}

} // namespace Host::CimXml
