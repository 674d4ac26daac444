// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "tools/collect/Transport.h"

#include <set>
#include <stdexcept>
#include <utility>

namespace Ipmi {

// The BMC has not answered for five seconds, or its driver reports so without having waited.
class SilentBmc : public std::runtime_error {
public:
    explicit SilentBmc(bool hasWaited)
        : std::runtime_error("the BMC does not answer"), hasWaited_(hasWaited)
    {
    }

    bool hasWaited() const { return hasWaited_; }

private:
    bool hasWaited_;
};

// Sends the commands of one pass.
class Bmc {
public:
    // The transport must outlive the object.
    explicit Bmc(Transport& transport) : transport_(transport) {}

    // Returns the answer from the completion code on, which is at least one byte. Repeats a command
    // to a busy controller twice. A satellite that does not answer is not asked again: the answers
    // have the completion code of a timeout. Throws SilentBmc, and what Transport::send() throws.
    Bytes ask(const AddressedCommand& command);

private:
    using Clock = std::chrono::steady_clock;

    Bytes exchange(const AddressedCommand& command);
    bool isAlive(Clock::time_point end);

    Transport& transport_;
    std::set<std::pair<std::uint8_t, std::uint8_t>> silentSatellites_; // channels and addresses
};

} // namespace Ipmi
