// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Object paths as users type and paste them.

#pragma once

#include <string_view>

namespace Host {
class Arena;
class ClassInformation;
class ObjectPath;
} // namespace Host

namespace Tools {

// Reads what Host::ObjectPath::toText writes: //host/namespace:Class.Key="value",Other=1, where
// host and namespace may be left out and references are paths in quotes. The namespace is
// root/cimv2 when none is given.
//
// Returns null when the text does not name a known class where a path has its class: it is not
// meant as a path. Throws UsageError with the column when it names one and is malformed.
const Host::ObjectPath* readPath(
    Host::Arena& arena, const Host::ClassInformation& classes, std::string_view text);

} // namespace Tools
