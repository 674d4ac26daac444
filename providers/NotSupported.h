// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The handlers that are the same for every provider: changes and queries are not supported, and
// there is nothing to clean up. They write no trace line and do not use the result.

#pragma once

#include <cmpidt.h>
#include <cmpift.h>

namespace Vorn::SensorProfileProvider {

inline CMPIStatus notSupported()
{
    return {CMPI_RC_ERR_NOT_SUPPORTED, nullptr};
}

inline CMPIStatus createNotSupported(CMPIInstanceMI*, const CMPIContext*, const CMPIResult*,
    const CMPIObjectPath*, const CMPIInstance*)
{
    return notSupported();
}

inline CMPIStatus modifyNotSupported(CMPIInstanceMI*, const CMPIContext*, const CMPIResult*,
    const CMPIObjectPath*, const CMPIInstance*, const char**)
{
    return notSupported();
}

inline CMPIStatus deleteNotSupported(
    CMPIInstanceMI*, const CMPIContext*, const CMPIResult*, const CMPIObjectPath*)
{
    return notSupported();
}

inline CMPIStatus queryNotSupported(CMPIInstanceMI*, const CMPIContext*, const CMPIResult*,
    const CMPIObjectPath*, const char*, const char*)
{
    return notSupported();
}

inline CMPIStatus cleanUpNothing(CMPIInstanceMI*, const CMPIContext*, CMPIBoolean)
{
    return {CMPI_RC_OK, nullptr};
}

inline CMPIStatus cleanUpNoAssociation(CMPIAssociationMI*, const CMPIContext*, CMPIBoolean)
{
    return {CMPI_RC_OK, nullptr};
}

} // namespace Vorn::SensorProfileProvider
