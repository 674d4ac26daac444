// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/repository/Compiler.h"

#include "host/broker/Names.h"
#include "host/repository/FileCompiler.h"
#include "host/repository/Grammar.h"
#include "host/repository/NamespaceName.h"

#include <cerrno>
#include <fstream>
#include <iterator>
#include <stdexcept>
#include <system_error>
#include <utility>

namespace Host {

namespace {

namespace peg = tao::pegtl;

// The state of the actions: the declarations of a file, and what the files that it includes are
// compiled with.
struct Unit {
    Compiler& compiler;
    Namespaces& namespaces;
    const std::vector<std::filesystem::path>& includeStack; // ends with the file itself
    FileCompiler declarations;
};

// Throws at the pragma when the file is among those that include it.
void include(Unit& unit, const Literal& argument)
{
    const auto file = unit.includeStack.back().parent_path() / argument.text;
    std::error_code noSuchFile; // compileFile reports it
    for (const auto& including : unit.includeStack)
        if (std::filesystem::equivalent(including, file, noSuchFile))
            throw peg::parse_error(argument.text + " includes itself", argument.position);
    unit.compiler.compileFile(file, unit.declarations.nameSpace().name());
}

Namespace& openNamespace(Namespaces& namespaces, std::string_view written)
{
    const std::string name = plainNamespaceName(written);
    for (const auto& known : namespaces)
        if (equalNames(known->name(), name))
            return *known;
    return *namespaces.emplace_back(std::make_unique<Namespace>(name));
}

// Throws an error that names what the rule expected, at the position where it does not match.
template <typename Rule>
struct Control : peg::normal<Rule> {
    template <typename Input>
    [[noreturn]] static void raise(const Input& in, const Unit& /*unit*/)
    {
        throw peg::parse_error("expected " + std::string(Rule::expected), in);
    }
};

template <Word DeclarationParts::*part>
struct KeepWord {
    template <typename Input>
    static void apply(const Input& in, Unit& unit)
    {
        unit.declarations.parts.*part = {in.string(), in.position()};
    }
};

template <std::vector<Word> DeclarationParts::*part>
struct AppendWord {
    template <typename Input>
    static void apply(const Input& in, Unit& unit)
    {
        (unit.declarations.parts.*part).push_back({in.string(), in.position()});
    }
};

template <Literal::Kind kind>
struct AppendLiteral {
    template <typename Input>
    static void apply(const Input& in, Unit& unit)
    {
        unit.declarations.parts.value.elements.push_back({kind, in.string(), in.position()});
    }
};

template <bool DeclarationParts::*part>
struct SetFlag {
    static void apply0(Unit& unit) { unit.declarations.parts.*part = true; }
};

template <void (FileCompiler::*function)()>
struct Call {
    static void apply0(Unit& unit) { (unit.declarations.*function)(); }
};

template <typename Rule>
struct Action : peg::nothing<Rule> {
};

// clang-format off
template <> struct Action<Grammar::PragmaName> : KeepWord<&DeclarationParts::pragmaName> {};
template <> struct Action<Grammar::ClassName> : KeepWord<&DeclarationParts::className> {};
template <> struct Action<Grammar::Superclass> : KeepWord<&DeclarationParts::superclass> {};
template <> struct Action<Grammar::PropertyName> : KeepWord<&DeclarationParts::propertyName> {};
template <> struct Action<Grammar::TypeName> : KeepWord<&DeclarationParts::typeName> {};
template <> struct Action<Grammar::QualifierName> : KeepWord<&DeclarationParts::qualifierName> {};
template <> struct Action<Grammar::ScopeName> : AppendWord<&DeclarationParts::scopes> {};
template <> struct Action<Grammar::FlavorName> : AppendWord<&DeclarationParts::flavors> {};
template <> struct Action<Grammar::Number> : AppendLiteral<Literal::Kind::number> {};
template <> struct Action<Grammar::True> : AppendLiteral<Literal::Kind::truth> {};
template <> struct Action<Grammar::False> : AppendLiteral<Literal::Kind::truth> {};
template <> struct Action<Grammar::Null> : AppendLiteral<Literal::Kind::null> {};
template <> struct Action<Grammar::Reference> : SetFlag<&DeclarationParts::isReference> {};
template <> struct Action<Grammar::ArrayMark> : SetFlag<&DeclarationParts::isArray> {};
template <> struct Action<Grammar::QualifierDeclaration> : Call<&FileCompiler::endQualifierDeclaration> {};
template <> struct Action<Grammar::Qualifier> : Call<&FileCompiler::endQualifier> {};
template <> struct Action<Grammar::ClassHead> : Call<&FileCompiler::beginClass> {};
template <> struct Action<Grammar::Property> : Call<&FileCompiler::endProperty> {};
template <> struct Action<Grammar::Class> : Call<&FileCompiler::endClass> {};
// clang-format on

template <>
struct Action<Grammar::Piece> {
    template <typename Input>
    static void apply(const Input& in, Unit& unit)
    {
        unit.declarations.parts.text += in.string_view();
    }
};

template <>
struct Action<Grammar::Text> {
    template <typename Input>
    static void apply(const Input& in, Unit& unit)
    {
        DeclarationParts& parts = unit.declarations.parts;
        parts.value.elements.push_back(
            {Literal::Kind::text, std::exchange(parts.text, {}), in.position()});
    }
};

template <>
struct Action<Grammar::List> {
    static void apply0(Unit& unit) { unit.declarations.parts.value.isList = true; }
};

template <>
struct Action<Grammar::Pragma> {
    static void apply0(Unit& unit)
    {
        DeclarationParts& parts = unit.declarations.parts;
        const Literal argument = std::exchange(parts.value, {}).elements.front();
        if (equalNames(parts.pragmaName.text, "namespace"))
            unit.declarations.setNamespace(openNamespace(unit.namespaces, argument.text));
        else
            include(unit, argument);
    }
};

} // namespace

void Compiler::compileFile(const std::filesystem::path& file, std::string_view nameSpace)
{
    std::ifstream stream(file, std::ios::binary);
    stream.peek(); // fails for a folder, which can be opened
    if (stream.fail())
        throw std::runtime_error(file.string() + ": " + std::generic_category().message(errno));
    const std::string text((std::istreambuf_iterator<char>(stream)), {});
    compileText(text, file, nameSpace);
}

void Compiler::compileText(
    std::string_view text, const std::filesystem::path& file, std::string_view nameSpace)
{
    peg::memory_input<> input(text.data(), text.size(), file.string());
    includeStack_.push_back(file);
    Unit unit{*this, namespaces_, includeStack_,
        {openNamespace(namespaces_, nameSpace), referencedClasses_}};
    peg::parse<Grammar::File, Action, Control>(input, unit);
    includeStack_.pop_back();
}

std::unique_ptr<const Repository> Compiler::finish() &&
{
    for (const ReferencedClass& each : referencedClasses_)
        if (each.nameSpace->findClass(each.name) == nullptr)
            throw std::runtime_error(each.place + ": " + each.name + " is no declared class");
    return std::make_unique<const Repository>(std::move(namespaces_));
}

} // namespace Host
