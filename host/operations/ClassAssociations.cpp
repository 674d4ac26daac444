// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/operations/ClassAssociations.h"

#include "host/broker/Names.h"
#include "host/operations/KnownClass.h"
#include "host/repository/Repository.h"

#include <algorithm>

namespace Host {

using CimXml::Operation;

namespace {

using Classes = std::vector<const ClassDeclaration*>;

bool matches(const std::string& name, const std::string& wanted)
{
    return wanted.empty() || equalNames(name, wanted);
}

// Returns whether a class is the wanted one or derived from it. A null means any class.
bool isA(const ClassDeclaration& declared, const ClassDeclaration* wanted)
{
    return wanted == nullptr || &declared == wanted || declared.isDerivedFrom(*wanted);
}

void addOnce(Classes& classes, const ClassDeclaration& declared)
{
    if (std::find(classes.begin(), classes.end(), &declared) == classes.end())
        classes.push_back(&declared);
}

// One end of an association class that the operation's class can stand at.
class NearEnds {
public:
    NearEnds(const Repository& classes, const Operation& operation)
        : classes_(classes), operation_(operation),
          source_(knownClass(classes, operation.nameSpace, operation.className))
    {
    }

    // Visits the association classes, each with every such reference it has.
    template <typename Visit>
    void visit(const ClassDeclaration* associationClass, const Visit& visit) const
    {
        for (const auto& each : classes_.findNamespace(operation_.nameSpace)->classes())
            if (each->isAssociation && isA(*each, associationClass))
                for (const auto& property : each->properties)
                    if (isNear(*property))
                        visit(*each, *property);
    }

    // The class that a reference leads to.
    const ClassDeclaration& target(const PropertyDeclaration& reference) const
    {
        return *classes_.findClass(operation_.nameSpace, reference.referenceClass);
    }

private:
    bool isNear(const PropertyDeclaration& property) const
    {
        return property.isReference() && matches(property.name, operation_.role) &&
               isA(source_, &target(property));
    }

    const Repository& classes_;
    const Operation& operation_;
    const ClassDeclaration& source_;
};

} // namespace

Classes associatedClasses(const Repository& classes, const Operation& operation)
{
    const NearEnds ends(classes, operation);
    const ClassDeclaration* const wanted =
        findNamedClass(classes, operation.nameSpace, operation.resultClass);
    Classes found;
    ends.visit(findNamedClass(classes, operation.nameSpace, operation.associationClass),
        [&](const ClassDeclaration& association, const PropertyDeclaration& near) {
            for (const auto& far : association.properties)
                if (far->isReference() && far.get() != &near &&
                    matches(far->name, operation.resultRole) && isA(ends.target(*far), wanted))
                    addOnce(found, ends.target(*far));
        });
    return found;
}

Classes referringClasses(const Repository& classes, const Operation& operation)
{
    const NearEnds ends(classes, operation);
    Classes found;
    ends.visit(findNamedClass(classes, operation.nameSpace, operation.resultClass),
        [&](const ClassDeclaration& association, const PropertyDeclaration&) {
            addOnce(found, association);
        });
    return found;
}

} // namespace Host
