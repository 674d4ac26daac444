// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// A broker with a request in progress, and functions that tests of its objects share.

#pragma once

#include "host/broker/Broker.h"
#include "host/broker/ObjectPath.h"
#include "host/broker/Request.h"

#include <cmpidt.h>
#include <cmpift.h>
#include <cmpimacs.h>

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <string>

namespace HostTests {

constexpr CMPIValueState absentState = CMPI_nullValue | CMPI_notFound;

inline std::string textOf(const CMPIString* string)
{
    const char* const text = string->ft->getCharPtr(string, nullptr);
    return text == nullptr ? "(null)" : text;
}

// Returns the text of a key, property or element.
inline std::string textOf(const CMPIData& data)
{
    return data.type == CMPI_string && (data.state & CMPI_nullValue) == 0
               ? textOf(data.value.string)
               : "(no text)";
}

class BrokerTest : public testing::Test {
protected:
    CMPIString* string(const char* text) { return CMNewString(mb, text, nullptr); }
    CMPIObjectPath* path(const char* className = "Test_Class")
    {
        return CMNewObjectPath(mb, "root/cimv2", className, nullptr);
    }
    CMPIInstance* instance(const char* className = "Test_Class")
    {
        return CMNewInstance(mb, path(className), nullptr);
    }
    // Returns an array of CMPI_uint16.
    CMPIArray* array(std::initializer_list<CMPIUint16> numbers)
    {
        CMPIArray* const made =
            CMNewArray(mb, static_cast<CMPICount>(numbers.size()), CMPI_uint16, nullptr);
        CMPICount position = 0;
        for (const CMPIUint16 number : numbers)
            CMSetArrayElementAt(made, position++, &number, CMPI_uint16);
        return made;
    }

    Host::Broker broker;
    const CMPIBroker* mb = broker.handle();
    Host::Request request{broker};
    CMPIStatus rc{CMPI_RC_OK, nullptr};
};

} // namespace HostTests
