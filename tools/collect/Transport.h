// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Commands to a management controller and its satellites (IPMI 2.0), and what carries them.

#pragma once

#include <chrono>
#include <cstdint>
#include <vector>

namespace Ipmi {

using Bytes = std::vector<std::uint8_t>;

// The controller that a command is for: the BMC, or the satellite with an address on a channel.
struct Responder {
    bool isBmc = true;
    std::uint8_t channel = 0;
    std::uint8_t address = 0;
    std::uint8_t lun = 0;
};

// The commands of a reader of sensors (IPMI 2.0, appendix G): the network function and the number.
enum class CommandCode : std::uint16_t {
    getDeviceId = 0x0601,
    getSensorReadingFactors = 0x0423,
    getSensorThresholds = 0x0427,
    getSensorReading = 0x042D,
    getSdrRepositoryInfo = 0x0A20,
    reserveSdrRepository = 0x0A22,
    getSdr = 0x0A23,
};

struct AddressedCommand {
    Responder responder;
    CommandCode code{};
    Bytes data;
};

// Completion codes, with which answers begin (IPMI 2.0, table 5-2).
namespace CompletionCode {
inline constexpr std::uint8_t success = 0x00;
inline constexpr std::uint8_t busy = 0xC0;
inline constexpr std::uint8_t invalidCommand = 0xC1;
inline constexpr std::uint8_t timedOut = 0xC3; // of the kernel, too: a satellite did not answer
inline constexpr std::uint8_t reservationCanceled = 0xC5;
inline constexpr std::uint8_t requestTooLong = 0xC7;
inline constexpr std::uint8_t lengthOutOfRange = 0xC8;
inline constexpr std::uint8_t tooManyBytes = 0xCA;
inline constexpr std::uint8_t notPresent = 0xCB;
inline constexpr std::uint8_t invalidField = 0xCC;
inline constexpr std::uint8_t illegalCommand = 0xCD; // for this sensor
inline constexpr std::uint8_t unspecified = 0xFF;    // of the kernel, too: the BMC did not answer
} // namespace CompletionCode

class Transport {
public:
    virtual ~Transport() = default;

    // Sends a command and waits for its answer. Returns the bytes from the completion code on; none
    // when no answer arrives within the timeout, or when there is no way to that satellite. A late
    // answer is discarded. Throws std::system_error when the device fails.
    virtual Bytes send(const AddressedCommand& command, std::chrono::milliseconds timeout) = 0;
};

} // namespace Ipmi
