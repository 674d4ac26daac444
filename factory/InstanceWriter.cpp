// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "factory/InstanceWriter.h"

#include "factory/BrokerCalls.h"

#include <cmpimacs.h>

namespace Vorn::SensorProfileProvider {

void InstanceWriter::setText(const char* name, const std::string& text) const
{
    CMSetProperty(instance_, name, text.c_str(), CMPI_chars);
}

void InstanceWriter::setCode(const char* name, std::uint16_t code) const
{
    const CMPIValue value = {.uint16 = code};
    CMSetProperty(instance_, name, &value, CMPI_uint16);
}

void InstanceWriter::setNumber(const char* name, std::int32_t number) const
{
    const CMPIValue value = {.sint32 = number};
    CMSetProperty(instance_, name, &value, CMPI_sint32);
}

void InstanceWriter::setFlag(const char* name, bool flag) const
{
    const CMPIValue value = {.boolean = flag};
    CMSetProperty(instance_, name, &value, CMPI_boolean);
}

bool InstanceWriter::setCodes(
    const char* name, const std::vector<std::uint16_t>& codes, CMPIStatus* rc) const
{
    const auto count = static_cast<std::uint16_t>(codes.size());
    CMPIArray* const array = CMNewArray(broker_, count, CMPI_uint16, rc);
    if (!isUsable(array))
        return false;
    for (std::uint16_t i = 0; i < count; ++i) {
        const CMPIValue element = {.uint16 = codes[i]};
        CMSetArrayElementAt(array, i, &element, CMPI_uint16);
    }
    const CMPIValue value = {.array = array};
    CMSetProperty(instance_, name, &value, CMPI_uint16A);
    return true;
}

bool InstanceWriter::setTexts(
    const char* name, const std::vector<std::string>& texts, CMPIStatus* rc) const
{
    const auto count = static_cast<std::uint16_t>(texts.size());
    CMPIArray* const array = CMNewArray(broker_, count, CMPI_string, rc);
    if (!isUsable(array))
        return false;
    for (std::uint16_t i = 0; i < count; ++i) {
        const CMPIValue element = {.string = CMNewString(broker_, texts[i].c_str(), rc)};
        if (rc->rc == CMPI_RC_OK && isUsable(element.string))
            CMSetArrayElementAt(array, i, &element, CMPI_string);
    }
    const CMPIValue value = {.array = array};
    CMSetProperty(instance_, name, &value, CMPI_stringA);
    return true;
}

} // namespace Vorn::SensorProfileProvider
