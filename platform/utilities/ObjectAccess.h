// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Reads objects of the broker, which may return null or an object without a handle from any call.
// A `CMPIStatus*` is passed on to the broker and may be null.

#pragma once

#include <cmpidt.h>
#include <cmpift.h>

namespace Vorn {

// Returns whether the object is not null and has a handle and functions.
template <typename Object>
bool isUsable(const Object* object)
{
    return object != nullptr && object->hdl != nullptr && object->ft != nullptr;
}

// Returns the characters, valid as long as the string, or null when there are none.
const char* charactersOf(const CMPIString* string, CMPIStatus* status = nullptr);

// Returns null when the path has no namespace.
const char* nameSpaceOf(const CMPIObjectPath* path, CMPIStatus* status = nullptr);

} // namespace Vorn
