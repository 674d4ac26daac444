// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/cimxml/QualifierElement.h"

#include "host/broker/Types.h"
#include "host/broker/Value.h"
#include "host/cimxml/Literal.h"

#include <array>
#include <utility>

namespace Host::CimXml {

namespace {

constexpr std::array<std::pair<Scope, const char*>, 7> scopeAttributes = {{
    {Scope::classes, "CLASS"},
    {Scope::association, "ASSOCIATION"},
    {Scope::reference, "REFERENCE"},
    {Scope::property, "PROPERTY"},
    {Scope::method, "METHOD"},
    {Scope::parameter, "PARAMETER"},
    {Scope::indication, "INDICATION"},
}};

void writeScalar(std::string& out, const Scalar& value)
{
    const Markup element(out, "VALUE");
    if (const auto* const text = std::get_if<std::string>(&value))
        appendEscaped(out, *text);
    else if (const auto* const truth = std::get_if<bool>(&value))
        appendLiteral(out, Value::boolean(*truth));
    else if (const auto* const number = std::get_if<std::int64_t>(&value))
        out += std::to_string(*number);
    else
        out += std::to_string(std::get<std::uint64_t>(value));
}

void writeFlavor(Markup& element, const Flavor& flavor)
{
    if (!flavor.isOverridable)
        element.attribute("OVERRIDABLE", "false");
    if (!flavor.isInherited)
        element.attribute("TOSUBCLASS", "false");
    if (flavor.isTranslatable)
        element.attribute("TRANSLATABLE", "true");
}

void writeScopes(std::string& out, const ScopeSet& scopes)
{
    Markup element(out, "SCOPE");
    for (const auto& [scope, name] : scopeAttributes)
        if (scopes.has(scope))
            element.attribute(name, "true");
}

} // namespace

std::string_view elementNameFor(CMPIType propertyType)
{
    if (isArrayType(propertyType))
        return "PROPERTY.ARRAY";
    return propertyType == CMPI_ref ? "PROPERTY.REFERENCE" : "PROPERTY";
}

void writeEmbeddedObject(Markup& element, const QualifierList& qualifiers)
{
    if (!qualifierText(qualifiers, "EmbeddedInstance").empty())
        element.attribute("EmbeddedObject", "instance");
    else if (isQualified(qualifiers, "EmbeddedObject"))
        element.attribute("EmbeddedObject", "object");
}

void writeConstant(std::string& out, const Constant& value)
{
    if (isNull(value))
        return;
    if (const Scalar* const scalar = std::get_if<Scalar>(&value)) {
        writeScalar(out, *scalar);
        return;
    }
    const Markup element(out, "VALUE.ARRAY");
    for (const Scalar& each : std::get<std::vector<Scalar>>(value))
        if (!isNull(each))
            writeScalar(out, each);
}

void writeQualifiers(
    std::string& out, const QualifierList& qualifiers, const ObjectSelection& selection)
{
    for (const Qualifier& qualifier : qualifiers) {
        if (!isSelected(selection, qualifier))
            continue;
        const CMPIType type = qualifier.declaration->type;
        Markup element(out, "QUALIFIER");
        element.attribute("NAME", qualifier.name()).attribute("TYPE", nameOf(type));
        if (qualifier.isPropagated)
            element.attribute("PROPAGATED", "true");
        writeFlavor(element, qualifier.flavor());
        writeConstant(out, qualifier.value);
    }
}

void writeQualifierDeclaration(std::string& out, const QualifierDeclaration& declared)
{
    Markup element(out, "QUALIFIER.DECLARATION");
    element.attribute("NAME", declared.name).attribute("TYPE", nameOf(declared.type));
    element.attribute("ISARRAY", isArrayType(declared.type) ? "true" : "false");
    writeFlavor(element, declared.flavor);
    writeScopes(out, declared.scopes);
    writeConstant(out, declared.defaultValue);
}

} // namespace Host::CimXml
