// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The providers of this library share the table of a read-only instance provider, the body of their
// factory functions and the conversion of exceptions to a status.

#pragma once

#include "companion/BrokerObjects.h"

#include <cmpimacs.h>

#include <atomic>
#include <exception>
#include <stdexcept>
#include <string>

namespace Vorn::Companion {

inline constexpr CMPIStatus okStatus = {CMPI_RC_OK, nullptr};
inline constexpr CMPIStatus notSupported = {CMPI_RC_ERR_NOT_SUPPORTED, nullptr};

// Ends a request with a status of this code and message.
class RequestFailure : public std::runtime_error {
public:
    RequestFailure(CMPIrc code, const std::string& message)
        : std::runtime_error(message), code_(code)
    {
    }

    CMPIrc code() const noexcept { return code_; }

private:
    CMPIrc code_;
};

// An instance provider that only reads has these functions.
struct InstanceReaders {
    decltype(CMPIInstanceMIFT::enumerateInstanceNames) enumerateNames;
    decltype(CMPIInstanceMIFT::enumerateInstances) enumerate;
    decltype(CMPIInstanceMIFT::getInstance) get;
};

// Returns the table of an instance provider to which all other operations are not supported.
constexpr CMPIInstanceMIFT instanceTable(const char* name, const InstanceReaders& readers)
{
    return {
        .ftVersion = 200,
        .miVersion = 200,
        .miName = name,
        .cleanup = [](auto...) { return okStatus; },
        .enumerateInstanceNames = readers.enumerateNames,
        .enumerateInstances = readers.enumerate,
        .getInstance = readers.get,
        .createInstance = [](auto...) { return notSupported; },
        .modifyInstance = [](auto...) { return notSupported; },
        .deleteInstance = [](auto...) { return notSupported; },
        .execQuery = [](auto...) { return notSupported; },
    };
}

// Implements a factory function: stores the broker and returns the record, or null without a
// broker.
template <typename Record>
Record* createdWith(const CMPIBroker* broker, CMPIStatus* status,
    std::atomic<const CMPIBroker*>& kept, Record& record)
{
    if (broker == nullptr) {
        CMSetStatus(status, CMPI_RC_ERR_INVALID_PARAMETER);
        return nullptr;
    }
    kept = broker;
    return &record;
}

// Returns the status with a message, or without one where the broker fails to make it.
inline CMPIStatus failure(const CMPIBroker* broker, CMPIrc code, const char* message)
{
    CMPIString* const string = CMNewString(broker, message, nullptr);
    return {code, isUsable(string) ? string : nullptr};
}

// Returns the status of `work`. Exceptions become a status, since CMPI has none: RequestFailure
// that of its code, others CMPI_RC_ERR_FAILED.
template <typename Work>
CMPIStatus guarded(const CMPIBroker* broker, const Work& work)
{
    try {
        return work();
    } catch (const RequestFailure& error) {
        return failure(broker, error.code(), error.what());
    } catch (const std::exception& error) {
        return failure(broker, CMPI_RC_ERR_FAILED, error.what());
    }
}

} // namespace Vorn::Companion
