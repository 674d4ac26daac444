// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "host/cimxml/ObjectSelection.h"
#include "host/repository/ClassDeclaration.h"

#include <string>

namespace Host::CimXml {

// Appends CLASS with the selected properties in the order of the declaration. An inherited one is
// marked PROPAGATED.
void writeClass(
    std::string& out, const ClassDeclaration& declared, const ObjectSelection& selection);

} // namespace Host::CimXml
