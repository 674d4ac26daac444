// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// An intrinsic operation (DSP0200) with its parameters.

#pragma once

#include "host/cimxml/ObjectSelection.h"

#include <cstdint>
#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace Host {
class ObjectPath;
class Repository;
} // namespace Host

namespace Host::CimXml {

class Message;

enum class OperationKind {
    getInstance,
    enumerateInstances,
    enumerateInstanceNames,
    getProperty,
    associators,
    associatorNames,
    references,
    referenceNames,
    getClass,
    enumerateClasses,
    enumerateClassNames,
    getQualifier,
    enumerateQualifiers,
    openEnumerateInstances,
    openEnumerateInstancePaths,
    openAssociatorInstances,
    openAssociatorInstancePaths,
    openReferenceInstances,
    openReferenceInstancePaths,
    pullInstancesWithPath,
    pullInstancePaths,
    closeEnumeration,
};

// Parameters that the operation does not have or the client did not give keep the values below;
// flags have the defaults of their operation. Namespaces and classes are spelled as they are
// declared, or as the client spells them where they are not.
struct Operation {
    OperationKind kind = OperationKind::getInstance;
    std::string nameSpace;

    std::string className;      // the path's, where there is one; empty for all classes
    ObjectPath* path = nullptr; // of the instance, or of an association's source

    bool deepInheritance = false;
    ObjectSelection selection;

    // Operations on references have their association class in resultClass.
    std::string associationClass;
    std::string resultClass;
    std::string role;
    std::string resultRole;

    std::string propertyName;
    std::string qualifierName;

    std::string filterQueryLanguage;
    std::string filterQuery;
    std::optional<std::uint32_t> operationTimeout; // in seconds
    bool continueOnError = false;
    std::uint32_t maxObjectCount = 0;
    std::string enumerationContext;
};

// Reads the call. Paths live in the arena of this thread's request, which must be there. Throws
// RequestError for elements that lack something, and Refusal:
//
//   CMPI_RC_ERR_INVALID_NAMESPACE   there is no such namespace
//   CMPI_RC_ERR_NOT_SUPPORTED       an operation that is not offered
//   CMPI_RC_ERR_METHOD_NOT_AVAILABLE  a method of a class: no class has one
//   CMPI_RC_ERR_INVALID_PARAMETER   a parameter that is missing, unknown, given twice or of
//                                   another kind, or a value that does not fit; it is named
//   CMPI_RC_ERR_INVALID_CLASS       a key without name, or a method, of a class that is not known
Operation readOperation(const Message& message, const Repository& classes);

} // namespace Host::CimXml
