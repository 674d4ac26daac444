// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Functions that several providers need. Thread-safe.

#pragma once

#include <cmpidt.h>

#include <string>
#include <string_view>

namespace Vorn {

// Returns the kernel's host name, without a look-up in the network; empty only when uname() fails.
std::string getSystemName();

// Returns the text without spaces and tabs at either end.
std::string stripSpaces(const std::string& text);

// Convert wide characters to UTF-8 and back. Each wide character that is no code point and each
// byte that belongs to no character becomes U+FFFD. Throws only for lack of memory.
std::string make_string(const std::wstring& text);
std::wstring make_wstring(const std::string& text);

// Returns whether two CIM names (of a class, a property, a namespace) are the same. Names are
// case-insensitive (DSP0004); the comparison is that of ASCII, whatever the process's locale.
bool isSameName(std::string_view a, std::string_view b);

// Returns whether two object paths name the same instance.
//
// Class names and key names are compared without regard to case; the number of keys is the same,
// their order does not matter. Host names are ignored, namespaces (compared without regard to
// case and to outer slashes) too where either side has none.
//
// Values are compared by type: integers of any width and signedness by their value, reals by their
// value, texts and points in time character by character. A key that has no value (its state says
// null or not found, or it is an empty pointer) counts as absent; one of a type that no key can
// have equals nothing.
//
// Keys of type reference count, on either side, only when comparesReferences is true, and are
// then compared as paths by the same rule; paths nested deeper than eight are unequal.
//
// A null or handle-less path equals nothing, not even itself, and so does a path without a class
// name or one whose keys the broker fails to list.
bool isObjPathsEqual(const CMPIObjectPath* a, const CMPIObjectPath* b, bool comparesReferences);

} // namespace Vorn
