// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Qualifiers and their declarations as elements, with what properties of classes and of
// instances have in common.

#pragma once

#include "host/cimxml/Markup.h"
#include "host/cimxml/ObjectSelection.h"
#include "host/repository/Qualifier.h"

#include <string>
#include <string_view>

namespace Host::CimXml {

// PROPERTY, PROPERTY.ARRAY or PROPERTY.REFERENCE
std::string_view elementNameFor(CMPIType propertyType);

// The attribute EmbeddedObject, where the qualifiers say that a string holds an object.
void writeEmbeddedObject(Markup& element, const QualifierList& qualifiers);

// VALUE or VALUE.ARRAY; nothing for a null. Nulls in a list are left out.
void writeConstant(std::string& out, const Constant& value);

// A QUALIFIER for each that is selected. Flavors that are as usual are not written.
void writeQualifiers(
    std::string& out, const QualifierList& qualifiers, const ObjectSelection& selection);

// QUALIFIER.DECLARATION
void writeQualifierDeclaration(std::string& out, const QualifierDeclaration& declared);

} // namespace Host::CimXml
