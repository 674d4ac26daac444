// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Object paths as elements (DSP0201).

#pragma once

#include "host/broker/ObjectPath.h"

#include <string>
#include <string_view>

namespace Host::CimXml {

// The host and namespace of a path that has none of its own.
struct Location {
    std::string host;
    std::string nameSpace;
};

// Appends INSTANCENAME. VALUETYPE is `string` for texts and date-times; a null key is left out.
void writeInstanceName(std::string& out, const ObjectPath& path);
// Appends INSTANCEPATH.
void writeInstancePath(std::string& out, const ObjectPath& path, const Location& location);
// Appends OBJECTPATH around an INSTANCEPATH.
void writeObjectPath(std::string& out, const ObjectPath& path, const Location& location);
// Appends CLASSPATH.
void writeClassPath(std::string& out, std::string_view className, const Location& location);
// Appends VALUE.REFERENCE around INSTANCENAME, LOCALINSTANCEPATH or INSTANCEPATH, as the path has
// a namespace and a host.
void writeReference(std::string& out, const ObjectPath& path);

} // namespace Host::CimXml
