// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The names of sensors: the ID string of a sensor data record (IPMI 2.0, section 43.15), and the
// entity that a sensor belongs to (section 43.14).

#pragma once

#include <cstdint>
#include <span>
#include <string>

namespace Ipmi {

// Decodes an ID string, which begins with its type/length byte: 8-bit characters, which are UTF-8
// where they are valid as such and Latin-1 elsewhere, packed 6-bit ASCII or BCD plus. Returns UTF-8
// without unprintable characters and without blanks at either end; an empty text for an empty name.
// A string that is shorter than its length byte says ends with its bytes.
std::string decodeName(std::span<const std::uint8_t> idString);

// Returns the name and number of an entity, such as "Processor 1".
std::string entityName(std::uint8_t entity, std::uint8_t instance);

} // namespace Ipmi
