// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/repository/ClassBuilder.h"

#include "host/broker/Names.h"

#include <tao/pegtl/parse_error.hpp>

#include <algorithm>
#include <utility>

namespace Host {

namespace {

bool isInherited(const Qualifier& qualifier)
{
    return qualifier.flavor().isInherited;
}

// Appends the inherited qualifiers that the element does not specify itself.
void inherit(QualifierList& own, const QualifierList& inherited)
{
    for (const Qualifier& above : inherited)
        if (isInherited(above) && findQualifier(own, above.name()) == nullptr)
            own.push_back({above.declaration, above.value, true});
}

// Returns the property as a subclass inherits it that does not override it.
std::shared_ptr<const PropertyDeclaration> inherited(
    const std::shared_ptr<const PropertyDeclaration>& property)
{
    if (std::all_of(property->qualifiers.begin(), property->qualifiers.end(), isInherited))
        return property;
    auto copy = std::make_shared<PropertyDeclaration>(*property);
    copy->qualifiers.clear();
    inherit(copy->qualifiers, property->qualifiers);
    return copy;
}

} // namespace

ClassBuilder::ClassBuilder(
    std::string name, const ClassDeclaration* superclass, QualifierList qualifiers)
    : class_(std::make_unique<ClassDeclaration>())
{
    class_->name = std::move(name);
    class_->superclass = superclass;
    class_->qualifiers = std::move(qualifiers);
    if (superclass != nullptr) {
        inherit(class_->qualifiers, superclass->qualifiers);
        for (const auto& property : superclass->properties)
            class_->properties.push_back(inherited(property));
    }
    class_->isAssociation = isQualified(class_->qualifiers, "Association");
}

void ClassBuilder::add(PropertyDeclaration property, const SourcePosition& position)
{
    const auto fail = [&](const std::string& reason) {
        throw tao::pegtl::parse_error("property " + property.name + " " + reason, position);
    };
    const auto place = std::find_if(class_->properties.begin(), class_->properties.end(),
        [&](const auto& each) { return equalNames(each->name, property.name); });
    const bool isNew = place == class_->properties.end();
    if (!isNew && (*place)->declaredIn == class_.get())
        fail("is declared twice");
    const bool isOverride = !qualifierText(property.qualifiers, "Override").empty();
    if (isNew && isOverride)
        fail("overrides none: no superclass has one of that name");
    if (!isNew && !isOverride)
        fail("is inherited from class " + (*place)->declaredIn->name +
             "; to declare it anew, qualify it Override");

    property.origin = property.declaredIn = class_.get();
    if (!isNew) {
        const PropertyDeclaration& above = **place;
        if (property.type != above.type)
            fail("is overridden with another type");
        property.origin = above.origin;
        inherit(property.qualifiers, above.qualifiers);
        if (isNull(property.defaultValue))
            property.defaultValue = above.defaultValue;
    }
    property.isKey = isQualified(property.qualifiers, "Key");
    if (property.isKey)
        ownKeys_.push_back(property.name);
    auto declared = std::make_shared<const PropertyDeclaration>(std::move(property));
    if (isNew)
        class_->properties.push_back(std::move(declared));
    else
        *place = std::move(declared);
}

std::unique_ptr<ClassDeclaration> ClassBuilder::finish()
{
    const ClassDeclaration* const above = class_->superclass;
    if (above != nullptr && !above->keys.empty())
        class_->keys = above->keys;
    else
        class_->keys = std::move(ownKeys_);
    return std::move(class_);
}

} // namespace Host
