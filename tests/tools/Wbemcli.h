// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// What wbemcli prints and what `sensorctl --json` prints, in one form that can be compared.

#pragma once

#include "tests/tools/ChildProcess.h"

#include <nlohmann/json.hpp>

#include <map>
#include <set>
#include <string>
#include <vector>

namespace Testing {

// The properties of an instance as texts, by name; a path as a text. Without quotes and
// backslashes, and without where an object is, as each program writes these in its own way.
using PlainProperties = std::map<std::string, std::string>;
using PlainPaths = std::multiset<std::string>;
using PlainInstances = std::multimap<std::string, PlainProperties>; // by path

std::string plain(const std::string& text);

// An object as `sensorctl --json` prints it.
PlainInstances::value_type plainInstance(const nlohmann::json& instance);

// What `wbemcli -nl` printed of instances or classes.
PlainInstances plainInstances(const std::string& output);
// What wbemcli printed of names, one a line.
PlainPaths plainPaths(const std::string& output);

PlainPaths pathsOf(const PlainInstances& instances);

Ended wbemcli(const std::vector<std::string>& arguments);

} // namespace Testing
