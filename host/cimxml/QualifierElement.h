// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Qualifiers and their declarations as elements (DSP0201), and the common parts of the properties
// of classes and of instances.

#pragma once

#include "host/cimxml/Markup.h"
#include "host/cimxml/ObjectSelection.h"
#include "host/repository/Qualifier.h"

#include <string>
#include <string_view>

namespace Host::CimXml {

// Returns PROPERTY, PROPERTY.ARRAY or PROPERTY.REFERENCE.
std::string_view elementNameFor(CMPIType propertyType);

// Appends the attribute EmbeddedObject where the qualifiers say that a string holds an object.
void writeEmbeddedObject(Markup& element, const QualifierList& qualifiers);

// Appends VALUE or VALUE.ARRAY; nothing for a null. Nulls in an array are left out.
void writeConstant(std::string& out, const Constant& value);

// Appends a QUALIFIER for each that is selected, without flavors that have their default.
void writeQualifiers(
    std::string& out, const QualifierList& qualifiers, const ObjectSelection& selection);

// Appends QUALIFIER.DECLARATION.
void writeQualifierDeclaration(std::string& out, const QualifierDeclaration& declared);

} // namespace Host::CimXml
