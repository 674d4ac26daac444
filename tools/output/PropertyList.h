// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// All properties of one object.

#pragma once

#include "tools/output/TextStyle.h"

#include <string>

namespace Host {
class Instance;
struct ClassDeclaration;
} // namespace Host

namespace Tools {

// Returns the object's name, then a line for each property in the order of the instance, with the
// meanings of codes and scaled numbers. The elements of an array are wrapped at the width. The
// class is that of the instance, or null where it is unknown.
std::string propertyList(
    const Host::Instance& instance, const Host::ClassDeclaration* declared, const TextStyle& style);

} // namespace Tools
