// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Calls of the broker that test the objects they use. Objects belong to the broker. A `CMPIStatus*`
// is passed on to the broker and may be null.

#pragma once

#include "platform/utilities/ObjectAccess.h"

#include <string>

namespace Vorn::SensorProfileProvider {

// Returns null when the path is not usable.
CMPIString* classNameOf(const CMPIObjectPath* path, CMPIStatus* rc);

// Returns whether the class name of the path is this one; case matters.
bool isExactlyOfClass(const CMPIObjectPath* path, const char* className);

// Makes a path without keys, with the namespace of `ref`, the class and the host. The namespace is
// read and set a second time once the path is made, and `again` receives the status of that read.
// Returns null when the broker fails.
CMPIObjectPath* newPath(const CMPIBroker* broker, const CMPIObjectPath* ref, const char* className,
    const std::string& host, CMPIStatus* rc, CMPIStatus* again = nullptr);

// Sets the namespace of the path to that of `ref`, if there is one.
void copyNameSpace(const CMPIObjectPath* path, const CMPIObjectPath* ref, CMPIStatus* rc);

// Adds a key of type string.
void addTextKey(const CMPIObjectPath* path, const char* name, const char* text);

// Writes a message to the broker's trace facility (CMTraceMessage).
void traceToBroker(
    const CMPIBroker* broker, CMPILevel level, const char* component, const char* text);

// Reports a failure: sets the status, if there is one, to CMPI_RC_ERR_FAILED with one text, and
// writes the other, which often differs, to the broker's trace at warning level.
void reportFailure(const CMPIBroker* broker, CMPIStatus* rc, const char* component,
    const char* statusText, const char* traceText);

} // namespace Vorn::SensorProfileProvider
