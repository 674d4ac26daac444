// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// For any bytes of a model file, the reader returns nodes or throws std::runtime_error, and nodes
// that were read are the same after they were written and read again.

#include "platform/instrumentation/machinefile/MachineFileReader.h"
#include "platform/instrumentation/machinefile/MachineFileWriter.h"

#include <cstddef>
#include <cstdint>
#include <cstdlib>
#include <optional>
#include <stdexcept>

namespace {

std::optional<Vorn::MachineFile> tryRead(std::string_view text)
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

void requireRoundTrip(const Vorn::MachineFile& file)
{
    const auto again = tryRead(Vorn::writeMachineFile(file));
    if (!again || again->nodes.size() != file.nodes.size() || again->renewal != file.renewal)
        std::abort();
    for (std::size_t at = 0; at < file.nodes.size(); ++at)
        if (!isSame(file.nodes[at], again->nodes[at]))
            std::abort();
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size);

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    if (const auto file = tryRead({reinterpret_cast<const char*>(data), size}))
        requireRoundTrip(*file);
    return 0;
}
