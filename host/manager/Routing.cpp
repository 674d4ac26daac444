// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/manager/Routing.h"

#include "host/broker/Names.h"
#include "host/broker/ObjectPath.h"
#include "host/broker/Refusal.h"

#include <algorithm>
#include <iterator>
#include <string>
#include <utility>

namespace Host {

namespace {

// Returns whether the name is the expected one; null stands for any.
bool matches(std::string_view name, const char* expected)
{
    return expected == nullptr || equalNames(name, expected);
}

} // namespace

Routing::Routing(const ClassInformation& classes, std::vector<ProviderRegistration> registrations)
    : classes_(classes), registrations_(std::move(registrations))
{
}

const ProviderRegistration* Routing::findProviderOf(const ObjectPath& path) const
{
    checkKnown(path.nameSpace(), path.className());
    const auto found = std::find_if(
        registrations_.begin(), registrations_.end(), [&](const ProviderRegistration& candidate) {
            return equalNames(candidate.className, path.className());
        });
    return found == registrations_.end() ? nullptr : &*found;
}

Routing::Registrations Routing::providersBelow(const ObjectPath& path) const
{
    checkKnown(path.nameSpace(), path.className());
    Registrations found;
    for (const ProviderRegistration& candidate : registrations_)
        if (isA(path.nameSpace(), candidate.className, path.className()))
            found.push_back(&candidate);
    if (found.empty())
        throw Refusal(CMPI_RC_ERR_NOT_SUPPORTED,
            "no provider serves the class " + std::string(path.className()));
    return found;
}

Routing::Registrations Routing::associationProviders(
    const ObjectPath& source, const Association& association) const
{
    checkKnown(source.nameSpace(), source.className());
    for (const char* const named : {association.associationClass, association.resultClass})
        if (named != nullptr)
            checkKnown(source.nameSpace(), named);
    Registrations found;
    for (const ProviderRegistration& candidate : registrations_)
        if (candidate.servesAssociations && !farEnds(candidate, source, association).empty())
            found.push_back(&candidate);
    return found;
}

const char* Routing::resultClassFor(const ProviderRegistration& registration,
    const ObjectPath& source, const Association& association) const
{
    const auto ends = farEnds(registration, source, association);
    const bool excludesNothing =
        association.resultClass != nullptr &&
        std::all_of(ends.begin(), ends.end(), [&](const ReferenceProperty& end) {
            return classes_.isDerivedFrom(
                source.nameSpace(), end.className, association.resultClass);
        });
    return excludesNothing ? nullptr : association.resultClass;
}

std::string Routing::classNameOf(const ObjectPath& path) const
{
    const auto found = std::find_if(
        registrations_.begin(), registrations_.end(), [&](const ProviderRegistration& candidate) {
            return equalNames(candidate.className, path.className());
        });
    return found == registrations_.end() ? std::string(path.className()) : found->className;
}

bool Routing::isA(
    std::string_view nameSpace, std::string_view className, std::string_view ancestor) const
{
    return equalNames(className, ancestor) ||
           classes_.isDerivedFrom(nameSpace, className, ancestor);
}

void Routing::checkKnown(std::string_view nameSpace, std::string_view className) const
{
    if (classes_.keysOf(nameSpace, className) == nullptr)
        throw Refusal(CMPI_RC_ERR_INVALID_CLASS,
            "there is no class " + std::string(className) + " in " + std::string(nameSpace));
}

std::vector<ReferenceProperty> Routing::farEnds(const ProviderRegistration& registration,
    const ObjectPath& source, const Association& association) const
{
    const std::string_view nameSpace = source.nameSpace();
    if (association.associationClass != nullptr &&
        !isA(nameSpace, registration.className, association.associationClass))
        return {};
    std::vector<ReferenceProperty> found;
    const auto references = classes_.referencesOf(nameSpace, registration.className);
    for (const ReferenceProperty& near : references) {
        if (!matches(near.name, association.role) ||
            !isA(nameSpace, source.className(), near.className))
            continue;
        std::copy_if(references.begin(), references.end(), std::back_inserter(found),
            [&](const ReferenceProperty& far) {
                return &far != &near && canReach(nameSpace, far, association);
            });
    }
    return found;
}

bool Routing::canReach(
    std::string_view nameSpace, const ReferenceProperty& far, const Association& association) const
{
    if (!matches(far.name, association.resultRole))
        return false;
    return association.resultClass == nullptr ||
           isA(nameSpace, far.className, association.resultClass) ||
           isA(nameSpace, association.resultClass, far.className);
}

} // namespace Host
