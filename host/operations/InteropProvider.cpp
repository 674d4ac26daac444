// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/operations/InteropProvider.h"

#include "host/broker/Instance.h"
#include "host/broker/ObjectPath.h"
#include "host/broker/String.h"

#include <utility>

namespace Host {

namespace {

constexpr CMPIStatus success = {CMPI_RC_OK, nullptr};
constexpr const char* interopProviderName = "InteropProvider";

InteropObjects objectsOf(const CMPIInstanceMI* mi)
{
    return static_cast<const InteropProvider*>(mi->hdl)->objects();
}

std::string_view classOf(const CMPIObjectPath* path)
{
    return ObjectPath::of(path)->className();
}

CMPIStatus deliver(const Instance& object, const CMPIResult* result, const char** properties)
{
    const CMPIInstance* const copy = object.copiedTo(Arena::required()).handle();
    copy->ft->setPropertyFilter(copy, properties, nullptr);
    return result->ft->returnInstance(result, copy);
}

// Returns whether the object has the keys of the target. All keys of these classes are texts.
bool isAt(const Instance& object, const ObjectPath& target)
{
    for (const NamedValue& key : object.objectPath().keys()) {
        const Value* const expected = target.key(*key.name->text());
        if (expected == nullptr || expected->text() != key.value.text())
            return false;
    }
    return true;
}

const CMPIInstanceMIFT functions = {
    .ftVersion = CMPIVersion200,
    .miVersion = CMPIVersion200,
    .miName = interopProviderName,
    .cleanup = [](CMPIInstanceMI*, const CMPIContext*, CMPIBoolean) { return success; },
    .enumerateInstanceNames =
        [](CMPIInstanceMI* mi, const CMPIContext*, const CMPIResult* result,
            const CMPIObjectPath* target) {
            const InteropObjects objects = objectsOf(mi);
            for (const Instance* const object : objects.ofClass(classOf(target)))
                result->ft->returnObjectPath(result, object->objectPath().handle());
            return success;
        },
    .enumerateInstances =
        [](CMPIInstanceMI* mi, const CMPIContext*, const CMPIResult* result,
            const CMPIObjectPath* target, const char** properties) {
            const InteropObjects objects = objectsOf(mi);
            for (const Instance* const object : objects.ofClass(classOf(target)))
                deliver(*object, result, properties);
            return success;
        },
    .getInstance =
        [](CMPIInstanceMI* mi, const CMPIContext*, const CMPIResult* result,
            const CMPIObjectPath* target, const char** properties) {
            const InteropObjects objects = objectsOf(mi);
            for (const Instance* const object : objects.ofClass(classOf(target)))
                if (isAt(*object, *ObjectPath::of(target)))
                    deliver(*object, result, properties);
            return success;
        },
    .createInstance = nullptr, // what is left out is not supported
    .modifyInstance = nullptr,
    .deleteInstance = nullptr,
    .execQuery = nullptr,
};

} // namespace

InteropProvider::InteropProvider(const Repository& classes, HostName hostName)
    : classes_(classes), hostName_(std::move(hostName)), mi_{this, &functions}
{
}

std::vector<ProviderRegistration> InteropProvider::registrations()
{
    std::vector<ProviderRegistration> all;
    for (const char* const className : {objectManagerClass, namespaceClass})
        all.push_back({.className = className,
            .providerName = interopProviderName,
            .libraryFile = {},
            .instanceMI = &mi_});
    return all;
}

} // namespace Host
