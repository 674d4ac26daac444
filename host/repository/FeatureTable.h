// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The properties or the methods of a class while it is compiled.

#pragma once

#include "host/repository/ClassCompiler.h"
#include "host/repository/MofError.h"
#include "host/repository/QualifierRules.h"

#include <algorithm>
#include <unordered_set>

namespace Host {

// What a feature costs that a subclass cannot share.
inline std::size_t weight(const PropertyDeclaration& property)
{
    return 1 + property.qualifiers.size();
}

inline std::size_t weight(const MethodDeclaration& method)
{
    std::size_t sum = 1 + method.qualifiers.size();
    for (const ParameterDeclaration& parameter : method.parameters)
        sum += 1 + parameter.qualifiers.size();
    return sum;
}

// Whether a subclass sees the feature otherwise than the class itself.
inline bool isRestricted(const PropertyDeclaration& property)
{
    return hasRestricted(property.qualifiers);
}

inline bool isRestricted(const MethodDeclaration& method)
{
    return hasRestricted(method.qualifiers) ||
           std::any_of(method.parameters.begin(), method.parameters.end(),
               [](const ParameterDeclaration& each) { return hasRestricted(each.qualifiers); });
}

// The feature as a subclass has it that does not declare it anew.
inline PropertyDeclaration inheritable(PropertyDeclaration property)
{
    property.qualifiers = inheritable(property.qualifiers);
    return property;
}

inline MethodDeclaration inheritable(MethodDeclaration method)
{
    method.qualifiers = inheritable(method.qualifiers);
    for (ParameterDeclaration& parameter : method.parameters)
        parameter.qualifiers = inheritable(parameter.qualifiers);
    return method;
}

template <typename Feature>
class FeatureTable {
public:
    using List = std::vector<std::shared_ptr<const Feature>>;

    // REQUIRES: called before declare().
    void inherit(const List& features, InheritanceBudget& budget, const SourcePosition& position)
    {
        for (const std::shared_ptr<const Feature>& feature : features) {
            const bool isCopied = isRestricted(*feature);
            budget.spend(isCopied ? weight(*feature) : 1, position);
            places_.emplace(feature->name, list_.size());
            list_.push_back(
                isCopied ? std::make_shared<const Feature>(inheritable(*feature)) : feature);
        }
        inherited_ = list_.size();
    }

    // What the feature overrides; null when it is new. Throws MofError unless the feature says
    // so, and only then.
    const Feature* overridden(const Syntax::Name& name, const QualifierList& own, const char* kind)
    {
        const auto place = places_.find(name.text);
        const bool isInherited = place != places_.end();
        if (isInherited && (place->second >= inherited_ || overridden_.count(place->second) != 0))
            throw MofError(
                name.position, std::string(kind) + " " + name.text + " is declared twice");
        const std::string_view target = qualifierText(own, "Override");
        if (target.empty()) {
            if (isInherited)
                throw MofError(name.position,
                    std::string(kind) + " " + name.text + " is inherited from class " +
                        list_[place->second]->declaredIn->name +
                        "; to declare it anew, qualify it Override(\"" + name.text + "\")");
            return nullptr;
        }
        const SourcePosition& position = findQualifier(own, "Override")->position;
        if (!equalNames(target, name.text))
            throw MofError(position, std::string(kind) + " " + name.text + " cannot override " +
                                         quotation(target) + ", which has another name");
        if (!isInherited)
            throw MofError(position, "no superclass has a " + std::string(kind) + " " + name.text +
                                         " that could be overridden");
        return list_[place->second].get();
    }

    void declare(std::shared_ptr<const Feature> feature)
    {
        const auto [place, isNew] = places_.emplace(feature->name, list_.size());
        if (isNew) {
            list_.push_back(std::move(feature));
        } else {
            overridden_.insert(place->second);
            list_[place->second] = std::move(feature);
        }
    }

    List take() { return std::move(list_); }

private:
    List list_;
    NameTable<std::size_t> places_;
    std::unordered_set<std::size_t> overridden_;
    std::size_t inherited_ = 0;
};

} // namespace Host
