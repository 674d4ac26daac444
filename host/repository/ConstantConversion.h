// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "host/repository/Constant.h"
#include "host/repository/SyntaxTree.h"

namespace Host {

// The value in the type's form. Throws MofError at the literal that does not fit the type, or
// where a list stands for a single value or the other way round.
Constant toConstant(const Syntax::Initializer& written, CMPIType type);

} // namespace Host
