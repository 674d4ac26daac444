// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/cimxml/InstanceWriter.h"

#include "host/broker/Array.h"
#include "host/broker/String.h"
#include "host/broker/Types.h"
#include "host/cimxml/Literal.h"
#include "host/cimxml/Markup.h"
#include "host/cimxml/PathWriter.h"
#include "host/cimxml/QualifierWriter.h"

namespace Host::CimXml {

namespace {

void writeOne(std::string& out, const Value& value)
{
    Markup element(out, "VALUE");
    const Instance* const embedded = value.instance();
    if (embedded == nullptr) {
        element.content(writeLiteral(value));
        return;
    }
    std::string text;
    writeInstance(text, *embedded, nullptr, {});
    element.content(text);
}

void writeProperty(std::string& out, std::string_view name, const Value& value,
    const PropertyDeclaration* property, const ClassDeclaration* declared,
    const PropertySelection& selection)
{
    const bool isTypeless = value.type() == CMPI_null && property != nullptr;
    const CMPIType type = isTypeless ? property->type : value.type();
    Markup element(out, elementNameFor(type));
    element.attribute("NAME", name);
    if (type != CMPI_ref)
        element.attribute("TYPE", nameOf(type));
    else if (property != nullptr && !property->referenceClass.empty())
        element.attribute("REFERENCECLASS", property->referenceClass);
    if (property != nullptr && property->arraySize && isArrayType(type))
        element.attribute("ARRAYSIZE", std::to_string(*property->arraySize));
    if (selection.includeClassOrigin && property != nullptr) {
        element.attribute("CLASSORIGIN", property->origin->name);
        if (property->declaredIn != declared)
            element.attribute("PROPAGATED", "true");
    }
    if (elementType(type) == CMPI_instance)
        element.attribute("EmbeddedObject", "instance");
    else if (property != nullptr)
        writeEmbeddedObject(element, property->qualifiers);
    if (property != nullptr)
        writeQualifiers(out, property->qualifiers, selection);
    writeValue(out, value);
}

} // namespace

void writeValue(std::string& out, const Value& value)
{
    if (value.isNull())
        return;
    if (const ObjectPath* const reference = value.path()) {
        writeReference(out, *reference);
        return;
    }
    const Array* const array = value.array();
    if (array == nullptr) {
        writeOne(out, value);
        return;
    }
    const Markup element(out, array->type() == CMPI_ref ? "VALUE.REFARRAY" : "VALUE.ARRAY");
    for (const Value& each : array->elements())
        writeValue(out, each);
}

void writeInstance(std::string& out, const Instance& instance, const ClassDeclaration* declared,
    const PropertySelection& selection)
{
    Markup element(out, "INSTANCE");
    element.attribute("CLASSNAME", instance.className());
    if (declared != nullptr)
        writeQualifiers(out, declared->qualifiers, selection);
    for (const auto& [name, value] : instance.properties()) {
        const std::string_view spelling = *name->text();
        if (isSelected(selection, declared, spelling))
            writeProperty(out, spelling, value,
                declared == nullptr ? nullptr : declared->property(spelling), declared, selection);
    }
}

} // namespace Host::CimXml
