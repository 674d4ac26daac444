// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// An instance whose properties a test sets.

#pragma once

#include "host/broker/Array.h"
#include "host/broker/Broker.h"
#include "host/broker/Instance.h"
#include "host/broker/ObjectPath.h"
#include "host/broker/Request.h"

#include <gtest/gtest.h>

#include <cstdint>
#include <initializer_list>
#include <string_view>

namespace Testing {

class InstanceTest : public ::testing::Test {
protected:
    void setText(std::string_view name, std::string_view text)
    {
        instance_.setProperty(name, Host::Value::text(request_.arena(), text));
    }
    void setCode(std::string_view name, std::uint64_t code)
    {
        instance_.setProperty(name, Host::Value::integer(CMPI_uint16, code));
    }
    void setNumber(std::string_view name, std::int64_t number)
    {
        instance_.setProperty(
            name, Host::Value::integer(CMPI_sint32, static_cast<std::uint64_t>(number)));
    }
    void setCodes(std::string_view name, std::initializer_list<std::uint64_t> codes)
    {
        Host::Array& array =
            Host::Array::make(request_.arena(), CMPI_uint16, static_cast<CMPICount>(codes.size()));
        CMPICount at = 0;
        for (const std::uint64_t code : codes)
            array.set(at++, Host::Value::integer(CMPI_uint16, code));
        instance_.setProperty(name, Host::Value::of(array));
    }

    Host::Broker broker_;
    Host::Request request_{broker_};
    Host::Instance& instance_ =
        request_.makeInstance(request_.makePath("root/cimv2", "ZUMLO_NumericSensor"));
};

} // namespace Testing
