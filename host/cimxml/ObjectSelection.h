// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// What of an object a client wants to see.

#pragma once

#include <optional>
#include <string>
#include <string_view>
#include <vector>

namespace Host {
struct ClassDeclaration;
struct PropertyDeclaration;
struct Qualifier;
} // namespace Host

namespace Host::CimXml {

struct ObjectSelection {
    std::optional<std::vector<std::string>> properties; // all, unless there is a list
    bool localOnly = false;
    bool includeQualifiers = false;
    bool includeClassOrigin = false;
};

// Whether the list, if there is one, has the name, in any letter case.
bool isListed(const ObjectSelection& selection, std::string_view propertyName);

// Whether a property of the class, or of an instance of it, is to be shown. Local are properties
// that the class itself declares, anew or for the first time. A property that the class does not
// have is local. The class is null where it is not known; all properties are local then.
bool isSelected(const ObjectSelection& selection, const ClassDeclaration* declared,
    std::string_view propertyName);

// Of a class or a property. Local are those that it carries itself.
bool isSelected(const ObjectSelection& selection, const Qualifier& qualifier);

} // namespace Host::CimXml
