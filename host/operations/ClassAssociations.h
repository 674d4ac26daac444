// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Associations between classes, as the repository declares them.

#pragma once

#include "host/cimxml/Operation.h"

#include <vector>

namespace Host {

class Repository;
struct ClassDeclaration;

// An association class refers to the operation's class when one of its references is of that
// class or of one above it, and has the role where one is given. Both functions return each class
// once, in the order of declaration, and throw Refusal (CMPI_RC_ERR_INVALID_CLASS) for a class of
// the operation that is not known.

// Returns the classes of the other references, filtered by AssocClass, ResultClass and ResultRole.
std::vector<const ClassDeclaration*> associatedClasses(
    const Repository& classes, const CimXml::Operation& operation);

// Returns the association classes themselves that are the result class or below it.
std::vector<const ClassDeclaration*> referringClasses(
    const Repository& classes, const CimXml::Operation& operation);

} // namespace Host
