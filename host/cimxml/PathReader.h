// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Reading of object paths (DSP0201).

#pragma once

#include "host/broker/ObjectPath.h"
#include "host/broker/Value.h"
#include "host/cimxml/Element.h"
#include "host/repository/Repository.h"

#include <string>
#include <string_view>

namespace Host::CimXml {

// Returns the names in a LOCALNAMESPACEPATH with slashes between them. Throws RequestError when
// there are none.
std::string nameSpaceOf(const Element& localNameSpacePath);

// Reads paths with the names of namespaces, classes and keys spelled as they are declared, and with
// keys of the declared types. Where the class is not known the client's spelling stays, and
// VALUETYPE or TYPE gives the type of a key; without either it is a string.
//
// Paths live in the arena of this thread's request. All functions throw RequestError for
// elements that lack something, and Refusal: CMPI_RC_ERR_INVALID_PARAMETER with the key's name
// for a key that the class does not have, that comes twice or whose value does not fit;
// CMPI_RC_ERR_INVALID_CLASS for a key without name where the class is not known.
class PathReader {
public:
    explicit PathReader(const Repository& classes) : classes_(classes) {}

    // Reads an INSTANCENAME in the namespace.
    ObjectPath& instanceName(const Element& element, std::string_view nameSpace) const;
    // Returns the class that a CLASSNAME or an INSTANCENAME names, spelled as it is declared.
    std::string className(const Element& element, std::string_view nameSpace) const;

private:
    const ClassDeclaration* declaredClass(const ObjectPath& path) const;
    std::string_view declaredNameSpace(std::string_view nameSpace) const;
    ObjectPath& emptyPath(
        const Element& named, const char* attribute, std::string_view nameSpace) const;
    ObjectPath& instance(const Element& element, std::string_view nameSpace, unsigned depth) const;
    ObjectPath& target(const Element& element, std::string_view nameSpace, unsigned depth) const;
    void addKey(
        ObjectPath& path, const std::string& name, const Element& element, unsigned depth) const;
    Value keyValue(
        const Element& element, const std::string& what, const PropertyDeclaration* declared) const;

    const Repository& classes_;
};

} // namespace Host::CimXml
