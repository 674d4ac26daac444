// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Values and instances as elements.

#pragma once

#include "host/broker/Instance.h"
#include "host/cimxml/PropertySelection.h"
#include "host/repository/Repository.h"

#include <string>
#include <string_view>

namespace Host::CimXml {

// VALUE, VALUE.ARRAY or VALUE.REFERENCE; nothing for a null. A null in an array is left out and
// what follows moves up, since not all clients know an element for it. An embedded instance is
// the text of its INSTANCE.
void writeValue(std::string& out, const Value& value);

// PROPERTY, PROPERTY.ARRAY or PROPERTY.REFERENCE for each selected property the instance has, in
// its order. What the value does not say, such as the type of a null, and the class's own
// attributes come from the class where it is known; its declarations may be null. With the class
// origin comes PROPAGATED.
void writeInstance(std::string& out, const Instance& instance, const ClassDeclaration* declared,
    const PropertySelection& selection);

} // namespace Host::CimXml
