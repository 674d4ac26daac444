// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Requests for the instances of an association, whose two references form pairs.

#pragma once

#include "tests/providers/AssociationTest.h"

#include <string>
#include <utility>
#include <vector>

namespace Testing {

struct AssociationClass {
    const char* name;
    const char* one; // the name of the first reference
    const char* other;
    InstanceFactory createInstanceMI;
    AssociationFactory createAssociationMI;
};

class AssociationInstanceTest : public AssociationTest {
protected:
    AssociationInstanceTest(const AssociationClass& association, std::vector<ScriptedNode> nodes,
        std::vector<std::string> systems)
        : AssociationTest(association.createInstanceMI, association.createAssociationMI,
              std::move(nodes), std::move(systems)),
          association_(association)
    {
    }

    // Returns a path of the association with the given values of its keys.
    Host::ObjectPath& pairPath(const Host::Value& one, const Host::Value& other)
    {
        Host::ObjectPath& made = path(association_.name);
        made.addKey(association_.one, one);
        made.addKey(association_.other, other);
        return made;
    }

    Host::ObjectPath& pairPath(const Host::ObjectPath& one, const Host::ObjectPath& other)
    {
        return pairPath(Host::Value::of(one), Host::Value::of(other));
    }

    std::vector<std::string> pairs() const
    {
        return AssociationTest::pairs(association_.one, association_.other);
    }

    // Calls GetInstance with a result of its own. Returns the pairs that were delivered.
    std::vector<std::string> got(const Host::ObjectPath& ref)
    {
        Host::CollectedResult found;
        Host::Result into(found);
        expectOk(instanceMI_->ft->getInstance(
            instanceMI_, context(), into.handle(), ref.handle(), nullptr));
        EXPECT_TRUE(found.isDone());
        return AssociationTest::pairs(found, association_.one, association_.other);
    }

    AssociationClass association_;
};

} // namespace Testing
