// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "platform/utilities/Descriptor.h"
#include "tools/collect/Transport.h"

namespace Ipmi {

inline constexpr const char* devicePath = "/dev/ipmi0";

// The kernel's interface to the BMC of this machine (linux/ipmi.h), which also bridges commands to
// satellites. Keeps other collectors from the device during its lifetime, since each of them would
// cost the BMC as many commands. Used by one thread.
class IpmiDevice final : public Transport {
public:
    // Throws std::system_error naming the device, and std::runtime_error when another process has
    // it.
    IpmiDevice();

    Bytes send(const AddressedCommand& command, std::chrono::milliseconds timeout) override;

private:
    bool submit(const AddressedCommand& command, std::chrono::milliseconds timeout);
    Bytes receive();

    Vorn::Descriptor file_;
    long lastMessage_ = 0; // its number distinguishes an answer from late ones
};

} // namespace Ipmi
