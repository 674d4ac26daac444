// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/operations/KnownClass.h"

#include "host/broker/Refusal.h"
#include "host/repository/Repository.h"

#include <string>

namespace Host {

const ClassDeclaration& knownClass(
    const Repository& classes, std::string_view nameSpace, std::string_view className)
{
    const ClassDeclaration* const declared = classes.findClass(nameSpace, className);
    if (declared == nullptr)
        throw Refusal(CMPI_RC_ERR_INVALID_CLASS,
            "there is no class " + std::string(className) + " in " + std::string(nameSpace));
    return *declared;
}

const ClassDeclaration* findNamedClass(
    const Repository& classes, std::string_view nameSpace, std::string_view className)
{
    return className.empty() ? nullptr : &knownClass(classes, nameSpace, className);
}

} // namespace Host
