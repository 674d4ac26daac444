// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Compiles short MOF texts together with the declarations of common qualifiers.

#pragma once

#include "host/repository/Compiler.h"
#include "tests/support/ErrorOf.h"

#include <gtest/gtest.h>

#include <memory>
#include <stdexcept>
#include <string>
#include <string_view>

namespace Testing {

inline constexpr const char* testNameSpace = "root/test";

inline constexpr std::string_view commonQualifiers = R"(
Qualifier Abstract : boolean = false, Scope(class, association, indication), Flavor(Restricted);
Qualifier Association : boolean = false, Scope(association), Flavor(DisableOverride);
Qualifier Key : boolean = false, Scope(property, reference), Flavor(DisableOverride, ToSubclass);
Qualifier Override : string = null, Scope(property, reference, method), Flavor(Restricted);
Qualifier Description : string = null, Scope(any), Flavor(EnableOverride, ToSubclass, Translatable);
Qualifier MaxLen : uint32 = null, Scope(property, method, parameter), Flavor(ToSubclass);
Qualifier Values : string[], Scope(property, method, parameter), Flavor(ToSubclass);
Qualifier Version : string = null, Scope(class, association, indication), Flavor(Restricted);
)";

inline std::unique_ptr<const Host::Repository> compileBare(std::string_view text)
{
    Host::Compiler compiler;
    compiler.compileText(text, "test.mof", testNameSpace);
    return std::move(compiler).finish();
}

inline std::unique_ptr<const Host::Repository> compile(std::string_view text)
{
    Host::Compiler compiler;
    compiler.compileText(commonQualifiers, "qualifiers.mof", testNameSpace);
    compiler.compileText(text, "test.mof", testNameSpace);
    return std::move(compiler).finish();
}

// Returns the error in the text with its position; an empty text when there is none.
inline std::string errorOf(std::string_view text)
{
    return errorOf([&] { compile(text); });
}

inline const Host::ClassDeclaration& classNamed(
    const Host::Repository& repository, std::string_view name)
{
    const Host::ClassDeclaration* const found = repository.findClass(testNameSpace, name);
    if (found == nullptr)
        throw std::runtime_error("no class " + std::string(name));
    return *found;
}

inline const Host::PropertyDeclaration& propertyNamed(
    const Host::Repository& repository, std::string_view className, std::string_view name)
{
    const Host::PropertyDeclaration* const found = classNamed(repository, className).property(name);
    if (found == nullptr)
        throw std::runtime_error("no property " + std::string(name));
    return *found;
}

// Returns the default of the property `P` of the class `A`.
inline Host::Constant defaultOf(const std::string& typeAndName, const std::string& value)
{
    const auto repository = compile("class A { " + typeAndName + " = " + value + "; };");
    return propertyNamed(*repository, "A", "P").defaultValue;
}

template <typename Value>
Host::Constant constant(Value value)
{
    return Host::Scalar(std::move(value));
}

} // namespace Testing
