// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tests/host/manager/OddProvider.h"

#include <cmpidt.h>
#include <cmpift.h>

#include <type_traits>

namespace {

Testing::OddProviderReport report;

// Makes a provider's management interface with a table of this version, whose cleanup answers
// with this code.
template <typename MI, CMPIVersion version = 200, CMPIrc cleanupCode = CMPI_RC_OK>
MI* make()
{
    static std::remove_const_t<std::remove_pointer_t<decltype(MI::ft)>> table{};
    table.ftVersion = version;
    table.cleanup = [](MI*, const CMPIContext* context, CMPIBoolean) {
        ++report.cleanedUp;
        if (context != nullptr && context->hdl != nullptr)
            ++report.cleanedUpWithContext;
        return CMPIStatus{cleanupCode, nullptr};
    };
    static MI mi{nullptr, &table};
    ++report.created;
    return &mi;
}

} // namespace

extern "C" {

[[gnu::visibility("default")]] const Testing::OddProviderReport* oddProviderReport()
{
    return &report;
}

// Makes an up-call in its factory and reports the returned code.
[[gnu::visibility("default")]] CMPIInstanceMI* Calling_Create_InstanceMI(
    const CMPIBroker* broker, const CMPIContext* context, CMPIStatus*)
{
    CMPIStatus status{CMPI_RC_OK, nullptr};
    broker->bft->enumerateInstanceNames(
        broker, context, broker->eft->newObjectPath(broker, "root/cimv2", "Box", nullptr), &status);
    report.upcall = status.rc;
    return make<CMPIInstanceMI>();
}

[[gnu::visibility("default")]] CMPIInstanceMI* Leaving_Create_InstanceMI(
    const CMPIBroker*, const CMPIContext*, CMPIStatus*)
{
    return make<CMPIInstanceMI>();
}

[[gnu::visibility("default")]] CMPIAssociationMI* Leaving_Create_AssociationMI(
    const CMPIBroker*, const CMPIContext*, CMPIStatus*)
{
    return make<CMPIAssociationMI>();
}

[[gnu::visibility("default")]] CMPIInstanceMI* Staying_Create_InstanceMI(
    const CMPIBroker*, const CMPIContext*, CMPIStatus*)
{
    return make<CMPIInstanceMI, 200, CMPI_RC_NEVER_UNLOAD>();
}

[[gnu::visibility("default")]] CMPIInstanceMI* Refusing_Create_InstanceMI(
    const CMPIBroker* broker, const CMPIContext*, CMPIStatus* status)
{
    status->rc = CMPI_RC_ERR_ACCESS_DENIED;
    status->msg = broker->eft->newString(broker, "not on this machine", nullptr);
    return nullptr;
}

[[gnu::visibility("default")]] CMPIInstanceMI* Empty_Create_InstanceMI(
    const CMPIBroker*, const CMPIContext*, CMPIStatus*)
{
    return nullptr;
}

[[gnu::visibility("default")]] CMPIInstanceMI* Ancient_Create_InstanceMI(
    const CMPIBroker*, const CMPIContext*, CMPIStatus*)
{
    return make<CMPIInstanceMI, 86>();
}

} // extern "C"
