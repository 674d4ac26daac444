// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Classes as elements.

#pragma once

#include "host/cimxml/PropertySelection.h"
#include "host/repository/ClassDeclaration.h"

#include <string>

namespace Host::CimXml {

// CLASS, with the selected properties and methods in the order of the declaration. A property's
// or a method's inheritance is told by PROPAGATED.
void writeClass(
    std::string& out, const ClassDeclaration& declared, const PropertySelection& selection);

} // namespace Host::CimXml
