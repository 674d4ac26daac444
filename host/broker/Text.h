// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Readable texts of objects and values.

#pragma once

#include <string>

namespace Host {

class Array;
class Instance;
class ObjectPath;
class Value;

// As ObjectPath::toText describes it.
std::string toText(const ObjectPath& path);
// Texts quoted, references quoted, a null as NULL, an array as {1, 2}.
std::string toText(const Value& value);
std::string toText(const Array& array);
// As MOF writes it: instance of Class { Name = value; };
std::string toText(const Instance& instance);

} // namespace Host
