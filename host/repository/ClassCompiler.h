// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// From a class as it is written to the class as a repository answers it.

#pragma once

#include "host/repository/Namespace.h"
#include "host/repository/SyntaxTree.h"

#include <cstddef>
#include <memory>
#include <string>
#include <vector>

namespace Host {

// Keeps what classes inherit within bounds: a file of a few megabytes could ask for billions of
// inherited properties.
class InheritanceBudget {
public:
    // Throws MofError with that position when nothing is left.
    void spend(std::size_t elements, const SourcePosition& position);

private:
    std::size_t left_ = 2'000'000;
};

// A class that a reference names. It may be declared later than the reference.
struct ReferencedClass {
    const Namespace* nameSpace;
    std::string name;
    std::string ancestor; // the class of the reference it overrides; empty if it does not
    SourcePosition position;
};

// The class, ready to be added to the namespace. Appends the classes its references name, which
// the caller has yet to check. Throws MofError for whatever contradicts the namespace or itself.
std::unique_ptr<ClassDeclaration> compileClass(const Syntax::Class& written,
    const Namespace& nameSpace, InheritanceBudget& budget,
    std::vector<ReferencedClass>& referenced);

} // namespace Host
