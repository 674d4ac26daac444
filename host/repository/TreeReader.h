// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// From the nodes that the grammar's rules leave to declarations.

#pragma once

#include "host/repository/SyntaxTree.h"

#include <tao/pegtl.hpp>
#include <tao/pegtl/contrib/parse_tree.hpp>

#include <memory>
#include <string>

namespace Host {

// REQUIRES: the node is a Pragma, QualifierDeclaration or Class of the grammar, with the nodes
// below it that Parser.cpp keeps. Throws MofError for literals that stand for no value.
Syntax::Production readProduction(
    const tao::pegtl::parse_tree::node& node, const std::shared_ptr<const std::string>& file);

} // namespace Host
