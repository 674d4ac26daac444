// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// What the handlers of the two association providers share.

#pragma once

#include "factory/BrokerCalls.h"
#include "factory/ClassNames.h"
#include "factory/SensorFactory.h"
#include "providers/RequestHandler.h"

#include <cmpidt.h>
#include <cmpimacs.h>

#include <array>
#include <vector>

namespace Vorn::SensorProfileProvider {

// Whether a request wants objects or only their paths.
enum class Answer { instances, paths };

// One end of an association: the reference property and what it refers to.
struct Reference {
    const char* role;
    const CMPIObjectPath* path;
};
using References = std::array<Reference, 2>;

// What one association class differs in from another.
struct AssociationClass {
    TraceModule module;
    const char* provider; // the component of broker trace messages
    const char* name;
    bool isCap; // needs capabilities besides sensors
    // The references of one association, in the order they are published in.
    References (*pair)(const CMPIObjectPath* sensor, const CMPIObjectPath* other);
};

// How one failure reads for the client, in the broker's trace and in a message line.
struct FailureTexts {
    const char* status;
    const char* trace;
    const char* message; // null for no message line
};

// The message lines of fetches that failed.
inline constexpr const char* sensorsFailed = "getAllSensorCMPIInstances failed";
inline constexpr const char* sensorPathsFailed = "getAllSensorCMPIObjPaths failed";
inline constexpr const char* capabilitiesPathsFailed =
    "getAllSensorEnabledLogicalElementCapCMPIObjPaths failed";

// What came of fetching one end's objects.
struct FetchFailure {
    const char* text; // of the message line; null when all went well
    bool hasExitMark = true;
};

// One request to an association provider: its broker, its marks and how it reports failures. The
// trace lines it writes carry the caller's line.
class AssociationRequest {
public:
    // Writes the entry mark of the function.
    AssociationRequest(const AssociationClass& served, const CMPIBroker* broker,
        const char* function, unsigned line = __builtin_LINE())
        : served_(served), broker_(broker), marks_(served.module, function)
    {
        marks_.entry(line);
    }

    const AssociationClass& served() const { return served_; }
    const CMPIBroker* broker() const { return broker_; }
    const HandlerMarks& marks() const { return marks_; }

    void fail(const FailureTexts& texts, CMPIStatus* status, unsigned line = __builtin_LINE()) const
    {
        reportFailure(broker_, status, served_.provider, texts.status, texts.trace);
        if (texts.message)
            marks_.failure(texts.message, line);
    }

    // What the source's class has no far end in this association is answered with.
    void failWithoutTarget(
        const char* text, CMPIStatus* status, unsigned line = __builtin_LINE()) const;

    // Finds the instance of the request's path among all that `build(instances)` makes (0 for
    // success), and ends the request.
    template <typename Build>
    CMPIStatus getInstance(const CMPIResult* rslt, const CMPIObjectPath* op, const Build& build,
        unsigned line = __builtin_LINE()) const
    {
        CMPIStatus status = {CMPI_RC_OK, nullptr};
        std::vector<CMPIInstance*> instances;
        if (keyCountOf(op, &status) == 0)
            fail({noKeyPassed, noKeyPassed, noKeyPassed}, &status, line);
        else if (build(instances) == 0)
            returnInstanceAt(rslt, op, instances, true, nullptr);
        marks_.exit(line);
        CMReturnDone(rslt);
        return status;
    }

    // Hands over all that `build(instances)` makes, and ends the request: well, whatever comes
    // of the building.
    template <typename Build>
    CMPIStatus enumerateInstances(
        const CMPIResult* rslt, const Build& build, unsigned line = __builtin_LINE()) const
    {
        std::vector<CMPIInstance*> instances;
        if (build(instances) == 0)
            returnInstances(rslt, instances);
        marks_.exit(line);
        CMReturnDone(rslt);
        return {CMPI_RC_OK, nullptr};
    }

    // The paths of all sensors.
    FetchFailure fetchSensorPaths(SensorFactory& factory, const CMPIObjectPath* op,
        std::vector<CMPIObjectPath*>& paths, CMPIStatus* status) const
    {
        return {factory.getAllSensorCMPIObjPaths(broker_, op, paths, status) ? sensorPathsFailed
                                                                             : nullptr};
    }

    // Hands over one association for each far end, with the source at its other end, and ends
    // the request. `fetch(factory, target, leadsToSensors, farEnds, status)` finds the far ends;
    // it returns its FetchFailure. `withoutTarget` is the failure of a source whose class has no
    // far end.
    template <typename Fetch>
    CMPIStatus references(Answer answer, const CMPIResult* rslt, const CMPIObjectPath* op,
        const char* withoutTarget, const Fetch& fetch, unsigned line = __builtin_LINE()) const
    {
        CMPIStatus status = {CMPI_RC_OK, nullptr};
        SensorFactory factory(true, served_.isCap);
        std::vector<CMPIObjectPath*> farEnds;
        farEnds.reserve(factory.getNumberOfInstances());
        const CMPIObjectPath* const target = SensorFactory::get_assoc_targetClass_ObjectPath(
            broker_, op, served_.name, nullptr, &status);
        if (!isUsable(target)) {
            failWithoutTarget(withoutTarget, &status, line);
            return status;
        }
        if (const CMPIObjectPath* const path = newPath(broker_, op, served_.name, &status)) {
            // Asked once: a broker that answers differently later would turn the pairs round.
            const bool leadsToSensors = isOfClass(target, SensorClass, &status);
            const FetchFailure failure = fetch(factory, target, leadsToSensors, farEnds, &status);
            if (failure.text == nullptr)
                returnReferences(answer, rslt, op, path, leadsToSensors, farEnds, &status);
            else
                marks_.failure(failure.text, line);
            if (!failure.hasExitMark)
                return status;
        }
        marks_.exit(line);
        return status;
    }

private:
    // What the broker could not make is left out.
    void returnReferences(Answer answer, const CMPIResult* rslt, const CMPIObjectPath* op,
        const CMPIObjectPath* path, bool leadsToSensors,
        const std::vector<CMPIObjectPath*>& farEnds, CMPIStatus* status) const;

    AssociationClass served_;
    const CMPIBroker* broker_;
    HandlerMarks marks_;
};

// The association class that a request for associated objects names; the provider's own where
// the object manager hands over none.
inline const char* namedOrOwn(const char* assocClass, const char* own)
{
    return assocClass ? assocClass : own;
}

void addReferenceKeys(const CMPIObjectPath* path, const References& references);

// An instance at the path, with its references as properties. `properties` and `keys` are its
// filter; no filter when `keys` is null. Null, or the handle-less instance the broker returned,
// when there is none.
CMPIInstance* newAssociation(const CMPIBroker* broker, const CMPIObjectPath* path,
    const References& references, const char** properties, const char** keys);

// Visits the elements of an up-call's answer until there are no more, `visit` returns false or
// the broker fails: then the result is false and its status stands in `status`. No answer has no
// elements.
template <typename Visit>
bool forEachElement(const CMPIEnumeration* elements, CMPIStatus* status, const Visit& visit)
{
    if (!isUsable(elements))
        return true;
    CMPIStatus step = {CMPI_RC_OK, nullptr};
    while (CMHasNext(elements, &step) && step.rc == CMPI_RC_OK) {
        const CMPIData element = CMGetNext(elements, &step);
        if (step.rc != CMPI_RC_OK || !visit(element))
            break;
    }
    if (step.rc == CMPI_RC_OK)
        return true;
    *status = step;
    return false;
}

// The path or the instance of an element; null when it is none.
CMPIObjectPath* pathOf(const CMPIData& element);
CMPIInstance* instanceOf(const CMPIData& element);

} // namespace Vorn::SensorProfileProvider
