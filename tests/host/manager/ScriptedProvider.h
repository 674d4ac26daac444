// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Providers whose handlers a test writes down.

#pragma once

#include "host/manager/ProviderSource.h"

#include <cmpidt.h>
#include <cmpift.h>

#include <functional>
#include <map>
#include <stdexcept>
#include <string>
#include <vector>

namespace Testing {

// One call, as the provider sees it.
struct ProviderCall {
    std::string operation;
    const CMPIContext* context = nullptr;
    const CMPIResult* result = nullptr;
    const CMPIObjectPath* path = nullptr;
    // What the operation has of these; null where a client named none.
    const char* associationClass = nullptr;
    const char* resultClass = nullptr;
    const char* role = nullptr;
    const char* resultRole = nullptr;
    const char** properties = nullptr;
};

// Both MIs of one provider; every operation comes to the one handler.
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
            return pass(mi, {.operation = "enumerateInstances",
                                .context = context,
                                .result = result,
                                .path = path,
                                .properties = properties});
        },
    .getInstance =
        [](CMPIInstanceMI* mi, const CMPIContext* context, const CMPIResult* result,
            const CMPIObjectPath* path, const char** properties) {
            return pass(mi, {.operation = "getInstance",
                                .context = context,
                                .result = result,
                                .path = path,
                                .properties = properties});
        },
    .createInstance =
        [](CMPIInstanceMI* mi, const CMPIContext* context, const CMPIResult* result,
            const CMPIObjectPath* path, const CMPIInstance*) {
            return pass(mi, {"createInstance", context, result, path});
        },
    .modifyInstance =
        [](CMPIInstanceMI* mi, const CMPIContext* context, const CMPIResult* result,
            const CMPIObjectPath* path, const CMPIInstance*, const char** properties) {
            return pass(mi, {.operation = "modifyInstance",
                                .context = context,
                                .result = result,
                                .path = path,
                                .properties = properties});
        },
    .deleteInstance =
        [](CMPIInstanceMI* mi, const CMPIContext* context, const CMPIResult* result,
            const CMPIObjectPath* path) {
            return pass(mi, {"deleteInstance", context, result, path});
        },
    .execQuery = nullptr, // some providers leave out what they do not offer
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

// Finds them by the names of the registrations.
class ScriptedSource : public Host::ProviderSource {
public:
    explicit ScriptedSource(ScriptedProviders& providers) : providers_(providers) {}

    CMPIInstanceMI& instanceMI(const Host::ProviderRegistration& registration) override
    {
        return find(registration).instanceMI;
    }
    CMPIAssociationMI& associationMI(const Host::ProviderRegistration& registration) override
    {
        return find(registration).associationMI;
    }

private:
    ScriptedProvider& find(const Host::ProviderRegistration& registration)
    {
        const auto found = providers_.find(registration.providerName);
        if (found == providers_.end())
            throw std::runtime_error("no provider " + registration.providerName);
        return found->second;
    }

    ScriptedProviders& providers_;
};

} // namespace Testing
