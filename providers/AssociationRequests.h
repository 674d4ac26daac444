// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The common parts of the requests of the two association providers.

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

// Whether a request returns objects or only their paths.
enum class ResultKind { instances, paths };

// One end of an association: the name of the reference property and its value, which is whole,
// since an object manager may copy it without regard to its type.
struct Reference {
    const char* role;
    CMPIValue path;
};
using References = std::array<Reference, 2>;

// A CMPIValue cannot hold a const path; the broker copies the path.
inline Reference referenceTo(const char* role, const CMPIObjectPath* path)
{
    return {role, {.ref = const_cast<CMPIObjectPath*>(path)}};
}

// The properties of an association class that its requests depend on.
struct AssociationClass {
    TraceModule module;
    const char* provider; // the component of broker trace messages
    const char* name;
    bool isCap; // needs capabilities besides sensors
    // Returns the references of one association in the order in which they are set.
    References (*pair)(const CMPIObjectPath* sensor, const CMPIObjectPath* other);
};

// The texts of one failure in the status, in the broker's trace and in a message line.
struct FailureTexts {
    const char* status;
    const char* trace;
    const char* message; // null for no message line
};

// The message lines of failed enumerations.
inline constexpr const char* sensorsFailed = "getAllSensorCMPIInstances failed";
inline constexpr const char* sensorPathsFailed = "getAllSensorCMPIObjPaths failed";
inline constexpr const char* capabilitiesPathsFailed =
    "getAllSensorEnabledLogicalElementCapCMPIObjPaths failed";

// The failure of enumerating the objects of one end, if there was one.
struct FetchFailure {
    const char* text; // of the message line; null on success
    bool hasExitMark = true;
};

// One request to an association provider. It holds the broker, writes the marks and reports
// failures. The trace lines carry the line of the call.
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

    // Reports that the class of the source has no far end in this association, and ends the
    // request.
    void failWithoutTarget(
        const char* text, CMPIStatus* status, unsigned line = __builtin_LINE()) const;

    // Returns the instance at the request's path to the object manager, if it is among those that
    // `build(instances)` appends (it returns 0 on success), and ends the request.
    template <typename Build>
    CMPIStatus getInstance(const CMPIResult* rslt, const CMPIObjectPath* op, const Build& build,
        unsigned line = __builtin_LINE()) const
    {
        CMPIStatus status = {CMPI_RC_OK, nullptr};
        std::vector<CMPIInstance*> instances;
        if (keyCountOf(op, nullptr) == 0)
            fail({noKeyPassed, noKeyPassed, noKeyPassed}, &status, line);
        else if (build(instances) == 0)
            returnInstanceAt(rslt, op, instances, true, nullptr);
        marks_.exit(line);
        CMReturnDone(rslt);
        return status;
    }

    // Returns all instances that `build(instances)` appends to the object manager, and ends the
    // request with status OK, also when building fails.
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

    // Appends the paths of all sensors.
    FetchFailure fetchSensorPaths(SensorFactory& factory, const CMPIObjectPath* op,
        std::vector<CMPIObjectPath*>& paths, CMPIStatus* status) const
    {
        return {factory.getAllSensorCMPIObjPaths(broker_, op, paths, status) ? sensorPathsFailed
                                                                             : nullptr};
    }

    // Returns one association of the source with each far end to the object manager, and ends the
    // request. `fetch(factory, target, leadsToSensors, farEnds, status)` appends the far ends and
    // returns a FetchFailure. `withoutTarget` is the failure text for a source whose class has no
    // far end.
    template <typename Fetch>
    CMPIStatus references(ResultKind kind, const CMPIResult* rslt, const CMPIObjectPath* op,
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
        if (const CMPIObjectPath* const path =
                newPath(broker_, op, served_.name, factory.systemName(), &status)) {
            // Evaluated once, since a different answer later would swap the ends of the pairs.
            const bool leadsToSensors = isExactlyOfClass(target, SensorClass);
            const FetchFailure failure = fetch(factory, target, leadsToSensors, farEnds, &status);
            if (failure.text == nullptr)
                returnReferences(kind, rslt, op, path, leadsToSensors, farEnds);
            else
                marks_.failure(failure.text, line);
            if (!failure.hasExitMark)
                return status;
        }
        marks_.exit(line);
        return status;
    }

private:
    // Omits associations that the broker cannot make.
    void returnReferences(ResultKind kind, const CMPIResult* rslt, const CMPIObjectPath* op,
        const CMPIObjectPath* path, bool leadsToSensors,
        const std::vector<CMPIObjectPath*>& farEnds) const;

    AssociationClass served_;
    const CMPIBroker* broker_;
    HandlerMarks marks_;
};

// Returns the association class of a request for associated objects; an object manager that passes
// none means the provider's own.
inline const char* namedOrOwn(const char* assocClass, const char* own)
{
    return assocClass ? assocClass : own;
}

void addReferenceKeys(const CMPIObjectPath* path, const References& references);

// Makes an instance at the path with the references as properties. `properties` and `keys` are its
// property filter; there is none when `keys` is null. Returns the result of the broker even if it
// is not usable.
CMPIInstance* newAssociation(const CMPIBroker* broker, const CMPIObjectPath* path,
    const References& references, const char** properties, const char** keys);

// Visits the elements of an enumeration until `visit` returns false. Returns false, with the
// broker's status in `status`, when the broker fails. An unusable enumeration counts as empty.
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

// Return the path or the instance of an element, or null when it is of another type or not usable.
// The state of an element is ignored, since brokers differ in it.
CMPIObjectPath* pathOf(const CMPIData& element);
CMPIInstance* instanceOf(const CMPIData& element);

} // namespace Vorn::SensorProfileProvider
