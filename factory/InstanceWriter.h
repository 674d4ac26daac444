// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cmpidt.h>
#include <cmpift.h>

#include <cstdint>
#include <string>
#include <vector>

namespace Vorn::SensorProfileProvider {

// Sets properties of one instance, each with its CMPI type. An object manager may copy a whole
// CMPIValue from the address that it is passed, whatever the type: all values but texts are whole.
// The status of a setting is ignored: a property that the broker refuses is absent.
class InstanceWriter {
public:
    // REQUIRES: the instance is usable and outlives the writer.
    InstanceWriter(const CMPIBroker* broker, const CMPIInstance* instance)
        : broker_(broker), instance_(instance)
    {
    }

    void setText(const char* name, const std::string& text) const;
    void setCode(const char* name, std::uint16_t code) const;
    void setNumber(const char* name, std::int32_t number) const;
    void setFlag(const char* name, bool flag) const;

    // Sets an array, also an empty one. Returns false, without the property, when the broker makes
    // no array. `rc` is passed on to the broker.
    bool setCodes(const char* name, const std::vector<std::uint16_t>& codes, CMPIStatus* rc) const;

    // Sets an array of texts as setCodes() does one of codes. An element stays empty when the
    // broker cannot make its string. REQUIRES: rc is not null.
    bool setTexts(const char* name, const std::vector<std::string>& texts, CMPIStatus* rc) const;

private:
    const CMPIBroker* broker_;
    const CMPIInstance* instance_;
};

} // namespace Vorn::SensorProfileProvider
