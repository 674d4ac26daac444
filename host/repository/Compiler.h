// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Compiles MOF files into a repository.

#pragma once

#include "host/repository/Repository.h"

#include <filesystem>
#include <memory>
#include <string>
#include <string_view>
#include <vector>

namespace Host {

// A class that a reference names. It may be declared later than the reference.
struct ReferencedClass {
    const Namespace* nameSpace;
    std::string name;
    std::string place; // of the name, `FILE:LINE:COLUMN`
};

using Namespaces = std::vector<std::unique_ptr<Namespace>>;

// Compiles the part of MOF (DSP0004) that the files in schema/ use. Superclasses and qualifiers
// are declared before they are used, in the same file or an earlier one; classes that references
// name may follow later.
//
// `#pragma include ("other.mof")` compiles the other file, whose path is relative to the folder of
// the including one; a file that includes itself, also through others, is an error. `#pragma
// namespace ("root/interop")` holds for the rest of the file and for the files that are included
// there.
//
// For one thread. Every function throws std::runtime_error `FILE:LINE:COLUMN: reason` for an error
// in a text; the compiler can only be destroyed afterwards.
class Compiler {
public:
    // Also throws std::runtime_error `FILE: reason` for a file that cannot be read.
    void compileFile(const std::filesystem::path& file, std::string_view nameSpace);

    // Compiles a text as if it were in a file of that name.
    void compileText(
        std::string_view text, const std::filesystem::path& file, std::string_view nameSpace);

    // Returns the compiled repository. Throws at the first reference whose class has not been
    // declared.
    std::unique_ptr<const Repository> finish() &&;

private:
    Namespaces namespaces_;
    std::vector<ReferencedClass> referencedClasses_;
    std::vector<std::filesystem::path> includeStack_; // the files that are being compiled
};

} // namespace Host
