// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// For any record, the reader returns a sensor or nothing. Names are UTF-8 without control
// characters, and each raw byte is a finite number or none.

#include "platform/text/Utf8.h"
#include "tools/collect/SensorAnswer.h"
#include "tools/collect/SensorKind.h"
#include "tools/collect/SensorRecord.h"

#include <cmath>
#include <cstddef>
#include <cstdint>
#include <cstdlib>

namespace {

void require(bool holds)
{
    if (!holds)
        std::abort();
}

void check(const Ipmi::SensorRecord& sensor)
{
    require(Text::toValidUtf8(sensor.name) == sensor.name);
    for (const char character : sensor.name)
        require(static_cast<unsigned char>(character) >= ' ' && character != '\x7F');
    const auto kind = Ipmi::kindOf(sensor);
    for (unsigned raw = 0; kind && raw <= 0xFF; ++raw) {
        const auto value = Ipmi::convert(
            static_cast<std::uint8_t>(raw), sensor.format, sensor.factors, sensor.linearization);
        require(!value || std::isfinite(*value));
    }
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size);

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    const std::span bytes(data, size);
    if (const auto sensor = Ipmi::readSensorRecord(bytes))
        check(*sensor);
    const Ipmi::SensorAnswer answer = Ipmi::interpret(bytes, false);
    require(answer.kind != Ipmi::SensorAnswer::Kind::reading || size >= 3);
    return 0;
}
