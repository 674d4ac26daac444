// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Words and values in the text of a MOF file, with their positions.

#pragma once

#include "host/repository/Constant.h"

#include <cmpidt.h>
#include <tao/pegtl/position.hpp>

#include <string>
#include <vector>

namespace Host {

using SourcePosition = tao::pegtl::position;

struct Word {
    std::string text;
    SourcePosition position{0, 0, 0, ""};
};

struct Literal {
    enum class Kind { null, truth, number, text };
    Kind kind;
    std::string text; // for a string, the text between the quotation marks
    SourcePosition position;
};

struct Initializer {
    bool isList = false;
    std::vector<Literal> elements; // empty when no value is written

    bool isEmpty() const noexcept { return elements.empty(); }
};

// Returns the value in the form of the type, null for one that is not written. Throws
// tao::pegtl::parse_error at a literal that does not fit the type, at the first one of a list for a
// single value, and at a single value for an array.
Constant toConstant(const Initializer& written, CMPIType type);

} // namespace Host
