// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The operations on classes and qualifiers (DSP0200), carried out on the repository.

#pragma once

#include "host/cimxml/Operation.h"
#include "host/operations/FoundObjects.h"

namespace Host {

class Repository;

// All are thread-safe and add the objects to return.

// Throws Refusal (CMPI_RC_ERR_NOT_FOUND) when there is no such class.
void getClass(const Repository& classes, const CimXml::Operation& operation, FoundObjects& found);

// Add the subclasses of the named class, or those without superclass when none is named. Throw
// Refusal (CMPI_RC_ERR_INVALID_CLASS) for a class that is not known.
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
