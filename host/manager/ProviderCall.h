// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// One call of one provider, from the arguments to a status that is OK or a refusal.

#pragma once

#include "host/broker/Context.h"
#include "host/broker/ObjectPath.h"
#include "host/broker/Refusal.h"
#include "host/broker/Result.h"
#include "host/broker/ResultSink.h"
#include "host/manager/ProviderRegistration.h"

#include <exception>
#include <string>

namespace Host {

// Counts the provider calls that stand in one another on this thread while it lives.
class CallDepth {
public:
    // Providers that refer to each other need two or three levels.
    static constexpr unsigned maximum = 10;

    // Throws Refusal (CMPI_RC_ERR_FAILED) beyond the maximum: providers call up in a circle.
    explicit CallDepth(const ProviderRegistration& registration);
    ~CallDepth();
    CallDepth(const CallDepth&) = delete;
    CallDepth& operator=(const CallDepth&) = delete;
};

// The path as a provider is handed it: its own copy, with the class's name as it is declared,
// however the client spelt it.
const CMPIObjectPath* targetOf(const ObjectPath& path, const std::string& className);

// Throws Refusal with the status's code and message unless it is OK. The operation is for those
// that are not supported: what the provider would do, such as "creating instances".
void checkStatus(
    const ProviderRegistration& registration, const char* operation, const CMPIStatus& status);

// Throws Refusal when the provider leaves the function out, when it throws, and with what it
// answers unless that is OK.
template <typename MI, typename Function, typename... Arguments>
void callProvider(const ProviderRegistration& registration, const char* operation, MI& mi,
    Function function, const Context& context, ResultSink& sink, const CMPIObjectPath* target,
    Arguments... arguments)
{
    if (function == nullptr)
        checkStatus(registration, operation, {CMPI_RC_ERR_NOT_SUPPORTED, nullptr});
    const CallDepth depth(registration);
    Result result(sink);
    CMPIStatus status = {CMPI_RC_OK, nullptr};
    try {
        status = function(&mi, context.handle(), result.handle(), target, arguments...);
    } catch (const std::exception& error) {
        throw Refusal(CMPI_RC_ERR_FAILED, registration.providerName + ": " + error.what());
    }
    checkStatus(registration, operation, status);
}

} // namespace Host
