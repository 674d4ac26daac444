// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tests/host/manager/OddProvider.h"

#include <cmpidt.h>
#include <cmpift.h>

namespace {

Testing::OddProviderReport report;

CMPIStatus countCleanup(const CMPIContext* context, CMPIrc answer)
{
    ++report.cleanedUp;
    if (context != nullptr && context->hdl != nullptr)
        ++report.cleanedUpWithContext;
    return {answer, nullptr};
}

CMPIStatus leave(CMPIInstanceMI*, const CMPIContext* context, CMPIBoolean)
{
    return countCleanup(context, CMPI_RC_OK);
}

CMPIStatus leaveAssociation(CMPIAssociationMI*, const CMPIContext* context, CMPIBoolean)
{
    return countCleanup(context, CMPI_RC_OK);
}

CMPIStatus stay(CMPIInstanceMI*, const CMPIContext* context, CMPIBoolean)
{
    return countCleanup(context, CMPI_RC_NEVER_UNLOAD);
}

template <typename Table, typename Cleanup>
Table tableWith(CMPIVersion version, Cleanup cleanup)
{
    Table table{};
    table.ftVersion = version;
    table.cleanup = cleanup;
    return table;
}

template <typename MI, typename Table>
MI* made(MI& mi, const Table& table)
{
    ++report.created;
    mi.ft = &table;
    return &mi;
}

} // namespace

extern "C" {

[[gnu::visibility("default")]] const Testing::OddProviderReport* oddProviderReport()
{
    return &report;
}

// Calls up while it is made and reports what it is told.
[[gnu::visibility("default")]] CMPIInstanceMI* Calling_Create_InstanceMI(
    const CMPIBroker* broker, const CMPIContext* context, CMPIStatus*)
{
    static CMPIInstanceMI mi{};
    static const auto table = tableWith<CMPIInstanceMIFT>(200, leave);
    CMPIStatus status{CMPI_RC_OK, nullptr};
    broker->bft->enumerateInstanceNames(
        broker, context, broker->eft->newObjectPath(broker, "root/cimv2", "Box", nullptr), &status);
    report.upcall = status.rc;
    return made(mi, table);
}

[[gnu::visibility("default")]] CMPIInstanceMI* Leaving_Create_InstanceMI(
    const CMPIBroker*, const CMPIContext*, CMPIStatus*)
{
    static CMPIInstanceMI mi{};
    static const auto table = tableWith<CMPIInstanceMIFT>(200, leave);
    return made(mi, table);
}

[[gnu::visibility("default")]] CMPIAssociationMI* Leaving_Create_AssociationMI(
    const CMPIBroker*, const CMPIContext*, CMPIStatus*)
{
    static CMPIAssociationMI mi{};
    static const auto table = tableWith<CMPIAssociationMIFT>(200, leaveAssociation);
    return made(mi, table);
}

[[gnu::visibility("default")]] CMPIInstanceMI* Staying_Create_InstanceMI(
    const CMPIBroker*, const CMPIContext*, CMPIStatus*)
{
    static CMPIInstanceMI mi{};
    static const auto table = tableWith<CMPIInstanceMIFT>(200, stay);
    return made(mi, table);
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
    static CMPIInstanceMI mi{};
    static const auto table = tableWith<CMPIInstanceMIFT>(86, leave);
    return made(mi, table);
}

} // extern "C"
