// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/repository/FileCompiler.h"

#include "host/broker/Names.h"
#include "host/broker/Types.h"
#include "host/repository/TypeNames.h"

#include <tao/pegtl/parse_error.hpp>

#include <array>
#include <utility>

namespace Host {

namespace {

struct ScopeName {
    std::string_view name;
    Scope scope;
};

constexpr std::array<ScopeName, 8> scopes = {{
    {"class", Scope::classes},
    {"association", Scope::association},
    {"indication", Scope::indication},
    {"property", Scope::property},
    {"reference", Scope::reference},
    {"method", Scope::method},
    {"parameter", Scope::parameter},
    {"any", Scope::any},
}};

struct FlavorName {
    std::string_view name;
    bool Flavor::*flag;
    bool value;
};

constexpr std::array<FlavorName, 5> flavors = {{
    {"EnableOverride", &Flavor::isOverridable, true},
    {"DisableOverride", &Flavor::isOverridable, false},
    {"ToSubclass", &Flavor::isInherited, true},
    {"Restricted", &Flavor::isInherited, false},
    {"Translatable", &Flavor::isTranslatable, true},
}};

[[noreturn]] void failAt(const Word& word, const std::string& reason)
{
    throw tao::pegtl::parse_error(word.text + " " + reason, word.position);
}

// Returns the entry of that name; throws when there is none.
template <typename Table>
const auto& find(const Table& table, const Word& word, const char* kind)
{
    for (const auto& each : table)
        if (equalNames(each.name, word.text))
            return each;
    failAt(word, std::string("is no ") + kind);
}

} // namespace

void FileCompiler::endQualifierDeclaration()
{
    const Word& name = parts.qualifierName;
    if (nameSpace_->findQualifier(name.text) != nullptr)
        failAt(name, "is declared twice");
    auto declared = std::make_unique<QualifierDeclaration>();
    declared->name = name.text;
    declared->type = takeType();
    declared->defaultValue = toConstant(std::exchange(parts.value, {}), declared->type);
    for (const Word& word : std::exchange(parts.scopes, {}))
        declared->scopes.add(find(scopes, word, "scope").scope);
    for (const Word& word : std::exchange(parts.flavors, {})) {
        const auto& known = find(flavors, word, "flavor");
        declared->flavor.*known.flag = known.value;
    }
    nameSpace_->add(std::move(declared));
}

void FileCompiler::endQualifier()
{
    const Word& name = parts.qualifierName;
    const QualifierDeclaration* const declaration = nameSpace_->findQualifier(name.text);
    if (declaration == nullptr)
        failAt(name, "is no declared qualifier");
    if (findQualifier(qualifiers_, name.text) != nullptr)
        failAt(name, "stands here twice");
    Qualifier& qualifier = qualifiers_.emplace_back();
    qualifier.declaration = declaration;
    // A boolean qualifier without a value is true.
    if (parts.value.isEmpty() && declaration->type == CMPI_boolean)
        qualifier.value = Scalar(true);
    else
        qualifier.value = toConstant(std::exchange(parts.value, {}), declaration->type);
}

void FileCompiler::beginClass()
{
    const Word& name = parts.className;
    if (nameSpace_->findClass(name.text) != nullptr)
        failAt(name, "is declared twice");
    const Word above = std::exchange(parts.superclass, {});
    const ClassDeclaration* const superclass = nameSpace_->findClass(above.text);
    if (superclass == nullptr && !above.text.empty())
        failAt(above, "is no declared class");
    class_.emplace(name.text, superclass, std::exchange(qualifiers_, {}));
}

void FileCompiler::endProperty()
{
    PropertyDeclaration property;
    property.name = parts.propertyName.text;
    property.type = takeType();
    if (property.isReference()) {
        property.referenceClass = parts.typeName.text;
        referencedClasses_.push_back(
            {nameSpace_, parts.typeName.text, to_string(parts.typeName.position)});
    }
    property.defaultValue = toConstant(std::exchange(parts.value, {}), property.type);
    property.qualifiers = std::exchange(qualifiers_, {});
    class_->add(std::move(property), parts.propertyName.position);
}

void FileCompiler::endClass()
{
    nameSpace_->add(class_->finish());
}

CMPIType FileCompiler::takeType()
{
    if (std::exchange(parts.isReference, false))
        return CMPI_ref;
    const CMPIType type = dataTypeNamed(parts.typeName.text);
    if (type == CMPI_null || type == CMPI_ref)
        failAt(parts.typeName, "is no data type");
    return std::exchange(parts.isArray, false) ? arrayOf(type) : type;
}

} // namespace Host
