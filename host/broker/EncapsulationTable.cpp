// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/broker/Array.h"
#include "host/broker/Broker.h"
#include "host/broker/ClassInformation.h"
#include "host/broker/Instance.h"
#include "host/broker/Messages.h"
#include "host/broker/Names.h"
#include "host/broker/ObjectPath.h"
#include "host/broker/Slot.h"
#include "host/broker/String.h"
#include "host/broker/Tables.h"

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

String& newString(const Broker&, const char* text)
{
    return String::make(Arena::required(), requiredText(text, "the text"));
}

Array& newArray(const Broker&, CMPICount size, CMPIType type)
{
    return Array::make(Arena::required(), type, size);
}

bool classPathIsA(const Broker& broker, const CMPIObjectPath* path, const char* className)
{
    const auto& object = required<ObjectPath>(path);
    const std::string_view wanted = requiredText(className, "the class name");
    const ClassInformation* const classes = broker.classInformation();
    return equalNames(object.className(), wanted) ||
           (classes != nullptr &&
               classes->isDerivedFrom(object.nameSpace(), object.className(), wanted));
}

} // namespace

const CMPIBrokerEncFT encapsulationFunctions = {
    .ftVersion = CMPIVersion200,
    .newInstance = slot<&newInstance>,
    .newObjectPath = slot<&newObjectPath>,
    .newArgs = notOffered,
    .newString = slot<&newString>,
    .newArray = slot<&newArray>,
    .newDateTime = notOffered,
    .newDateTimeFromBinary = notOffered,
    .newDateTimeFromChars = notOffered,
    .newSelectExp = notOffered,
    .classPathIsA = slot<&classPathIsA>,
    .toString = notOffered,
    .isOfType = notOffered,
    .getType = notOffered,
    .getMessage = notOffered,
    .logMessage = notOffered,
    .trace = slot<&traceMessage>,
    .newCMPIError = notOffered,
    .openMessageFile = notOffered,
    .closeMessageFile = notOffered,
    .getMessage2 = notOffered,
};

} // namespace Host
