// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Operations on classes and qualifiers, answered by the repository.

#pragma once

#include "host/cimxml/Operation.h"
#include "host/operations/FoundObjects.h"

namespace Host {

class Repository;

// All may be called from any thread, and add what they find to the answer.

// Throws Refusal (CMPI_RC_ERR_NOT_FOUND) when there is no such class.
void getClass(const Repository& classes, const CimXml::Operation& operation, FoundObjects& found);

// The classes below the named one, or all from the roots on. Throw Refusal
// (CMPI_RC_ERR_INVALID_CLASS) for a class that is not known.
void enumerateClasses(
    const Repository& classes, const CimXml::Operation& operation, FoundObjects& found);
void enumerateClassNames(
    const Repository& classes, const CimXml::Operation& operation, FoundObjects& found);

// Throws Refusal (CMPI_RC_ERR_NOT_FOUND) when there is no such qualifier.
void getQualifier(
    const Repository& classes, const CimXml::Operation& operation, FoundObjects& found);
void enumerateQualifiers(
    const Repository& classes, const CimXml::Operation& operation, FoundObjects& found);

} // namespace Host
