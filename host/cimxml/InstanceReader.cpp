// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/cimxml/InstanceReader.h"

#include "host/broker/Array.h"
#include "host/broker/Types.h"
#include "host/cimxml/InvalidParameter.h"
#include "host/cimxml/Literal.h"
#include "host/cimxml/MessageParts.h"
#include "host/repository/MofError.h"
#include "host/repository/Words.h"

namespace Host::CimXml {

namespace {

Value literal(CMPIType type, const Element& element, const std::string& what)
{
    const std::string text = element.content();
    const auto value = readLiteral(Arena::required(), type, text);
    if (!value)
        refuse(what + ": " + quotation(text) + " is no value of type " + nameOfType(type));
    return *value;
}

Value array(CMPIType type, const Element& element, const std::string& what)
{
    const std::vector<Element> elements = element.children({"VALUE", "VALUE.NULL"});
    Array& made = Array::make(Arena::required(), type, static_cast<CMPICount>(elements.size()));
    CMPICount position = 0;
    for (const Element& each : elements) {
        if (each.is("VALUE"))
            made.set(position, literal(type, each, what));
        ++position;
    }
    return Value::of(made);
}

CMPIType typeOf(const Element& property, const std::string& what)
{
    if (property.is("PROPERTY.REFERENCE"))
        return CMPI_ref;
    const std::string_view word = property.attribute("TYPE");
    const auto type = typeNamed(word);
    if (!type || *type == CMPI_ref)
        refuse(what + ": " + quotation(word) + " is no type of a value");
    return property.is("PROPERTY.ARRAY") ? arrayOf(*type) : *type;
}

} // namespace

const Instance& InstanceReader::instance(
    const Element& element, std::string_view nameSpace, const ObjectPath* path) const
{
    const std::string_view name = element.attribute("CLASSNAME");
    const ClassDeclaration* const declared = classes_.findClass(nameSpace, name);
    Arena& arena = Arena::required();
    if (path == nullptr)
        path = &ObjectPath::make(
            arena, nameSpace, declared == nullptr ? name : std::string_view(declared->name));
    Instance& made = Instance::make(arena, *path, &classes_);
    const std::vector<Element> parts =
        element.children({"QUALIFIER", "PROPERTY", "PROPERTY.ARRAY", "PROPERTY.REFERENCE"});
    if (parts.size() > maximumUndeclared && declared == nullptr)
        refuse("more than " + std::to_string(maximumUndeclared) + " properties of class " +
               quotation(name) + ", which is not known");
    for (const Element& each : parts)
        if (!each.is("QUALIFIER"))
            setProperty(made, each, declared, nameSpace);
    return made;
}

void InstanceReader::setProperty(Instance& instance, const Element& element,
    const ClassDeclaration* declared, std::string_view nameSpace) const
{
    const std::string_view name = element.attribute("NAME");
    const std::string what = "property " + quotation(name);
    const PropertyDeclaration* const property =
        declared == nullptr ? nullptr : declared->property(name);
    if (name.empty())
        refuse("a property with an empty name");
    if (declared != nullptr && property == nullptr)
        refuse(what + " is none of class " + declared->name);
    if (instance.property(name) != nullptr)
        refuse(what + " comes twice");
    std::optional<Element> content;
    for (const Element& child :
        element.children({"QUALIFIER", "VALUE", "VALUE.ARRAY", "VALUE.REFERENCE"})) {
        if (child.is("QUALIFIER"))
            continue;
        if (content)
            child.fail("a second value");
        content = child;
    }
    const CMPIType type = property == nullptr ? typeOf(element, what) : property->type;
    instance.setProperty(property == nullptr ? name : std::string_view(property->name),
        value(content, type, what, nameSpace));
}

Value InstanceReader::value(const std::optional<Element>& element, CMPIType type,
    const std::string& what, std::string_view nameSpace) const
{
    if (!element)
        return Value::null(type);
    const char* const expected = isArrayType(type)  ? "VALUE.ARRAY"
                                 : type == CMPI_ref ? "VALUE.REFERENCE"
                                                    : "VALUE";
    if (!element->is(expected) || type == arrayOf(CMPI_ref))
        refuse(what + " is of type " + nameOfType(type) + ", which no " +
               std::string(element->name()) + " can be");
    if (isArrayType(type))
        return array(elementType(type), *element, what);
    if (type == CMPI_ref)
        return Value::of(paths_.reference(*element, nameSpace));
    return literal(type, *element, what);
}

} // namespace Host::CimXml
