// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Providers whose handlers a test defines.

#pragma once

#include "host/manager/ProviderRegistration.h"

#include <cmpidt.h>
#include <cmpift.h>

#include <functional>
#include <map>
#include <string>

namespace Testing {

// The operation and the arguments of one call.
struct ProviderCall {
    std::string operation;
    const CMPIContext* context = nullptr;
    const CMPIResult* result = nullptr;
    const CMPIObjectPath* path = nullptr;
    // Null where the operation has no such argument or the client gave none.
    const char* associationClass = nullptr;
    const char* resultClass = nullptr;
    const char* role = nullptr;
    const char* resultRole = nullptr;
    const char** properties = nullptr;
};

// Both MIs of one provider. Every operation calls the same handler.
class ScriptedProvider {
public:
    using Handler = std::function<CMPIStatus(const ProviderCall&)>;

    ScriptedProvider() = default;
    explicit ScriptedProvider(Handler handler) : handler_(std::move(handler)) {}
    ScriptedProvider(const ScriptedProvider&) = delete;
    ScriptedProvider& operator=(const ScriptedProvider&) = delete;

    void handle(Handler handler) { handler_ = std::move(handler); }

    CMPIInstanceMI instanceMI{this, &instanceTable};
    CMPIAssociationMI associationMI{this, &associationTable};

private:
    template <typename MI>
    static CMPIStatus pass(MI* mi, const ProviderCall& call)
    {
        return static_cast<const ScriptedProvider*>(mi->hdl)->handler_(call);
    }

    static const CMPIInstanceMIFT instanceTable;
    static const CMPIAssociationMIFT associationTable;

    Handler handler_ = [](const ProviderCall&) { return CMPIStatus{CMPI_RC_OK, nullptr}; };
};

inline const CMPIInstanceMIFT ScriptedProvider::instanceTable = {
    .ftVersion = 200,
    .miVersion = 200,
    .miName = "instanceScripted",
    .cleanup =
        [](CMPIInstanceMI*, const CMPIContext*, CMPIBoolean) {
            return CMPIStatus{CMPI_RC_OK, nullptr};
        },
    .enumerateInstanceNames =
        [](CMPIInstanceMI* mi, const CMPIContext* context, const CMPIResult* result,
            const CMPIObjectPath* path) {
            return pass(mi, {"enumerateInstanceNames", context, result, path});
        },
    .enumerateInstances =
        [](CMPIInstanceMI* mi, const CMPIContext* context, const CMPIResult* result,
            const CMPIObjectPath* path, const char** properties) {
            return pass(
                mi, {"enumerateInstances", context, result, path, {}, {}, {}, {}, properties});
        },
    .getInstance =
        [](CMPIInstanceMI* mi, const CMPIContext* context, const CMPIResult* result,
            const CMPIObjectPath* path, const char** properties) {
            return pass(mi, {"getInstance", context, result, path, {}, {}, {}, {}, properties});
        },
    .createInstance = nullptr, // the other operations are not supported
    .modifyInstance = nullptr,
    .deleteInstance = nullptr,
    .execQuery = nullptr,
};

inline const CMPIAssociationMIFT ScriptedProvider::associationTable = {
    .ftVersion = 200,
    .miVersion = 200,
    .miName = "associationScripted",
    .cleanup =
        [](CMPIAssociationMI*, const CMPIContext*, CMPIBoolean) {
            return CMPIStatus{CMPI_RC_OK, nullptr};
        },
    .associators =
        [](CMPIAssociationMI* mi, const CMPIContext* context, const CMPIResult* result,
            const CMPIObjectPath* path, const char* associationClass, const char* resultClass,
            const char* role, const char* resultRole, const char** properties) {
            return pass(mi, {"associators", context, result, path, associationClass, resultClass,
                                role, resultRole, properties});
        },
    .associatorNames =
        [](CMPIAssociationMI* mi, const CMPIContext* context, const CMPIResult* result,
            const CMPIObjectPath* path, const char* associationClass, const char* resultClass,
            const char* role, const char* resultRole) {
            return pass(mi, {"associatorNames", context, result, path, associationClass,
                                resultClass, role, resultRole});
        },
    .references =
        [](CMPIAssociationMI* mi, const CMPIContext* context, const CMPIResult* result,
            const CMPIObjectPath* path, const char* resultClass, const char* role,
            const char** properties) {
            return pass(mi, {"references", context, result, path, nullptr, resultClass, role,
                                nullptr, properties});
        },
    .referenceNames =
        [](CMPIAssociationMI* mi, const CMPIContext* context, const CMPIResult* result,
            const CMPIObjectPath* path, const char* resultClass, const char* role) {
            return pass(mi, {"referenceNames", context, result, path, nullptr, resultClass, role});
        },
};

using ScriptedProviders = std::map<std::string, ScriptedProvider>;

// Returns a registration of the provider of that name, which is created at its first use. The
// providers must outlive the manager that gets the registration.
inline Host::ProviderRegistration registration(ScriptedProviders& providers,
    const std::string& className, const std::string& name, bool servesAssociations = false)
{
    ScriptedProvider& provider = providers[name];
    return {className, name, {}, servesAssociations, &provider.instanceMI, &provider.associationMI};
}

} // namespace Testing
