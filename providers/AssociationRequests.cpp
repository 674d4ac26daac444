// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "providers/AssociationRequests.h"

#include <string>

namespace Vorn::SensorProfileProvider {

namespace {

void returnAssociation(ResultKind kind, const CMPIResult* rslt, const CMPIObjectPath* op,
    const CMPIInstance* association)
{
    if (kind == ResultKind::instances) {
        CMReturnInstance(rslt, association);
        return;
    }
    const CMPIObjectPath* const path = CMGetObjectPath(association, nullptr);
    if (!isUsable(path))
        return;
    copyNameSpace(path, op, nullptr);
    CMReturnObjectPath(rslt, path);
}

} // namespace

void AssociationRequest::failWithoutTarget(
    const char* text, CMPIStatus* status, unsigned line) const
{
    const std::string sentence = std::string(text) + '.';
    fail({sentence.c_str(), sentence.c_str(), text}, status, line);
    marks_.exit(line);
}

void AssociationRequest::returnReferences(ResultKind kind, const CMPIResult* rslt,
    const CMPIObjectPath* op, const CMPIObjectPath* path, bool leadsToSensors,
    const std::vector<CMPIObjectPath*>& farEnds) const
{
    forEachCounted(farEnds, [&](const CMPIObjectPath* farEnd) {
        const References references =
            leadsToSensors ? served_.pair(farEnd, op) : served_.pair(op, farEnd);
        const CMPIInstance* const association =
            newAssociation(broker_, path, references, nullptr, nullptr);
        if (isUsable(association))
            returnAssociation(kind, rslt, op, association);
    });
}

void addReferenceKeys(const CMPIObjectPath* path, const References& references)
{
    for (const Reference& reference : references)
        CMAddKey(path, reference.role, &reference.path, CMPI_ref);
}

CMPIInstance* newAssociation(const CMPIBroker* broker, const CMPIObjectPath* path,
    const References& references, const char** properties, const char** keys)
{
    CMPIInstance* const instance = CMNewInstance(broker, path, nullptr);
    if (!isUsable(instance))
        return instance;
    if (keys != nullptr)
        CMSetPropertyFilter(instance, properties, keys);
    for (const Reference& reference : references)
        CMSetProperty(instance, reference.role, &reference.path, CMPI_ref);
    return instance;
}

CMPIObjectPath* pathOf(const CMPIData& element)
{
    return element.type == CMPI_ref && isUsable(element.value.ref) ? element.value.ref : nullptr;
}

CMPIInstance* instanceOf(const CMPIData& element)
{
    return element.type == CMPI_instance && isUsable(element.value.inst) ? element.value.inst
                                                                         : nullptr;
}

} // namespace Vorn::SensorProfileProvider
