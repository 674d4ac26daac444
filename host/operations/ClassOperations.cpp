// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/operations/ClassOperations.h"

#include "host/broker/Refusal.h"
#include "host/operations/KnownClass.h"
#include "host/repository/Repository.h"

namespace Host {

using CimXml::Operation;

namespace {

std::vector<const ClassDeclaration*> subclassesOf(
    const Repository& classes, const Operation& operation)
{
    findNamedClass(classes, operation.nameSpace, operation.className);
    return classes.subclasses(operation.nameSpace, operation.className,
        operation.deepInheritance ? Repository::Depth::deep : Repository::Depth::direct);
}

[[noreturn]] void refuseUnknown(
    const std::string& kind, const std::string& name, const std::string& nameSpace)
{
    throw Refusal(CMPI_RC_ERR_NOT_FOUND, "there is no " + kind + " " + name + " in " + nameSpace);
}

} // namespace

void getClass(const Repository& classes, const Operation& operation, FoundObjects& found)
{
    const auto* const declared = classes.findClass(operation.nameSpace, operation.className);
    if (declared == nullptr)
        refuseUnknown("class", operation.className, operation.nameSpace);
    found.add(declared);
}

void enumerateClasses(const Repository& classes, const Operation& operation, FoundObjects& found)
{
    for (const ClassDeclaration* const declared : subclassesOf(classes, operation))
        found.add(declared);
}

void enumerateClassNames(const Repository& classes, const Operation& operation, FoundObjects& found)
{
    for (const ClassDeclaration* const declared : subclassesOf(classes, operation))
        found.add(ClassName{declared->name});
}

void getQualifier(const Repository& classes, const Operation& operation, FoundObjects& found)
{
    const auto* const declared =
        classes.findQualifier(operation.nameSpace, operation.qualifierName);
    if (declared == nullptr)
        refuseUnknown("qualifier", operation.qualifierName, operation.nameSpace);
    found.add(declared);
}

void enumerateQualifiers(const Repository& classes, const Operation& operation, FoundObjects& found)
{
    for (const auto& declared : classes.findNamespace(operation.nameSpace)->qualifiers())
        found.add(declared.get());
}

} // namespace Host
