// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The values of literals. Each function takes text that the grammar has matched, and throws
// MofError for what it cannot rule out, such as numbers that are too large.

#pragma once

#include "host/repository/SyntaxTree.h"

#include <string_view>
#include <vector>

namespace Host {

// The text between quotation marks, without them; columns count from its first byte.
struct QuotedText {
    std::string_view text;
    SourcePosition position;
};

// One text of adjacent ones, as UTF-8.
std::string readText(const std::vector<QuotedText>& pieces);

// The one UTF-16 unit that stands between single quotes.
Syntax::Character readCharacter(const QuotedText& quote);

// Digits with or without sign; prefix and suffix of the base are not among them.
Syntax::Integer readInteger(
    std::string_view signAndDigits, unsigned base, const SourcePosition& position);

double readReal(std::string_view text, const SourcePosition& position);

// Of an array of fixed size.
std::uint32_t readArraySize(std::string_view digits, const SourcePosition& position);

} // namespace Host
