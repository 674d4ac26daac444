// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Makes objects through the broker, which owns them. Any call of the broker may return an unusable
// object: each is tested before each use.

#pragma once

#include "platform/utilities/ObjectAccess.h"

#include <cstdint>
#include <string>

namespace Vorn::Companion {

// Returns whether the path is of the class; case does not matter (DSP0004).
bool isOfClass(const CMPIObjectPath* path, const char* className);

// Returns a path without keys in the namespace; null when that is null or the broker fails.
CMPIObjectPath* newPathIn(const CMPIBroker* broker, const char* nameSpace, const char* className,
    const std::string& host);

// Return whether the broker set the value.
bool addKey(const CMPIObjectPath* path, const char* name, const char* text);
bool addKey(const CMPIObjectPath* path, const char* name, const CMPIObjectPath* reference);
bool setText(const CMPIInstance* instance, const char* name, const char* text);
bool setReference(const CMPIInstance* instance, const char* name, const CMPIObjectPath* reference);

// Leave the property out when the broker fails. The arrays have one element.
void setCode(const CMPIInstance* instance, const char* name, std::uint16_t code);
void setCodes(
    const CMPIBroker* broker, const CMPIInstance* instance, const char* name, std::uint16_t code);
void setTexts(
    const CMPIBroker* broker, const CMPIInstance* instance, const char* name, const char* text);

} // namespace Vorn::Companion
