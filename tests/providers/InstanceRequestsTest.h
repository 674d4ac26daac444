// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Requests to the instance provider of one class, as an object manager sends them.

#pragma once

#include "tests/providers/Factories.h"
#include "tests/support/ProviderTest.h"

#include <string>
#include <utility>
#include <vector>

namespace Testing {

class InstanceRequestsTest : public ProviderTest {
protected:
    InstanceRequestsTest(
        const char* className, InstanceFactory create, std::vector<ScriptedNode> nodes)
        : className_(className), machine_(std::move(nodes)), mi_(create(broker(), nullptr, nullptr))
    {
    }

    CMPIStatus enumerateNames(const char* nameSpace = testNameSpace)
    {
        return mi_->ft->enumerateInstanceNames(
            mi_, context(), result(), path(className_, {}, nameSpace).handle());
    }

    CMPIStatus enumerate(const char** properties = nullptr)
    {
        return mi_->ft->enumerateInstances(
            mi_, context(), result(), path(className_).handle(), properties);
    }

    CMPIStatus get(const Host::ObjectPath& ref, const char** properties = nullptr)
    {
        return mi_->ft->getInstance(mi_, context(), result(), ref.handle(), properties);
    }

    CMPIStatus get(const std::vector<std::pair<std::string, std::string>>& keys)
    {
        return get(path(className_, keys));
    }

    static void expectOk(const CMPIStatus& status)
    {
        EXPECT_EQ(status.rc, CMPI_RC_OK);
        EXPECT_EQ(status.msg, nullptr);
    }

    const char* className_;
    ScriptedMachine machine_;
    CMPIInstanceMI* mi_;
};

} // namespace Testing
