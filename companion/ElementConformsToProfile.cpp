// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The provider of ZUMLO_SensorElementConformsToProfile, which associates the registration of the
// profile with each sensor. This is DSP1033's methodology of central classes, which needs no
// registration of the profile that sensors are scoped by. The ends are in different namespaces; as
// DSP1033 requires, the association is in both.

#include "companion/Conformance.h"
#include "companion/RegisteredProfile.h"
#include "companion/ResultWriter.h"
#include "platform/utilities/KeyValue.h"
#include "platform/utilities/ProviderUtilities.h"

#include <array>
#include <atomic>

namespace Vorn::Companion {

namespace {

constexpr const char* ConformsClass = "ZUMLO_SensorElementConformsToProfile";

// These are the names of the references.
constexpr const char* standardRole = "ConformantStandard";
constexpr const char* elementRole = "ManagedElement";

// Some object managers call the factories again while requests run.
std::atomic<const CMPIBroker*> theBroker = nullptr;

enum class ResultKind { instances, paths };

// The filters of an association operation (DSP0200, Associators) are null or empty where the client
// set none.
struct Filters {
    const char* associationClass = nullptr;
    const char* resultClass = nullptr;
    const char* role = nullptr;
    const char* resultRole = nullptr;
};

bool isUnset(const char* filter)
{
    return filter == nullptr || *filter == '\0';
}

bool admits(const char* filter, const char* name)
{
    return isUnset(filter) || isSameName(name, filter);
}

// Answers one request to the provider.
class ConformanceRequest {
public:
    ConformanceRequest(const CMPIBroker* broker, const CMPIContext* context,
        const CMPIResult* result, const CMPIObjectPath* target, ResultKind kind,
        const char** properties)
        : broker_(broker), target_(target), kind_(kind), properties_(properties),
          upcalls_(broker, context), result_(broker, result)
    {
    }

    CMPIStatus enumerate()
    {
        addAssociations(wholeConformance(upcalls_));
        return result_.finish();
    }

    CMPIStatus get()
    {
        Conformance found = wholeConformance(upcalls_);
        const CMPIObjectPath* const element = targetReference(elementRole);
        std::erase_if(found.sensors,
            [&](const CMPIObjectPath* sensor) { return !isObjPathsEqual(sensor, element, false); });
        if (found.sensors.empty() || CMGetKeyCount(target_, nullptr) != 2 ||
            !isObjPathsEqual(found.profile, targetReference(standardRole), false))
            return failure(broker_, CMPI_RC_ERR_NOT_FOUND, "no such conformance");
        addAssociations(found);
        return result_.finish();
    }

    CMPIStatus references(const Filters& filters)
    {
        if (isNear(filters))
            addAssociations(conformanceOf(upcalls_, target_));
        return result_.finish();
    }

    CMPIStatus associators(const Filters& filters)
    {
        if (!isNear(filters) ||
            !admits(filters.resultRole, isFromProfile_ ? elementRole : standardRole))
            return result_.finish();
        if (!isFromProfile_)
            addProfile(filters.resultClass);
        else if (kind_ == ResultKind::paths)
            addSensors(conformanceOf(upcalls_, target_).sensors, filters.resultClass);
        else
            addSensors(conformingSensors(upcalls_, target_, properties_), filters.resultClass);
        return result_.finish();
    }

private:
    // Returns whether the filters admit the association from the target.
    bool isNear(const Filters& filters) const
    {
        return admits(filters.role, isFromProfile_ ? standardRole : elementRole) &&
               (isUnset(filters.associationClass) ||
                   isOfAdmittedClass(newAssociationPath(), filters.associationClass));
    }

    // Returns whether the class of the path is that of the filter, or below it. The object manager
    // has the superclasses.
    bool isOfAdmittedClass(const CMPIObjectPath* path, const char* filter) const
    {
        return isUnset(filter) ||
               (isUsable(path) && CMClassPathIsA(broker_, path, filter, nullptr) != 0);
    }

    // Returns the reference that is a key of the target; null when there is none.
    const CMPIObjectPath* targetReference(const char* role) const
    {
        if (!isUsable(target_))
            return nullptr;
        const KeyValue value = keyValue(CMGetKey(target_, role, nullptr));
        const auto* const reference = std::get_if<const CMPIObjectPath*>(&value);
        return reference == nullptr ? nullptr : *reference;
    }

    const CMPIObjectPath* newAssociationPath() const
    {
        return newPathIn(broker_, nameSpaceOf(target_), ConformsClass, systemName_);
    }

    const CMPIObjectPath* associationPath(
        const CMPIObjectPath* profile, const CMPIObjectPath* sensor) const
    {
        const CMPIObjectPath* const path = newAssociationPath();
        const bool isWhole =
            addKey(path, standardRole, profile) && addKey(path, elementRole, sensor);
        return isWhole ? path : nullptr;
    }

    const CMPIInstance* association(
        const CMPIObjectPath* profile, const CMPIObjectPath* sensor) const
    {
        const CMPIObjectPath* const path = newAssociationPath();
        const CMPIInstance* const instance =
            path == nullptr ? nullptr : CMNewInstance(broker_, path, nullptr);
        if (!isUsable(instance))
            return nullptr;
        std::array<const char*, 3> keys = {standardRole, elementRole, nullptr};
        CMSetPropertyFilter(instance, properties_, keys.data());
        const bool isWhole = setReference(instance, standardRole, profile) &&
                             setReference(instance, elementRole, sensor);
        return isWhole ? instance : nullptr;
    }

    void addAssociations(const Conformance& found)
    {
        for (const CMPIObjectPath* const sensor : found.sensors)
            if (kind_ == ResultKind::paths)
                result_.add(associationPath(found.profile, sensor));
            else
                result_.add(association(found.profile, sensor));
    }

    void addProfile(const char* resultClass)
    {
        const Conformance found = conformanceOf(upcalls_, target_);
        if (found.sensors.empty() || !isOfAdmittedClass(found.profile, resultClass))
            return;
        if (kind_ == ResultKind::paths)
            result_.add(found.profile);
        else
            result_.add(makeProfileInstance(broker_, found.profile, properties_));
    }

    // All sensors are of one class.
    template <typename Sensor>
    void addSensors(const std::vector<Sensor*>& sensors, const char* resultClass)
    {
        if (sensors.empty() || !isOfAdmittedClass(pathOf(sensors.front()), resultClass))
            return;
        for (const Sensor* const sensor : sensors)
            result_.add(sensor);
    }

    static const CMPIObjectPath* pathOf(const CMPIObjectPath* path) { return path; }
    static const CMPIObjectPath* pathOf(const CMPIInstance* instance)
    {
        return CMGetObjectPath(instance, nullptr);
    }

    const CMPIBroker* broker_;
    const CMPIObjectPath* target_;
    ResultKind kind_;
    const char** properties_;
    const bool isFromProfile_ = isOfClass(target_, RegisteredProfileClass);
    const std::string systemName_ = getSystemName();
    ProviderUpcalls upcalls_;
    ResultWriter result_;
};

// Calls `work` with a request.
template <typename Work>
CMPIStatus serve(const CMPIContext* context, const CMPIResult* result, const CMPIObjectPath* target,
    ResultKind kind, const char** properties, const Work& work)
{
    const CMPIBroker* const broker = theBroker;
    return guarded(broker, [&] {
        ConformanceRequest request(broker, context, result, target, kind, properties);
        return work(request);
    });
}

CMPIStatus enumerateNames(CMPIInstanceMI*, const CMPIContext* context, const CMPIResult* result,
    const CMPIObjectPath* target)
{
    return serve(context, result, target, ResultKind::paths, nullptr,
        [](ConformanceRequest& request) { return request.enumerate(); });
}

CMPIStatus enumerate(CMPIInstanceMI*, const CMPIContext* context, const CMPIResult* result,
    const CMPIObjectPath* target, const char** properties)
{
    return serve(context, result, target, ResultKind::instances, properties,
        [](ConformanceRequest& request) { return request.enumerate(); });
}

CMPIStatus get(CMPIInstanceMI*, const CMPIContext* context, const CMPIResult* result,
    const CMPIObjectPath* target, const char** properties)
{
    return serve(context, result, target, ResultKind::instances, properties,
        [](ConformanceRequest& request) { return request.get(); });
}

CMPIStatus associators(CMPIAssociationMI*, const CMPIContext* context, const CMPIResult* result,
    const CMPIObjectPath* target, const char* associationClass, const char* resultClass,
    const char* role, const char* resultRole, const char** properties)
{
    return serve(context, result, target, ResultKind::instances, properties,
        [&](ConformanceRequest& request) {
            return request.associators({associationClass, resultClass, role, resultRole});
        });
}

CMPIStatus associatorNames(CMPIAssociationMI*, const CMPIContext* context, const CMPIResult* result,
    const CMPIObjectPath* target, const char* associationClass, const char* resultClass,
    const char* role, const char* resultRole)
{
    return serve(
        context, result, target, ResultKind::paths, nullptr, [&](ConformanceRequest& request) {
            return request.associators({associationClass, resultClass, role, resultRole});
        });
}

CMPIStatus references(CMPIAssociationMI*, const CMPIContext* context, const CMPIResult* result,
    const CMPIObjectPath* target, const char* associationClass, const char* role,
    const char** properties)
{
    return serve(context, result, target, ResultKind::instances, properties,
        [&](ConformanceRequest& request) {
            return request.references({.associationClass = associationClass, .role = role});
        });
}

CMPIStatus referenceNames(CMPIAssociationMI*, const CMPIContext* context, const CMPIResult* result,
    const CMPIObjectPath* target, const char* associationClass, const char* role)
{
    return serve(
        context, result, target, ResultKind::paths, nullptr, [&](ConformanceRequest& request) {
            return request.references({.associationClass = associationClass, .role = role});
        });
}

constexpr CMPIInstanceMIFT instanceHandlers = instanceTable(
    "instanceSensorElementConformsToProfileProvider", {enumerateNames, enumerate, get});

constexpr CMPIAssociationMIFT associationHandlers = {
    .ftVersion = 200,
    .miVersion = 200,
    .miName = "associationSensorElementConformsToProfileProvider",
    .cleanup = [](auto...) { return okStatus; },
    .associators = associators,
    .associatorNames = associatorNames,
    .references = references,
    .referenceNames = referenceNames,
};

CMPIInstanceMI instanceMI = {nullptr, &instanceHandlers};
CMPIAssociationMI associationMI = {nullptr, &associationHandlers};

} // namespace

extern "C" [[gnu::visibility("default")]] CMPIInstanceMI*
SensorElementConformsToProfileProvider_Create_InstanceMI(
    const CMPIBroker* broker, const CMPIContext*, CMPIStatus* status)
{
    return createdWith(broker, status, theBroker, instanceMI);
}

extern "C" [[gnu::visibility("default")]] CMPIAssociationMI*
SensorElementConformsToProfileProvider_Create_AssociationMI(
    const CMPIBroker* broker, const CMPIContext*, CMPIStatus* status)
{
    return createdWith(broker, status, theBroker, associationMI);
}

} // namespace Vorn::Companion
