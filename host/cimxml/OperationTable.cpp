// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/cimxml/OperationTable.h"

#include "host/broker/Names.h"

#include <array>

namespace Host::CimXml {

namespace {

using Kind = OperationKind;
using P = Parameter;
using Set = ParameterSet;

constexpr Set Nothing;
constexpr Set Association(P::assocClass, P::resultClass, P::role, P::resultRole);
constexpr Set Reference(P::resultClass, P::role);
constexpr Set Look(P::includeQualifiers, P::includeClassOrigin, P::propertyList);
constexpr Set Opening(P::filterQuery, P::filterQueryLanguage, P::operationTimeout,
    P::continueOnError, P::maxObjectCount);
constexpr Set OpeningInstances = Opening | Set(P::includeClassOrigin, P::propertyList);

constexpr std::array<OperationForm, 27> Forms = {{
    {Kind::getInstance, "GetInstance", {P::instanceName}, Look | P::localOnly, {P::localOnly}},
    {Kind::enumerateInstances, "EnumerateInstances", {P::className},
        Look | Set(P::localOnly, P::deepInheritance), {P::localOnly, P::deepInheritance}},
    {Kind::enumerateInstanceNames, "EnumerateInstanceNames", {P::className}, Nothing, Nothing},
    {Kind::createInstance, "CreateInstance", {P::newInstance}, Nothing, Nothing},
    {Kind::modifyInstance, "ModifyInstance", {P::modifiedInstance},
        {P::includeQualifiers, P::propertyList}, {P::includeQualifiers}},
    {Kind::deleteInstance, "DeleteInstance", {P::instanceName}, Nothing, Nothing},
    {Kind::getProperty, "GetProperty", {P::instanceName, P::propertyName}, Nothing, Nothing},
    {Kind::setProperty, "SetProperty", {P::instanceName, P::propertyName}, {P::newValue}, Nothing},
    {Kind::execQuery, "ExecQuery", {P::queryLanguage, P::query}, Nothing, Nothing},
    {Kind::associators, "Associators", {P::objectName}, Association | Look, Nothing},
    {Kind::associatorNames, "AssociatorNames", {P::objectName}, Association, Nothing},
    {Kind::references, "References", {P::objectName}, Reference | Look, Nothing},
    {Kind::referenceNames, "ReferenceNames", {P::objectName}, Reference, Nothing},
    {Kind::getClass, "GetClass", {P::className}, Look | P::localOnly,
        {P::localOnly, P::includeQualifiers}},
    {Kind::enumerateClasses, "EnumerateClasses", Nothing,
        {P::className, P::deepInheritance, P::localOnly, P::includeQualifiers,
            P::includeClassOrigin},
        {P::localOnly, P::includeQualifiers}},
    {Kind::enumerateClassNames, "EnumerateClassNames", Nothing, {P::className, P::deepInheritance},
        Nothing},
    {Kind::getQualifier, "GetQualifier", {P::qualifierName}, Nothing, Nothing},
    {Kind::enumerateQualifiers, "EnumerateQualifiers", Nothing, Nothing, Nothing},
    {Kind::openEnumerateInstances, "OpenEnumerateInstances", {P::className},
        OpeningInstances | P::deepInheritance, {P::deepInheritance}},
    {Kind::openEnumerateInstancePaths, "OpenEnumerateInstancePaths", {P::className}, Opening,
        Nothing},
    {Kind::openAssociatorInstances, "OpenAssociatorInstances", {P::instanceName},
        OpeningInstances | Association, Nothing},
    {Kind::openAssociatorInstancePaths, "OpenAssociatorInstancePaths", {P::instanceName},
        Opening | Association, Nothing},
    {Kind::openReferenceInstances, "OpenReferenceInstances", {P::instanceName},
        OpeningInstances | Reference, Nothing},
    {Kind::openReferenceInstancePaths, "OpenReferenceInstancePaths", {P::instanceName},
        Opening | Reference, Nothing},
    {Kind::pullInstancesWithPath, "PullInstancesWithPath",
        {P::enumerationContext, P::maxObjectCount}, Nothing, Nothing},
    {Kind::pullInstancePaths, "PullInstancePaths", {P::enumerationContext, P::maxObjectCount},
        Nothing, Nothing},
    {Kind::closeEnumeration, "CloseEnumeration", {P::enumerationContext}, Nothing, Nothing},
}};

// In the order of Parameter.
constexpr std::array<std::string_view, ParameterCount> ParameterNames = {"AssocClass", "ClassName",
    "ContinueOnError", "DeepInheritance", "EnumerationContext", "FilterQuery",
    "FilterQueryLanguage", "IncludeClassOrigin", "IncludeQualifiers", "InstanceName", "LocalOnly",
    "MaxObjectCount", "ModifiedInstance", "NewInstance", "NewValue", "ObjectName",
    "OperationTimeout", "PropertyList", "PropertyName", "QualifierName", "Query", "QueryLanguage",
    "ResultClass", "ResultRole", "Role"};

} // namespace

const OperationForm* findOperation(std::string_view name)
{
    for (const OperationForm& form : Forms)
        if (equalNames(form.name, name))
            return &form;
    return nullptr;
}

std::string_view nameOf(Parameter parameter)
{
    return ParameterNames[static_cast<std::size_t>(parameter)];
}

} // namespace Host::CimXml
