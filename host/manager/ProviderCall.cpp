// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/manager/ProviderCall.h"

#include "host/manager/ProviderLibrary.h"

namespace Host {

namespace {

thread_local unsigned depth = 0;

} // namespace

CallDepth::CallDepth(const ProviderRegistration& registration)
{
    if (depth == maximum)
        throw Refusal(CMPI_RC_ERR_FAILED, registration.providerName + " is not asked: more than " +
                                              std::to_string(maximum) +
                                              " provider calls stand in one another");
    ++depth;
}

CallDepth::~CallDepth()
{
    --depth;
}

const CMPIObjectPath* targetOf(const ObjectPath& path, const std::string& className)
{
    ObjectPath& target = path.copiedTo(Arena::required());
    target.setClassName(className.c_str());
    return target.handle();
}

void checkStatus(
    const ProviderRegistration& registration, const char* operation, const CMPIStatus& status)
{
    if (status.rc == CMPI_RC_OK)
        return;
    std::string message = messageOf(status);
    if (message.empty() && status.rc == CMPI_RC_ERR_NOT_SUPPORTED)
        message = registration.providerName + " does not support " + operation + " of " +
                  registration.className;
    else if (message.empty())
        message = registration.providerName + " answers " + describe(status);
    throw Refusal(status.rc, message);
}

} // namespace Host
