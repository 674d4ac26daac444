// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/cimxml/OperationTable.h"

#include "host/broker/Names.h"

#include <array>

namespace Host::CimXml {

namespace {

using Kind = OperationKind;
using P = Parameter;
using Set = ParameterSet;

constexpr Set nothing;
constexpr Set associationFilters(P::assocClass, P::resultClass, P::role, P::resultRole);
constexpr Set referenceFilters(P::resultClass, P::role);
constexpr Set content(P::includeQualifiers, P::includeClassOrigin, P::propertyList);
constexpr Set opening(P::filterQuery, P::filterQueryLanguage, P::operationTimeout,
    P::continueOnError, P::maxObjectCount);
constexpr Set openingInstances = opening | Set(P::includeClassOrigin, P::propertyList);

constexpr std::array<OperationForm, 22> forms = {{
    {Kind::getInstance, "GetInstance", {P::instanceName}, content | P::localOnly, {P::localOnly}},
    {Kind::enumerateInstances, "EnumerateInstances", {P::className},
        content | Set(P::localOnly, P::deepInheritance), {P::localOnly, P::deepInheritance}},
    {Kind::enumerateInstanceNames, "EnumerateInstanceNames", {P::className}, nothing, nothing},
    {Kind::getProperty, "GetProperty", {P::instanceName, P::propertyName}, nothing, nothing},
    {Kind::associators, "Associators", {P::objectName}, associationFilters | content, nothing},
    {Kind::associatorNames, "AssociatorNames", {P::objectName}, associationFilters, nothing},
    {Kind::references, "References", {P::objectName}, referenceFilters | content, nothing},
    {Kind::referenceNames, "ReferenceNames", {P::objectName}, referenceFilters, nothing},
    {Kind::getClass, "GetClass", {P::className}, content | P::localOnly,
        {P::localOnly, P::includeQualifiers}},
    {Kind::enumerateClasses, "EnumerateClasses", nothing,
        {P::className, P::deepInheritance, P::localOnly, P::includeQualifiers,
            P::includeClassOrigin},
        {P::localOnly, P::includeQualifiers}},
    {Kind::enumerateClassNames, "EnumerateClassNames", nothing, {P::className, P::deepInheritance},
        nothing},
    {Kind::getQualifier, "GetQualifier", {P::qualifierName}, nothing, nothing},
    {Kind::enumerateQualifiers, "EnumerateQualifiers", nothing, nothing, nothing},
    {Kind::openEnumerateInstances, "OpenEnumerateInstances", {P::className},
        openingInstances | P::deepInheritance, {P::deepInheritance}},
    {Kind::openEnumerateInstancePaths, "OpenEnumerateInstancePaths", {P::className}, opening,
        nothing},
    {Kind::openAssociatorInstances, "OpenAssociatorInstances", {P::instanceName},
        openingInstances | associationFilters, nothing},
    {Kind::openAssociatorInstancePaths, "OpenAssociatorInstancePaths", {P::instanceName},
        opening | associationFilters, nothing},
    {Kind::openReferenceInstances, "OpenReferenceInstances", {P::instanceName},
        openingInstances | referenceFilters, nothing},
    {Kind::openReferenceInstancePaths, "OpenReferenceInstancePaths", {P::instanceName},
        opening | referenceFilters, nothing},
    {Kind::pullInstancesWithPath, "PullInstancesWithPath",
        {P::enumerationContext, P::maxObjectCount}, nothing, nothing},
    {Kind::pullInstancePaths, "PullInstancePaths", {P::enumerationContext, P::maxObjectCount},
        nothing, nothing},
    {Kind::closeEnumeration, "CloseEnumeration", {P::enumerationContext}, nothing, nothing},
}};

// The names in the order of Parameter.
constexpr std::array<std::string_view, parameterCount> parameterNames = {"AssocClass", "ClassName",
    "ContinueOnError", "DeepInheritance", "EnumerationContext", "FilterQuery",
    "FilterQueryLanguage", "IncludeClassOrigin", "IncludeQualifiers", "InstanceName", "LocalOnly",
    "MaxObjectCount", "ObjectName", "OperationTimeout", "PropertyList", "PropertyName",
    "QualifierName", "ResultClass", "ResultRole", "Role"};

} // namespace

std::span<const OperationForm> offeredOperations()
{
    return forms;
}

const OperationForm* findOperation(std::string_view name)
{
    for (const OperationForm& form : forms)
        if (equalNames(form.name, name))
            return &form;
    return nullptr;
}

std::string_view nameOf(Parameter parameter)
{
    return parameterNames[static_cast<std::size_t>(parameter)];
}

} // namespace Host::CimXml
