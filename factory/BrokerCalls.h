// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Calls to the broker that every operation makes, with their results tested: whatever a broker
// fails to deliver is null here and never used. What is made belongs to the broker.

#pragma once

#include <cmpidt.h>
#include <cmpift.h>

namespace Vorn::SensorProfileProvider {

// Neither null nor without a handle.
template <typename Object>
bool isUsable(const Object* object)
{
    return object != nullptr && object->hdl != nullptr;
}

// Null when there is no string or it has no characters. They live as long as the string.
const char* charactersOf(const CMPIString* string, CMPIStatus* rc);

// Null when the path does not say.
const char* nameSpaceOf(const CMPIObjectPath* path, CMPIStatus* rc);
// Null when there is no path.
CMPIString* classNameOf(const CMPIObjectPath* path, CMPIStatus* rc);

// Whether the path is of exactly that class, letter for letter.
bool isOfClass(const CMPIObjectPath* path, const char* className, CMPIStatus* rc);

// A path without keys: the namespace of `ref`, the class, and this system as host. Null when
// it cannot be made. `rc` goes to the broker and may be null.
CMPIObjectPath* newPath(
    const CMPIBroker* broker, const CMPIObjectPath* ref, const char* className, CMPIStatus* rc);

// Gives a path the namespace of `ref`, when that has one.
void copyNameSpace(const CMPIObjectPath* path, const CMPIObjectPath* ref, CMPIStatus* rc);

// Adds a key of type string.
void addTextKey(const CMPIObjectPath* path, const char* name, const char* text);

// Sends a message to the broker's trace facility.
void traceToBroker(
    const CMPIBroker* broker, CMPILevel level, const char* component, const char* text);

// Reports a failure with its two texts, which differ more often than not: one for the client
// in the status (when there is one), one for the broker's trace at warning level.
void reportFailure(const CMPIBroker* broker, CMPIStatus* rc, const char* component,
    const char* statusText, const char* traceText);

} // namespace Vorn::SensorProfileProvider
