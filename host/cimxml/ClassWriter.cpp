// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/cimxml/ClassWriter.h"

#include "host/broker/Types.h"
#include "host/cimxml/Literal.h"
#include "host/cimxml/QualifierWriter.h"

namespace Host::CimXml {

namespace {

template <typename Feature>
void writeOrigin(Markup& element, const Feature& feature, const ClassDeclaration& declared,
    const PropertySelection& selection)
{
    if (selection.includeClassOrigin)
        element.attribute("CLASSORIGIN", feature.origin->name);
    if (feature.declaredIn != &declared)
        element.attribute("PROPAGATED", "true");
}

void writeProperty(std::string& out, const PropertyDeclaration& property,
    const ClassDeclaration& declared, const PropertySelection& selection)
{
    Markup element(out, elementNameFor(property.type));
    element.attribute("NAME", property.name);
    if (property.isReference())
        element.attribute("REFERENCECLASS", property.referenceClass);
    else
        element.attribute("TYPE", nameOf(property.type));
    if (property.arraySize)
        element.attribute("ARRAYSIZE", std::to_string(*property.arraySize));
    writeOrigin(element, property, declared, selection);
    writeEmbeddedObject(element, property.qualifiers);
    writeQualifiers(out, property.qualifiers, selection);
    if (!property.isReference())
        writeConstant(out, *property.defaultValue, property.type);
}

void writeParameter(
    std::string& out, const ParameterDeclaration& parameter, const PropertySelection& selection)
{
    const bool isReference = elementType(parameter.type) == CMPI_ref;
    const bool isArray = isArrayType(parameter.type);
    Markup element(out, isReference ? (isArray ? "PARAMETER.REFARRAY" : "PARAMETER.REFERENCE")
                                    : (isArray ? "PARAMETER.ARRAY" : "PARAMETER"));
    element.attribute("NAME", parameter.name);
    if (isReference)
        element.attribute("REFERENCECLASS", parameter.referenceClass);
    else
        element.attribute("TYPE", nameOf(parameter.type));
    if (parameter.arraySize)
        element.attribute("ARRAYSIZE", std::to_string(*parameter.arraySize));
    writeQualifiers(out, parameter.qualifiers, selection);
}

void writeMethod(std::string& out, const MethodDeclaration& method,
    const ClassDeclaration& declared, const PropertySelection& selection)
{
    Markup element(out, "METHOD");
    element.attribute("NAME", method.name).attribute("TYPE", nameOf(method.type));
    writeOrigin(element, method, declared, selection);
    writeQualifiers(out, method.qualifiers, selection);
    for (const ParameterDeclaration& parameter : method.parameters)
        writeParameter(out, parameter, selection);
}

} // namespace

void writeClass(
    std::string& out, const ClassDeclaration& declared, const PropertySelection& selection)
{
    Markup element(out, "CLASS");
    element.attribute("NAME", declared.name);
    if (declared.superclass != nullptr)
        element.attribute("SUPERCLASS", declared.superclass->name);
    writeQualifiers(out, declared.qualifiers, selection);
    for (const auto& property : declared.properties)
        if (isSelected(selection, &declared, property->name))
            writeProperty(out, *property, declared, selection);
    for (const auto& method : declared.methods)
        if (isSelected(selection, declared, *method))
            writeMethod(out, *method, declared, selection);
}

} // namespace Host::CimXml
