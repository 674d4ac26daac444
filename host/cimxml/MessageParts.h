// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Where things stand in a message.

#pragma once

#include "host/cimxml/Element.h"

#include <string>

namespace Host::CimXml {

// Keys or properties of an object whose class is not known. Those of others are bounded by what the
// class has; each is held against all before it.
inline constexpr std::size_t maximumUndeclared = 1000;

// The IMETHODCALL or METHODCALL. REQUIRES: the document is a Message's.
Element callOf(const Document& document);

// The LOCALNAMESPACEPATH of an IMETHODCALL; the LOCALCLASSPATH or LOCALINSTANCEPATH of a
// METHODCALL.
Element pathOf(const Element& call);

// The names in a LOCALNAMESPACEPATH, with slashes between them.
std::string nameSpaceOf(const Element& localNameSpacePath);

} // namespace Host::CimXml
