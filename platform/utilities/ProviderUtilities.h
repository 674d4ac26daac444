// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Small services every provider needs. All may be called from any thread.

#pragma once

#include <cmpidt.h>

#include <string>
#include <string_view>

namespace Vorn {

// The kernel's host name; no look-up in the network. Empty only when the kernel refuses.
std::string getSystemName();

// Without leading and trailing blanks, which are spaces and tabs.
std::string stripSpaces(const std::string& text);

// UTF-8 from wide characters and back. Each wide character that is no code point and each byte
// that belongs to no character becomes U+FFFD. Throws only for lack of memory.
std::string make_string(const std::wstring& text);
std::wstring make_wstring(const std::string& text);

// Whether two CIM names (of a class, a property, a namespace) are the same: without regard to
// ASCII case, whatever the process's locale.
bool isSameName(std::string_view a, std::string_view b);

// Whether two object paths name the same instance.
//
// Class names and key names are compared without regard to case; the number of keys is the same,
// their order does not matter. Host names are ignored, namespaces (compared without regard to
// case and to outer slashes) too where either side has none.
//
// Values are compared by type: integers of any width and signedness by their value, reals by
// their value, texts and points in time character by character. A key that has no value (its
// state says null or not found, or it is an empty pointer) counts as not there; one of a type
// that no key can have equals nothing.
//
// Keys of type reference count, on either side, only when comparesReferences is true, and are
// then compared as paths by the same rule; paths nested deeper than eight are unequal.
//
// A null or handle-less path equals nothing, not even itself, and so does a path without a class
// name or one whose keys the broker fails to list.
bool isObjPathsEqual(const CMPIObjectPath* a, const CMPIObjectPath* b, bool comparesReferences);

} // namespace Vorn
