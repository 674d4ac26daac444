// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/utilities/ObjectAccess.h"

#include <cmpimacs.h>

namespace Vorn {

const char* charactersOf(const CMPIString* string, CMPIStatus* status)
{
    // The slot is called directly: header sets differ in the arguments of the macro.
    return isUsable(string) ? string->ft->getCharPtr(string, status) : nullptr;
}

const char* nameSpaceOf(const CMPIObjectPath* path, CMPIStatus* status)
{
    return isUsable(path) ? charactersOf(CMGetNameSpace(path, status), status) : nullptr;
}

} // namespace Vorn
