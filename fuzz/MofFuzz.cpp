// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Whatever bytes a MOF file holds, the compiler gives a repository or a MofError with a place;
// and what it compiled, the repository can answer for.

#include "host/repository/Compiler.h"
#include "host/repository/MofError.h"

#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <stdexcept>

namespace {

constexpr const char* NameSpace = "root/test";

// Includes reach no files: one name gives a text, and no other is there.
std::unique_ptr<const Host::Repository> tryCompile(std::string_view text)
{
    Host::Compiler compiler([&](const std::filesystem::path& file) {
        if (file.filename() != "other.mof")
            throw std::runtime_error("is not there");
        return std::string("class Other {};");
    });
    try {
        compiler.compileText(text, "self.mof", NameSpace);
        return std::move(compiler).finish();
    } catch (const Host::MofError& error) {
        if (error.position().line == 0 || error.position().column == 0)
            std::abort();
        return nullptr;
    }
}

void requireSound(const Host::Repository& repository, const Host::Namespace& nameSpace)
{
    for (const auto& declared : nameSpace.classes()) {
        if (repository.findClass(nameSpace.name(), declared->name) != declared.get())
            std::abort();
        for (const std::string& key : *repository.keysOf(nameSpace.name(), declared->name))
            if (declared->property(key) == nullptr)
                std::abort();
        for (const auto& reference : repository.referencesOf(nameSpace.name(), declared->name))
            if (nameSpace.findClass(reference.className) == nullptr)
                std::abort();
        for (const auto* const above : repository.ancestors(nameSpace.name(), declared->name))
            if (declared->properties.size() < above->properties.size())
                std::abort();
    }
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size);

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    if (const auto repository = tryCompile({reinterpret_cast<const char*>(data), size}))
        for (const auto& nameSpace : repository->namespaces())
            requireSound(*repository, *nameSpace);
    return 0;
}
