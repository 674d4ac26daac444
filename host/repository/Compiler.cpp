// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/repository/Compiler.h"

#include "host/repository/MofError.h"
#include "host/repository/NamespaceName.h"
#include "host/repository/Parser.h"
#include "host/repository/QualifierRules.h"

#include <algorithm>
#include <stdexcept>
#include <utility>

namespace Host {

namespace {

constexpr std::size_t maximumIncludeDepth = 16;
constexpr std::size_t maximumIncludes = 4096;
constexpr std::size_t maximumNamespaces = 256;

// What would break the line of a message that shows the name.
bool hasControlCharacter(std::string_view name)
{
    return std::any_of(name.begin(), name.end(),
        [](char c) { return static_cast<unsigned char>(c) < 0x20 || c == 0x7F; });
}

// One file is one file, by whatever path it is reached.
std::filesystem::path identityOf(const std::filesystem::path& file)
{
    std::error_code failed;
    std::filesystem::path identity = std::filesystem::weakly_canonical(file, failed);
    return failed ? file.lexically_normal() : identity;
}

std::string requireNamespaceName(std::string_view name)
{
    std::string plain = plainNamespaceName(name);
    if (plain.empty())
        throw std::invalid_argument(quotation(name) + " is no name of a namespace");
    return plain;
}

} // namespace

// One file on its way into the repository.
class Compiler::Unit {
public:
    Unit(Compiler& compiler, const std::filesystem::path& file, Namespace& nameSpace)
        : compiler_(compiler), file_(file), nameSpace_(&nameSpace)
    {
        compiler_.open_.push_back(identityOf(file));
    }
    ~Unit() { compiler_.open_.pop_back(); }
    Unit(const Unit&) = delete;
    Unit& operator=(const Unit&) = delete;

    void compile(std::string_view text)
    {
        const auto name = std::make_shared<const std::string>(file_.string());
        for (const Syntax::Production& production : parseMof(text, name))
            std::visit([this](const auto& each) { add(each); }, production);
    }

private:
    void add(const Syntax::Pragma& pragma)
    {
        if (equalNames(pragma.name.text, "include"))
            include(pragma);
        else if (equalNames(pragma.name.text, "namespace"))
            changeNamespace(pragma);
    }

    void add(const Syntax::QualifierType& written)
    {
        if (const auto* const before = nameSpace_->findQualifier(written.name.text))
            throw MofError(written.name.position, "qualifier " + written.name.text +
                                                      " is declared already, at " +
                                                      toText(before->position));
        nameSpace_->add(declareQualifier(written));
    }

    void add(const Syntax::Class& written)
    {
        nameSpace_->add(
            compileClass(written, *nameSpace_, compiler_.budget_, compiler_.referenced_));
    }

    void changeNamespace(const Syntax::Pragma& pragma)
    {
        const std::string name = plainNamespaceName(pragma.argument);
        if (name.empty())
            throw MofError(
                pragma.argumentPosition, quotation(pragma.argument) + " is no name of a namespace");
        nameSpace_ = &compiler_.openNamespace(name);
        if (compiler_.namespaces_.size() > maximumNamespaces)
            throw MofError(pragma.argumentPosition, "too many namespaces");
    }

    void include(const Syntax::Pragma& pragma)
    {
        if (hasControlCharacter(pragma.argument))
            throw MofError(
                pragma.argumentPosition, quotation(pragma.argument) + " is no name of a file");
        const std::filesystem::path included = file_.parent_path() / pragma.argument;
        const auto fail = [&](const std::string& reason) {
            throw MofError(pragma.argumentPosition, included.string() + ": " + reason);
        };
        const auto& open = compiler_.open_;
        if (std::find(open.begin(), open.end(), identityOf(included)) != open.end())
            fail("includes itself");
        if (open.size() > maximumIncludeDepth || ++compiler_.includes_ > maximumIncludes)
            fail("too many files are included");
        std::string text;
        try {
            text = compiler_.reader_(included);
        } catch (const std::runtime_error& error) {
            fail(error.what());
        }
        Unit(compiler_, included, *nameSpace_).compile(text);
    }

    Compiler& compiler_;
    const std::filesystem::path& file_;
    Namespace* nameSpace_;
};

Compiler::Compiler(SourceReader reader) : reader_(std::move(reader)) {}

void Compiler::compileFile(const std::filesystem::path& file, std::string_view nameSpace)
{
    std::string text;
    try {
        text = reader_(file);
    } catch (const std::runtime_error& error) {
        throw std::runtime_error(file.string() + ": " + error.what());
    }
    compileText(text, file, nameSpace);
}

void Compiler::compileText(
    std::string_view text, const std::filesystem::path& file, std::string_view nameSpace)
{
    Unit(*this, file, openNamespace(requireNamespaceName(nameSpace))).compile(text);
}

std::unique_ptr<const Repository> Compiler::finish() &&
{
    for (const ReferencedClass& reference : referenced_) {
        const ClassDeclaration* const found = reference.nameSpace->findClass(reference.name);
        if (found == nullptr)
            throw MofError(reference.position, "class " + reference.name + " is not declared");
        if (!reference.ancestor.empty() && !equalNames(reference.ancestor, found->name) &&
            !found->isDerivedFrom(reference.ancestor))
            throw MofError(reference.position,
                "class " + found->name + " is not derived from class " + reference.ancestor +
                    ", which the overridden reference names");
    }
    return std::make_unique<const Repository>(std::move(namespaces_));
}

Namespace& Compiler::openNamespace(std::string_view name)
{
    for (const auto& known : namespaces_)
        if (equalNames(known->name(), name))
            return *known;
    return *namespaces_.emplace_back(std::make_unique<Namespace>(std::string(name)));
}

} // namespace Host
