// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// For any bytes of a stored history, the reader returns samples or throws std::runtime_error, and
// samples that were read can be shown, continued and stored.

#include "tools/history/HistoryFile.h"
#include "tools/history/HistoryJson.h"

#include <cstddef>
#include <cstdint>
#include <cstring>
#include <stdexcept>

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size);

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    using namespace Tools;
    const auto read = [&](void* to, std::size_t count) {
        if (count > size)
            return false;
        std::memcpy(to, data, count);
        data += count;
        size -= count;
        return true;
    };
    try {
        auto [entries, newest] = parseHistory(read);
        SensorHistory history;
        history.restore(std::move(entries), newest);
        Sensor sensor;
        sensor.setNames("a", "/b");
        sensor.reading = Quantity{1, 0};
        const auto next = std::chrono::seconds(secondsOfSlot * (newest + 1));
        history.add({&sensor}, std::chrono::system_clock::time_point(next));
        const auto write = [](const std::string& deviceId, const Samples& samples,
                               SlotNumber last) {
            std::string json;
            appendHour(json, deviceId, samples, last);
            appendThinnedHour(json, deviceId, samples, last);
            appendDay(json, deviceId, samples, last);
        };
        history.visit(history.deviceIds(), write);
        storeHistory(history, [](const void*, std::size_t) {});
    } catch (const std::runtime_error&) {
        return 0;
    }
    return 0;
}
