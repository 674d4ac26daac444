// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Short texts that identify objects, as the provider spells them: not yet printable.

#pragma once

#include <string>

namespace Host {
class Instance;
class ObjectPath;
} // namespace Host

namespace Tools {

// Returns the key that identifies an object within its class: its DeviceID, InstanceID or Name,
// else its whole path.
std::string shortName(const Host::ObjectPath& path);

// Returns the ElementName, else the name of the class.
std::string nameOf(const Host::Instance& instance);

// Returns a text that is equal for two paths of the same object, in whatever order and letter case
// they are written; host and namespace do not count.
std::string identityOf(const Host::ObjectPath& path);

} // namespace Tools
