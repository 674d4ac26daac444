// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/cimxml/PathReader.h"

#include "host/broker/Arena.h"
#include "host/broker/Names.h"
#include "host/broker/Refusal.h"
#include "host/cimxml/InvalidParameter.h"
#include "host/cimxml/Literal.h"
#include "host/cimxml/Quotation.h"
#include "host/repository/TypeNames.h"

#include <algorithm>

namespace Host::CimXml {

namespace {

// Bounds the keys of a path whose class is not known, since each is compared with all before it. A
// known class bounds the keys itself.
constexpr std::size_t maximumUndeclared = 1000;

// Returns the type that a KEYVALUE itself names; CMPI_null for a number of any type.
CMPIType namedType(const Element& element, const std::string& what)
{
    if (const auto word = element.findAttribute("TYPE")) {
        const auto type = typeNamed(*word);
        if (!type || *type == CMPI_ref)
            refuse(what + ": " + quotation(*word) + " is no type of a value");
        return *type;
    }
    const std::string_view kind = element.findAttribute("VALUETYPE").value_or("string");
    if (equalNames(kind, "string"))
        return CMPI_string;
    if (equalNames(kind, "boolean"))
        return CMPI_boolean;
    if (!equalNames(kind, "numeric"))
        refuse(what + ": " + quotation(kind) + " is no VALUETYPE");
    return CMPI_null;
}

// Returns the only key of a class, for a KEYVALUE without KEYBINDING.
const std::string& onlyKeyOf(const ClassDeclaration* declared, const ObjectPath& path)
{
    if (declared == nullptr)
        throw Refusal(CMPI_RC_ERR_INVALID_CLASS,
            "class " + quotation(path.className()) + " is not known, so its key has no name");
    if (declared->keys.size() != 1)
        refuse("a key without name, but class " + declared->name + " has " +
               std::to_string(declared->keys.size()) + " keys");
    return declared->keys.front();
}

} // namespace

std::string nameSpaceOf(const Element& localNameSpacePath)
{
    std::string all;
    for (const Element& part : localNameSpacePath.children({"NAMESPACE"})) {
        // Some clients write a namespace of several components into one NAMESPACE.
        std::string_view rest = part.attribute("NAME");
        while (!rest.empty()) {
            const std::string_view name = rest.substr(0, rest.find('/'));
            if (!name.empty())
                all.append(all.empty() ? "" : "/").append(name);
            rest.remove_prefix(std::min(name.size() + 1, rest.size()));
        }
    }
    if (all.empty())
        localNameSpacePath.fail("it names no namespace");
    return all;
}

ObjectPath& PathReader::instanceName(const Element& element, std::string_view nameSpace) const
{
    return instance(element, nameSpace, 1);
}

std::string PathReader::className(const Element& element, std::string_view nameSpace) const
{
    const std::string_view name =
        element.attribute(element.is("INSTANCENAME") ? "CLASSNAME" : "NAME");
    const ClassDeclaration* const declared = classes_.findClass(nameSpace, name);
    return declared == nullptr ? std::string(name) : declared->name;
}

const ClassDeclaration* PathReader::declaredClass(const ObjectPath& path) const
{
    return classes_.findClass(path.nameSpace(), path.className());
}

std::string_view PathReader::declaredNameSpace(std::string_view nameSpace) const
{
    const Namespace* const declared = classes_.findNamespace(nameSpace);
    return declared == nullptr ? nameSpace : declared->name();
}

ObjectPath& PathReader::emptyPath(
    const Element& named, const char* attribute, std::string_view nameSpace) const
{
    const std::string_view name = named.attribute(attribute);
    if (name.empty())
        refuse("a path without the name of a class");
    const ClassDeclaration* const declared = classes_.findClass(nameSpace, name);
    return ObjectPath::make(Arena::required(), declaredNameSpace(nameSpace),
        declared == nullptr ? name : std::string_view(declared->name));
}

ObjectPath& PathReader::instance(
    const Element& element, std::string_view nameSpace, unsigned depth) const
{
    if (depth > Value::maximumNesting)
        refuse("paths more than " + std::to_string(Value::maximumNesting) + " deep in one another");
    ObjectPath& path = emptyPath(element, "CLASSNAME", nameSpace);
    const std::vector<Element>& keys =
        element.children({"KEYBINDING", "KEYVALUE", "VALUE.REFERENCE"});
    if (keys.size() > maximumUndeclared && declaredClass(path) == nullptr)
        refuse("more than " + std::to_string(maximumUndeclared) + " keys of class " +
               quotation(path.className()) + ", which is not known");
    for (const Element& key : keys) {
        if (key.is("KEYBINDING")) {
            addKey(path, std::string(key.attribute("NAME")),
                key.child({"KEYVALUE", "VALUE.REFERENCE"}), depth);
            continue;
        }
        if (keys.size() > 1)
            key.fail("a key without name must be the only one");
        addKey(path, onlyKeyOf(declaredClass(path), path), key, depth);
    }
    return path;
}

ObjectPath& PathReader::target(
    const Element& element, std::string_view nameSpace, unsigned depth) const
{
    const Element& found = element.child({"INSTANCENAME", "LOCALINSTANCEPATH", "INSTANCEPATH",
        "CLASSNAME", "LOCALCLASSPATH", "CLASSPATH"});
    const auto named = [&](const Element& name, std::string_view where) -> ObjectPath& {
        return name.is("CLASSNAME") ? emptyPath(name, "NAME", where) : instance(name, where, depth);
    };
    if (found.is("INSTANCENAME") || found.is("CLASSNAME"))
        return named(found, nameSpace);
    std::string host;
    std::string ownNameSpace;
    const Element* name = nullptr;
    const auto& parts =
        found.children({"NAMESPACEPATH", "LOCALNAMESPACEPATH", "INSTANCENAME", "CLASSNAME"});
    for (const Element& part : parts) {
        if (part.is("NAMESPACEPATH")) {
            for (const Element& inner : part.children({"HOST", "LOCALNAMESPACEPATH"})) {
                std::string& value = inner.is("HOST") ? host : ownNameSpace;
                if (!value.empty())
                    part.fail("it needs one host and one namespace");
                value = inner.is("HOST") ? inner.content() : nameSpaceOf(inner);
            }
        } else if (part.is("LOCALNAMESPACEPATH")) {
            ownNameSpace = nameSpaceOf(part);
        } else {
            name = &part;
        }
    }
    if (parts.size() != 2 || name == nullptr || ownNameSpace.empty())
        found.fail("it needs a namespace and a name");
    ObjectPath& path = named(*name, ownNameSpace);
    if (!host.empty())
        path.setHost(host.c_str());
    return path;
}

void PathReader::addKey(
    ObjectPath& path, const std::string& name, const Element& element, unsigned depth) const
{
    const ClassDeclaration* const declared = declaredClass(path);
    const PropertyDeclaration* const property =
        declared == nullptr ? nullptr : declared->property(name);
    const std::string what = "key " + quotation(name);
    if (name.empty())
        refuse("a key with an empty name");
    if (declared != nullptr && (property == nullptr || !property->isKey))
        refuse(what + " is none of class " + declared->name);
    if (path.key(name) != nullptr)
        refuse(what + " comes twice");
    const bool isReference = element.is("VALUE.REFERENCE");
    if (property != nullptr && property->isReference() != isReference)
        refuse(what + (isReference ? " is no reference" : " is a reference"));
    const std::string_view spelling = property == nullptr ? std::string_view(name) : property->name;
    path.addKey(spelling, isReference ? Value::of(target(element, path.nameSpace(), depth + 1))
                                      : keyValue(element, what, property));
}

Value PathReader::keyValue(
    const Element& element, const std::string& what, const PropertyDeclaration* declared) const
{
    const CMPIType type = declared == nullptr ? namedType(element, what) : declared->type;
    const std::string& text = element.content();
    Arena& arena = Arena::required();
    const auto value = type == CMPI_null ? readNumber(arena, text) : readLiteral(arena, type, text);
    if (!value)
        refuse(what + ": " + quotation(text) + " is no " +
               (type == CMPI_null ? "number" : "value of type " + nameOfType(type)));
    return *value;
}

} // namespace Host::CimXml
