// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include <cmpidt.h>
#include <cmpift.h>

#include <cstdint>
#include <string>
#include <vector>

namespace Vorn::SensorProfileProvider {

// Sets properties of one instance, each by the CMPI type it is published with. What the broker
// says of a setting is not asked: a property it refuses is simply not there.
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

    // False when the broker makes no array; the property is then left out. An empty list is an
    // empty array. `rc` goes to the broker.
    bool setCodes(const char* name, const std::vector<std::uint16_t>& codes, CMPIStatus* rc) const;

    // The same for texts. An element whose string cannot be made is left empty.
    // REQUIRES: rc is not null.
    bool setTexts(const char* name, const std::vector<std::string>& texts, CMPIStatus* rc) const;

private:
    const CMPIBroker* broker_;
    const CMPIInstance* instance_;
};

} // namespace Vorn::SensorProfileProvider
