// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Short texts for objects, as they came from the provider: not yet fit for a terminal.

#pragma once

#include <string>

namespace Host {
class Instance;
class ObjectPath;
} // namespace Host

namespace Tools {

// What tells an object from others of its class: its DeviceID, InstanceID or Name, else its
// whole path.
std::string shortName(const Host::ObjectPath& path);

// The ElementName, else the class.
std::string nameOf(const Host::Instance& instance);

// Equal for two paths that name the same object, however each is written and whichever host
// and namespace it names.
std::string identityOf(const Host::ObjectPath& path);

} // namespace Tools
