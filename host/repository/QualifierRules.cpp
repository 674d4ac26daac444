// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/repository/QualifierRules.h"

#include "host/broker/Types.h"
#include "host/repository/ConstantConversion.h"
#include "host/repository/MofError.h"
#include "host/repository/Words.h"

#include <algorithm>

namespace Host {

namespace {

constexpr std::size_t maximumQualifiers = 256; // of one element

// Which of two flavors that exclude each other was written.
class Choice {
public:
    void choose(bool value, const SourcePosition& position)
    {
        if (chosen_ && *chosen_ != value)
            throw MofError(position, "this flavor excludes one before it");
        chosen_ = value;
    }
    bool orElse(bool otherwise) const { return chosen_.value_or(otherwise); }

private:
    std::optional<bool> chosen_;
};

Flavor changed(const Flavor& flavor, const std::vector<Syntax::FlavorWord>& words)
{
    Choice isOverridable;
    Choice isInherited;
    bool isTranslatable = flavor.isTranslatable;
    for (const Syntax::FlavorWord& word : words) {
        switch (word.change) {
        case FlavorChange::enableOverride:
        case FlavorChange::disableOverride:
            isOverridable.choose(word.change == FlavorChange::enableOverride, word.position);
            break;
        case FlavorChange::toSubclass:
        case FlavorChange::restricted:
            isInherited.choose(word.change == FlavorChange::toSubclass, word.position);
            break;
        case FlavorChange::translatable:
            isTranslatable = true;
            break;
        }
    }
    return {isOverridable.orElse(flavor.isOverridable), isInherited.orElse(flavor.isInherited),
        isTranslatable};
}

// A boolean qualifier without a value is true, any other one null.
Constant valueOf(const Syntax::Qualifier& written, const QualifierDeclaration& declaration)
{
    if (written.value)
        return toConstant(*written.value, declaration.type);
    if (declaration.type != CMPI_boolean)
        return {};
    return Constant(std::in_place_type<Scalar>, true);
}

const Qualifier* sameQualifier(const QualifierList& list, const Qualifier& wanted)
{
    const auto found = std::find_if(list.begin(), list.end(),
        [&](const Qualifier& each) { return each.declaration == wanted.declaration; });
    return found == list.end() ? nullptr : &*found;
}

Qualifier propagated(const Qualifier& inherited)
{
    Qualifier qualifier = inherited;
    qualifier.isPropagated = true;
    return qualifier;
}

} // namespace

std::unique_ptr<const QualifierDeclaration> declareQualifier(const Syntax::QualifierType& written)
{
    auto declared = std::make_unique<QualifierDeclaration>();
    declared->name = written.name.text;
    declared->type = written.type.code;
    declared->arraySize = written.type.arraySize;
    if (written.value)
        declared->defaultValue = toConstant(*written.value, declared->type);
    declared->scopes = written.scopes;
    declared->flavor = changed({}, written.flavors);
    declared->position = written.name.position;
    return declared;
}

QualifierList ownQualifiers(
    const std::vector<Syntax::Qualifier>& written, const Namespace& nameSpace)
{
    QualifierList own;
    for (const Syntax::Qualifier& each : written) {
        const SourcePosition& position = each.name.position;
        if (own.size() == maximumQualifiers)
            throw MofError(position,
                "more than " + std::to_string(maximumQualifiers) + " qualifiers on one element");
        Qualifier qualifier;
        qualifier.declaration = nameSpace.findQualifier(each.name.text);
        if (qualifier.declaration == nullptr)
            throw MofError(position, "qualifier " + each.name.text + " is not declared");
        if (sameQualifier(own, qualifier) != nullptr)
            throw MofError(position, "qualifier " + each.name.text + " stands here twice");
        qualifier.value = std::make_shared<const Constant>(valueOf(each, *qualifier.declaration));
        qualifier.flavor = changed(qualifier.declaration->flavor, each.flavors);
        qualifier.position = position;
        own.push_back(std::move(qualifier));
    }
    return own;
}

void requireScope(const QualifierList& own, Scope scope)
{
    for (const Qualifier& qualifier : own)
        if (!qualifier.isPropagated && !qualifier.declaration->scopes.has(scope))
            throw MofError(
                qualifier.position, "qualifier " + qualifier.name() +
                                        " may not stand on this element: its scope has no " +
                                        std::string(nameOfScope(scope)));
}

QualifierList withInherited(QualifierList own, const QualifierList& inherited)
{
    for (const Qualifier& above : inherited) {
        if (!above.flavor.isInherited)
            continue;
        // What was appended here is of other declarations, so that own ones alone are found.
        const Qualifier* const here = sameQualifier(own, above);
        if (here == nullptr) {
            own.push_back(propagated(above));
        } else if (!above.flavor.isOverridable) {
            if (*here->value != *above.value)
                throw MofError(here->position,
                    "qualifier " + here->name() + " may not get another value than it inherits");
            own[static_cast<std::size_t>(here - own.data())].flavor.isOverridable = false;
        }
    }
    return own;
}

bool hasRestricted(const QualifierList& qualifiers)
{
    return std::any_of(qualifiers.begin(), qualifiers.end(),
        [](const Qualifier& qualifier) { return !qualifier.flavor.isInherited; });
}

QualifierList inheritable(const QualifierList& qualifiers)
{
    QualifierList list;
    for (const Qualifier& qualifier : qualifiers)
        if (qualifier.flavor.isInherited)
            list.push_back(propagated(qualifier));
    return list;
}

} // namespace Host
