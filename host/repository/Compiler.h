// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// From MOF files to a repository.

#pragma once

#include "host/repository/ClassCompiler.h"
#include "host/repository/Repository.h"
#include "host/repository/SourceFile.h"
#include "host/repository/SyntaxTree.h"

#include <filesystem>
#include <memory>
#include <string_view>
#include <vector>

namespace Host {

// Superclasses and qualifiers are declared before they are used, in the same file or an earlier
// one; classes that references name may follow later.
//
// `#pragma include ("other.mof")` reads the other file, relative to the folder of the one it
// stands in. `#pragma namespace ("root/interop")` holds for the rest of the file and for the
// files that are included there. Every other pragma is read and has no effect.
//
// For one thread. After a function has thrown, the compiler is good for nothing but destruction.
class Compiler {
public:
    // The reader is for all files, those of compileFile included.
    explicit Compiler(SourceReader reader = readSourceFile);

    // Throws MofError for what the file or one it includes has wrong, and std::runtime_error
    // `FILE: reason` for a file that cannot be read.
    void compileFile(const std::filesystem::path& file, std::string_view nameSpace);

    // The same for a text that stands for a file of that name.
    void compileText(
        std::string_view text, const std::filesystem::path& file, std::string_view nameSpace);

    // What has been compiled. Throws MofError at the first reference whose class has not been
    // declared or does not suit the reference it overrides.
    std::unique_ptr<const Repository> finish() &&;

private:
    class Unit;

    Namespace& openNamespace(std::string_view name);

    SourceReader reader_;
    std::vector<std::unique_ptr<Namespace>> namespaces_;
    std::vector<ReferencedClass> referenced_;
    InheritanceBudget budget_;
    std::size_t includes_ = 0;
    std::vector<std::filesystem::path> open_; // the files being compiled, outermost first
};

} // namespace Host
