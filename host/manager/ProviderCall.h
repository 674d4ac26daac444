// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// One call of one provider.

#pragma once

#include "host/broker/Context.h"
#include "host/broker/ObjectPath.h"
#include "host/broker/Refusal.h"
#include "host/broker/Result.h"
#include "host/manager/ProviderRegistration.h"

#include <exception>
#include <string>

namespace Host {

// Counts the nested provider calls of this thread.
class CallDepth {
public:
    // Providers that call one another need two or three levels.
    static constexpr unsigned maximum = 10;

    // Throws Refusal (CMPI_RC_ERR_FAILED) beyond the maximum, which a cycle of up-calls exceeds.
    explicit CallDepth(const ProviderRegistration& registration);
    ~CallDepth();
    CallDepth(const CallDepth&) = delete;
    CallDepth& operator=(const CallDepth&) = delete;
};

// Returns the path for a provider: a copy with the class's name as it is declared, whatever the
// client's spelling.
const CMPIObjectPath* targetOf(const ObjectPath& path, const std::string& className);

// Throws Refusal with the status's code and message unless it is OK. The operation names what a
// provider does not support, such as "getting instances".
void checkStatus(
    const ProviderRegistration& registration, const char* operation, const CMPIStatus& status);

// Calls a provider's function and returns what it delivered. Throws Refusal when the provider lacks
// the function, when it throws, and with its status unless that is OK.
template <typename MI, typename Function, typename... Arguments>
CollectedResult callProvider(const ProviderRegistration& registration, const char* operation,
    MI& mi, Function function, const Context& context, const CMPIObjectPath* target,
    Arguments... arguments)
{
    if (function == nullptr)
        checkStatus(registration, operation, {CMPI_RC_ERR_NOT_SUPPORTED, nullptr});
    const CallDepth depth(registration);
    CollectedResult collected;
    Result result(collected);
    CMPIStatus status = {CMPI_RC_OK, nullptr};
    try {
        status = function(&mi, context.handle(), result.handle(), target, arguments...);
    } catch (const std::exception& error) {
        throw Refusal(CMPI_RC_ERR_FAILED, registration.providerName + ": " + error.what());
    }
    checkStatus(registration, operation, status);
    return collected;
}

} // namespace Host
