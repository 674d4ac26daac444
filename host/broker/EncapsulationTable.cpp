// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/broker/Arguments.h"
#include "host/broker/Array.h"
#include "host/broker/Broker.h"
#include "host/broker/ClassInformation.h"
#include "host/broker/DateTime.h"
#include "host/broker/Error.h"
#include "host/broker/Instance.h"
#include "host/broker/Messages.h"
#include "host/broker/Names.h"
#include "host/broker/ObjectPath.h"
#include "host/broker/Slot.h"
#include "host/broker/String.h"
#include "host/broker/Tables.h"
#include "host/broker/Text.h"

namespace Host {

namespace {

Instance& newInstance(const Broker& broker, const CMPIObjectPath* path)
{
    return Instance::make(Arena::required(), required<ObjectPath>(path), broker.classInformation());
}

ObjectPath& newObjectPath(const Broker&, const char* nameSpace, const char* className)
{
    ObjectPath& path =
        ObjectPath::make(Arena::required(), {}, requiredText(className, "the class name"));
    path.setNameSpace(nameSpace);
    return path;
}

Arguments& newArgs(const Broker&)
{
    return Arguments::make(Arena::required());
}

String& newString(const Broker&, const char* text)
{
    return String::make(Arena::required(), requiredText(text, "the text"));
}

Array& newArray(const Broker&, CMPICount size, CMPIType type)
{
    return Array::make(Arena::required(), type, size);
}

DateTime& newDateTime(const Broker&)
{
    return DateTime::makeNow(Arena::required());
}

DateTime& newDateTimeFromBinary(const Broker&, CMPIUint64 microseconds, CMPIBoolean isInterval)
{
    return DateTime::make(Arena::required(), microseconds, isInterval != 0);
}

DateTime& newDateTimeFromChars(const Broker&, const char* text)
{
    return DateTime::parse(Arena::required(), requiredText(text, "the date-time"));
}

bool classPathIsA(const Broker& broker, const CMPIObjectPath* handle, const char* className)
{
    const ObjectPath& path = required<ObjectPath>(handle);
    const std::string_view ancestor = requiredText(className, "the class name");
    if (equalNames(path.className(), ancestor))
        return true;
    const ClassInformation* const classes = broker.classInformation();
    return classes != nullptr &&
           classes->isDerivedFrom(path.nameSpace(), path.className(), ancestor);
}

const Object& requiredObject(const void* encapsulated)
{
    if (const Object* const object = Object::behind(encapsulated))
        return *object;
    throw Refusal(CMPI_RC_ERR_INVALID_HANDLE, "no object behind the handle");
}

String& toString(const Broker&, const void* encapsulated)
{
    return String::make(Arena::required(), toText(requiredObject(encapsulated)));
}

bool isOfType(const Broker&, const void* encapsulated, const char* type)
{
    const std::string_view name = requiredText(type, "the type");
    return name == Object::typeName(requiredObject(encapsulated).kind());
}

String& getType(const Broker&, const void* encapsulated)
{
    return String::make(Arena::required(), Object::typeName(requiredObject(encapsulated).kind()));
}

// There are no message files: every message is its default text, inserts as they stand.
constexpr auto defaultText =
    &Slot<&newString>::call<CMPIString*, const CMPIBroker, const char*, CMPIStatus*>;

CMPIString* getMessage(
    const CMPIBroker* broker, const char*, const char* text, CMPIStatus* status, CMPICount, ...)
{
    return defaultText(broker, text, status);
}

CMPIString* getMessage2(const CMPIBroker* broker, const char*, const CMPIMsgFileHandle,
    const char* text, CMPIStatus* status, CMPICount, ...)
{
    return defaultText(broker, text, status);
}

Error& newError(const Broker&, const char* owner, const char* messageId, const char* message,
    CMPIErrorSeverity severity, CMPIErrorProbableCause cause, CMPIrc code)
{
    return Error::make(Arena::required(), owner, messageId, message, severity, cause, code);
}

} // namespace

const CMPIBrokerEncFT encapsulationFunctions = {
    .ftVersion = CMPIVersion200,
    .newInstance = slot<&newInstance>,
    .newObjectPath = slot<&newObjectPath>,
    .newArgs = slot<&newArgs>,
    .newString = slot<&newString>,
    .newArray = slot<&newArray>,
    .newDateTime = slot<&newDateTime>,
    .newDateTimeFromBinary = slot<&newDateTimeFromBinary>,
    .newDateTimeFromChars = slot<&newDateTimeFromChars>,
    .newSelectExp = notOffered,
    .classPathIsA = slot<&classPathIsA>,
    .toString = slot<&toString>,
    .isOfType = slot<&isOfType>,
    .getType = slot<&getType>,
    .getMessage = &getMessage,
    .logMessage = slot<&logMessage>,
    .trace = slot<&traceMessage>,
    .newCMPIError = slot<&newError>,
    .openMessageFile = notOffered,
    .closeMessageFile = notOffered,
    .getMessage2 = &getMessage2,
};

} // namespace Host
