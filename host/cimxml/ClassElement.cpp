// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/cimxml/ClassElement.h"

#include "host/cimxml/Literal.h"
#include "host/cimxml/QualifierElement.h"

namespace Host::CimXml {

namespace {

void writeProperty(std::string& out, const PropertyDeclaration& property,
    const ClassDeclaration& declared, const ObjectSelection& selection)
{
    Markup element(out, elementNameFor(property.type));
    element.attribute("NAME", property.name);
    if (property.isReference())
        element.attribute("REFERENCECLASS", property.referenceClass);
    else
        element.attribute("TYPE", nameOf(property.type));
    if (selection.includeClassOrigin)
        element.attribute("CLASSORIGIN", property.origin->name);
    if (property.declaredIn != &declared)
        element.attribute("PROPAGATED", "true");
    writeEmbeddedObject(element, property.qualifiers);
    writeQualifiers(out, property.qualifiers, selection);
    if (!property.isReference())
        writeConstant(out, property.defaultValue);
}

} // namespace

void writeClass(
    std::string& out, const ClassDeclaration& declared, const ObjectSelection& selection)
{
    Markup element(out, "CLASS");
    element.attribute("NAME", declared.name);
    if (declared.superclass != nullptr)
        element.attribute("SUPERCLASS", declared.superclass->name);
    writeQualifiers(out, declared.qualifiers, selection);
    for (const auto& property : declared.properties)
        if (isSelected(selection, &declared, property->name))
            writeProperty(out, *property, declared, selection);
}

} // namespace Host::CimXml
