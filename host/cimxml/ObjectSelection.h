// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The parts of an object that a response contains: PropertyList, LocalOnly, IncludeQualifiers and
// IncludeClassOrigin of DSP0200.

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
    std::optional<std::vector<std::string>> properties; // all of them without a list
    bool writesNulls = false; // for selected properties of the class that the instance lacks
    bool localOnly = false;
    bool includeQualifiers = false;
    bool includeClassOrigin = false;
};

// Returns whether the property list, if there is one, has the name, in any letter case.
bool isListed(const ObjectSelection& selection, std::string_view propertyName);

// Returns whether a property of the class, or of an instance of it, is selected. A property is
// local when the class itself declares or overrides it, or does not have it. The class is null
// where it is not known; all properties are local then.
bool isSelected(const ObjectSelection& selection, const ClassDeclaration* declared,
    std::string_view propertyName);

// Returns whether a qualifier of a class or a property is selected. It is local when it is not
// propagated.
bool isSelected(const ObjectSelection& selection, const Qualifier& qualifier);

} // namespace Host::CimXml
