// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// What a text must be before it is taken apart as XML.

#pragma once

#include <cstddef>
#include <string_view>

namespace Host::CimXml {

inline constexpr std::size_t usualDepth = 64; // where nobody says otherwise
inline constexpr std::size_t maximumElements = 100'000;
inline constexpr std::size_t maximumAttributes = 16; // of one element

// Well-formed XML in UTF-8 within those bounds, without document type declaration; so the only
// entities are the five predefined ones, and nothing can expand. Takes time in proportion to the
// text. Throws RequestError: requestNotWellFormed, or requestNotValid for a document type and
// beyond the bounds.
void requireWellFormed(std::string_view text, std::size_t maximumDepth = usualDepth);

} // namespace Host::CimXml
