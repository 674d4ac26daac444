// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Converts the outputs of wbemcli and of `sensorctl --cim` to a common form, so that they can be
// compared.

#pragma once

#include "tests/tools/ChildProcess.h"

#include <nlohmann/json.hpp>

#include <map>
#include <set>
#include <string>
#include <vector>

namespace Testing {

// The properties of an instance by name, values and paths as texts. Quotes, backslashes, hosts and
// namespaces are left out, since the programs write them differently.
using PlainProperties = std::map<std::string, std::string>;
using PlainPaths = std::multiset<std::string>;
using PlainInstances = std::multimap<std::string, PlainProperties>; // by path

std::string plain(const std::string& text);

// Converts an object that `sensorctl --cim` printed.
PlainInstances::value_type plainInstance(const nlohmann::json& instance);

// Converts the instances or classes that `wbemcli -nl` printed.
PlainInstances plainInstances(const std::string& output);
// Converts the names that wbemcli printed, one per line.
PlainPaths plainPaths(const std::string& output);

PlainPaths pathsOf(const PlainInstances& instances);

Ended wbemcli(const std::vector<std::string>& arguments);

} // namespace Testing
