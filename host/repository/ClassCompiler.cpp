// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/repository/ClassCompiler.h"

#include "host/broker/Types.h"
#include "host/repository/ConstantConversion.h"
#include "host/repository/FeatureTable.h"
#include "host/repository/MofError.h"
#include "host/repository/QualifierRules.h"
#include "host/repository/Words.h"

#include <algorithm>

namespace Host {

namespace {

constexpr std::size_t maximumDepth = 64; // of a class below its root

// How the type is called in messages: a reference by its class.
std::string describe(const Syntax::Type& type)
{
    return type.referenceClass.empty() ? nameOfType(type.code) : type.referenceClass + " ref";
}

class ClassCompiler {
public:
    ClassCompiler(const Syntax::Class& written, const Namespace& nameSpace,
        InheritanceBudget& budget, std::vector<ReferencedClass>& referenced)
        : written_(written), nameSpace_(nameSpace), budget_(budget), referenced_(referenced),
          declared_(std::make_unique<ClassDeclaration>())
    {
    }

    std::unique_ptr<ClassDeclaration> compile()
    {
        declared_->name = written_.name.text;
        declared_->position = written_.name.position;
        if (const ClassDeclaration* const before = nameSpace_.findClass(declared_->name))
            throw MofError(declared_->position, "class " + declared_->name +
                                                    " is declared already, at " +
                                                    toText(before->position));
        setSuperclass();
        setQualifiers();
        compileProperties();
        compileMethods();
        setKeys();
        checkReferences();
        return std::move(declared_);
    }

private:
    void setSuperclass()
    {
        if (!written_.superclass)
            return;
        const Syntax::Name& name = *written_.superclass;
        declared_->superclass = nameSpace_.findClass(name.text);
        if (declared_->superclass == nullptr)
            throw MofError(name.position, "superclass " + name.text + " is not declared");
        std::size_t depth = 0;
        for (auto above = declared_->superclass; above != nullptr; above = above->superclass)
            if (++depth > maximumDepth)
                throw MofError(name.position, "class " + declared_->name + " has more than " +
                                                  std::to_string(maximumDepth) + " ancestors");
    }

    void setQualifiers()
    {
        QualifierList own = ownQualifiers(written_.qualifiers, nameSpace_);
        const ClassDeclaration* const superclass = declared_->superclass;
        if (superclass != nullptr) {
            own = withInherited(std::move(own), superclass->qualifiers);
            budget_.spend(own.size(), declared_->position);
        }
        declared_->isAssociation = isQualified(own, "Association");
        declared_->isIndication = isQualified(own, "Indication");
        declared_->isAbstract = isQualified(own, "Abstract");
        requireScope(own, declared_->isAssociation  ? Scope::association
                          : declared_->isIndication ? Scope::indication
                                                    : Scope::classes);
        if (superclass != nullptr && declared_->isAssociation && !superclass->isAssociation)
            throw MofError(findQualifier(own, "Association")->position,
                "an association cannot have class " + superclass->name +
                    " for its superclass, which is none");
        declared_->qualifiers = std::move(own);
    }

    void compileProperties()
    {
        FeatureTable<PropertyDeclaration> table;
        if (declared_->superclass != nullptr)
            table.inherit(declared_->superclass->properties, budget_, declared_->position);
        for (const Syntax::Property& each : written_.properties)
            table.declare(compileProperty(each, table));
        declared_->properties = table.take();
    }

    std::shared_ptr<const PropertyDeclaration> compileProperty(
        const Syntax::Property& written, FeatureTable<PropertyDeclaration>& table)
    {
        const bool isReference = written.type.code == CMPI_ref;
        const char* const kind = isReference ? "reference" : "property";
        if (written.type.code == arrayOf(CMPI_ref))
            throw MofError(written.type.position, "a property cannot be an array of references");
        QualifierList own = ownQualifiers(written.qualifiers, nameSpace_);
        requireScope(own, isReference ? Scope::reference : Scope::property);
        const PropertyDeclaration* const above = table.overridden(written.name, own, kind);

        auto property = std::make_shared<PropertyDeclaration>();
        property->name = written.name.text;
        property->position = written.name.position;
        property->type = written.type.code;
        property->arraySize = written.type.arraySize;
        property->referenceClass = written.type.referenceClass;
        property->origin = above == nullptr ? declared_.get() : above->origin;
        property->declaredIn = declared_.get();
        if (above != nullptr) {
            requireSameType(written.name.text, written.type, above->type);
            own = withInherited(std::move(own), above->qualifiers);
        }
        if (written.value)
            property->defaultValue =
                std::make_shared<const Constant>(toConstant(*written.value, property->type));
        else
            property->defaultValue =
                above != nullptr ? above->defaultValue : std::make_shared<const Constant>();
        property->isKey = isQualified(own, "Key");
        if (property->isKey)
            addKey(*property);
        property->qualifiers = std::move(own);
        requireDeclared(written.type, above == nullptr ? std::string() : above->referenceClass);
        return property;
    }

    void compileMethods()
    {
        FeatureTable<MethodDeclaration> table;
        if (declared_->superclass != nullptr)
            table.inherit(declared_->superclass->methods, budget_, declared_->position);
        for (const Syntax::Method& each : written_.methods)
            table.declare(compileMethod(each, table));
        declared_->methods = table.take();
    }

    std::shared_ptr<const MethodDeclaration> compileMethod(
        const Syntax::Method& written, FeatureTable<MethodDeclaration>& table)
    {
        QualifierList own = ownQualifiers(written.qualifiers, nameSpace_);
        requireScope(own, Scope::method);
        const MethodDeclaration* const above = table.overridden(written.name, own, "method");

        auto method = std::make_shared<MethodDeclaration>();
        method->name = written.name.text;
        method->position = written.name.position;
        method->type = written.type.code;
        method->referenceClass = written.type.referenceClass;
        method->origin = above == nullptr ? declared_.get() : above->origin;
        method->declaredIn = declared_.get();
        requireDeclared(written.type, {});
        if (above != nullptr) {
            requireSameType(written.name.text, written.type, above->type);
            own = withInherited(std::move(own), above->qualifiers);
        }
        method->qualifiers = std::move(own);
        method->parameters = compileParameters(written, above);
        return method;
    }

    std::vector<ParameterDeclaration> compileParameters(
        const Syntax::Method& written, const MethodDeclaration* above)
    {
        std::vector<ParameterDeclaration> parameters;
        NameTable<bool> names;
        for (const Syntax::Parameter& each : written.parameters) {
            if (!names.emplace(each.name.text, true).second)
                throw MofError(
                    each.name.position, "parameter " + each.name.text + " is declared twice");
            ParameterDeclaration& parameter = parameters.emplace_back();
            parameter.name = each.name.text;
            parameter.type = each.type.code;
            parameter.arraySize = each.type.arraySize;
            parameter.referenceClass = each.type.referenceClass;
            parameter.qualifiers = ownQualifiers(each.qualifiers, nameSpace_);
            requireScope(parameter.qualifiers, Scope::parameter);
            requireDeclared(each.type, {});
            if (above != nullptr)
                inheritParameter(each, parameters, *above);
        }
        if (above != nullptr && above->parameters.size() != parameters.size())
            throw MofError(
                written.name.position, "method " + written.name.text + " overrides one with " +
                                           std::to_string(above->parameters.size()) +
                                           " parameters, not " + std::to_string(parameters.size()));
        return parameters;
    }

    // The last of the parameters against the one at its place in the method above.
    static void inheritParameter(const Syntax::Parameter& written,
        std::vector<ParameterDeclaration>& parameters, const MethodDeclaration& above)
    {
        if (parameters.size() > above.parameters.size())
            return;
        ParameterDeclaration& parameter = parameters.back();
        const ParameterDeclaration& model = above.parameters[parameters.size() - 1];
        if (!equalNames(model.name, parameter.name))
            throw MofError(written.name.position, "parameter " + parameter.name +
                                                      " stands where the overridden method has " +
                                                      model.name);
        requireSameType(written.name.text, written.type, model.type);
        parameter.qualifiers = withInherited(std::move(parameter.qualifiers), model.qualifiers);
    }

    static void requireSameType(
        const std::string& name, const Syntax::Type& written, CMPIType overridden)
    {
        if (written.code != overridden)
            throw MofError(written.position, name + " is overridden with type " +
                                                 describe(written) + ", but has type " +
                                                 nameOfType(overridden));
    }

    void requireDeclared(const Syntax::Type& type, const std::string& ancestor)
    {
        if (!type.referenceClass.empty())
            referenced_.push_back({&nameSpace_, type.referenceClass, ancestor, type.position});
    }

    bool inheritsKeys() const
    {
        return declared_->superclass != nullptr && !declared_->superclass->keys->empty();
    }

    void addKey(const PropertyDeclaration& property)
    {
        if (inheritsKeys() && !isKeyOf(*declared_->superclass, property.name))
            throw MofError(
                property.position, "property " + property.name + " cannot be a key: class " +
                                       declared_->superclass->name + " has its keys already");
        ownKeys_.push_back(property.name);
    }

    void setKeys()
    {
        if (inheritsKeys() || (ownKeys_.empty() && declared_->superclass != nullptr))
            declared_->keys = declared_->superclass->keys;
        else
            declared_->keys = std::make_shared<const std::vector<std::string>>(std::move(ownKeys_));
    }

    static bool isKeyOf(const ClassDeclaration& declared, const std::string& name)
    {
        return std::any_of(declared.keys->begin(), declared.keys->end(),
            [&](const std::string& key) { return equalNames(key, name); });
    }

    void checkReferences() const
    {
        std::size_t references = 0;
        for (const auto& property : declared_->properties) {
            if (!property->isReference())
                continue;
            ++references;
            if (!declared_->isAssociation)
                throw MofError(property->position,
                    "reference " + property->name + " stands in a class that is no association");
        }
        if (declared_->isAssociation && references < 2)
            throw MofError(declared_->position,
                "association " + declared_->name + " has fewer than two references");
    }

    const Syntax::Class& written_;
    const Namespace& nameSpace_;
    InheritanceBudget& budget_;
    std::vector<ReferencedClass>& referenced_;
    std::unique_ptr<ClassDeclaration> declared_;
    std::vector<std::string> ownKeys_;
};

} // namespace

void InheritanceBudget::spend(std::size_t elements, const SourcePosition& position)
{
    if (elements > left_)
        throw MofError(position, "the classes so far inherit too much in all");
    left_ -= elements;
}

std::unique_ptr<ClassDeclaration> compileClass(const Syntax::Class& written,
    const Namespace& nameSpace, InheritanceBudget& budget, std::vector<ReferencedClass>& referenced)
{
    return ClassCompiler(written, nameSpace, budget, referenced).compile();
}

} // namespace Host
