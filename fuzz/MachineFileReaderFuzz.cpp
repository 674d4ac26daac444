// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Whatever bytes a model file holds, the reader gives nodes or a std::runtime_error; and what
// it read and the writer wrote, it reads back as the same.

#include "platform/instrumentation/machinefile/MachineFileReader.h"
#include "platform/instrumentation/machinefile/MachineFileWriter.h"

#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <optional>
#include <stdexcept>

namespace {

std::optional<std::vector<Vorn::MachineFileNode>> tryRead(std::string_view text)
{
    try {
        return Vorn::readMachineFile(text);
    } catch (const std::runtime_error&) {
        return std::nullopt;
    }
}

bool isSame(const Vorn::MachineFileNode& left, const Vorn::MachineFileNode& right)
{
    return left.type == right.type && left.path == right.path &&
           left.description == right.description && left.sensorType == right.sensorType &&
           left.values == right.values;
}

void requireRoundTrip(const std::vector<Vorn::MachineFileNode>& nodes)
{
    const auto again = tryRead(Vorn::writeMachineFile(nodes));
    if (!again || again->size() != nodes.size())
        std::abort();
    for (std::size_t at = 0; at < nodes.size(); ++at)
        if (!isSame(nodes[at], (*again)[at]))
            std::abort();
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size);

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    if (const auto nodes = tryRead({reinterpret_cast<const char*>(data), size}))
        requireRoundTrip(*nodes);
    return 0;
}
