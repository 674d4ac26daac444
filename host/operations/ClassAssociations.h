// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Associations between classes, as the repository declares them.

#pragma once

#include "host/cimxml/Operation.h"

#include <vector>

namespace Host {

class Repository;
struct ClassDeclaration;

// An association class refers to the operation's class when one of its references is of that
// class or of one above it, and has the role where one is given. Both functions answer in the
// order of declaration, each class once, and throw Refusal (CMPI_RC_ERR_INVALID_CLASS) for a
// class of the operation that is not known.

// The classes of the other references, filtered as the operation of an instance would be.
std::vector<const ClassDeclaration*> associatedClasses(
    const Repository& classes, const CimXml::Operation& operation);

// The association classes themselves, of the result class or below it.
std::vector<const ClassDeclaration*> referringClasses(
    const Repository& classes, const CimXml::Operation& operation);

} // namespace Host
