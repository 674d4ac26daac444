// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Object paths as elements.

#pragma once

#include "host/broker/ObjectPath.h"

#include <string>
#include <string_view>

namespace Host::CimXml {

// What stands for a path's host or namespace where it has none of its own.
struct Location {
    std::string host;
    std::string nameSpace;
};

// INSTANCENAME. Texts and date-times are strings, numbers numeric; a null key is left out.
void writeInstanceName(std::string& out, const ObjectPath& path);
// INSTANCEPATH
void writeInstancePath(std::string& out, const ObjectPath& path, const Location& location);
// OBJECTPATH around an INSTANCEPATH.
void writeObjectPath(std::string& out, const ObjectPath& path, const Location& location);
// CLASSPATH
void writeClassPath(std::string& out, std::string_view className, const Location& location);
// VALUE.REFERENCE, around an element that says no more than the path knows.
void writeReference(std::string& out, const ObjectPath& path);

} // namespace Host::CimXml
