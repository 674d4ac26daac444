// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/collect/IpmiDevice.h"

#include <linux/ipmi.h>

#include <fcntl.h>
#include <poll.h>
#include <sys/file.h>
#include <sys/ioctl.h>

#include <algorithm>
#include <array>
#include <cerrno>
#include <stdexcept>
#include <string>
#include <system_error>

namespace Ipmi {

namespace {

using std::chrono::milliseconds;

[[noreturn]] void fail()
{
    throw std::system_error(errno, std::generic_category(), devicePath);
}

// Waits until there is something to read. Returns false at the end of the timeout.
bool waitForInput(int file, milliseconds timeout)
{
    pollfd input{file, POLLIN, 0};
    const int count = ::poll(&input, 1, static_cast<int>(timeout.count()));
    if (count < 0 && errno != EINTR)
        fail();
    if (count > 0 && (input.revents & POLLIN) == 0)
        throw std::system_error(EIO, std::generic_category(), devicePath);
    return count > 0;
}

} // namespace

IpmiDevice::IpmiDevice() : file_(::open(devicePath, O_RDWR | O_CLOEXEC))
{
    if (file_.isOpen() && ::flock(file_.number(), LOCK_EX | LOCK_NB) == 0)
        return;
    if (errno == EWOULDBLOCK)
        throw std::runtime_error(
            std::string("another process reads the sensors of ") + devicePath + " already");
    fail();
}

Bytes IpmiDevice::send(const AddressedCommand& command, milliseconds timeout)
{
    const auto end = std::chrono::steady_clock::now() + timeout;
    if (!submit(command, timeout))
        return {};
    for (;;) {
        const auto left = std::chrono::ceil<milliseconds>(end - std::chrono::steady_clock::now());
        if (left <= milliseconds::zero())
            return {};
        if (waitForInput(file_.number(), left))
            if (Bytes answer = receive(); !answer.empty())
                return answer;
    }
}

// Returns false where the kernel knows no way to the satellite, whose address is what a record
// says.
bool IpmiDevice::submit(const AddressedCommand& command, milliseconds timeout)
{
    const Responder& responder = command.responder;
    ipmi_system_interface_addr bmc{
        IPMI_SYSTEM_INTERFACE_ADDR_TYPE, IPMI_BMC_CHANNEL, responder.lun};
    ipmi_ipmb_addr satellite{
        IPMI_IPMB_ADDR_TYPE, responder.channel, responder.address, responder.lun};
    Bytes data = command.data;
    ipmi_req_settime request{};
    request.req.addr = reinterpret_cast<unsigned char*>(&satellite);
    request.req.addr_len = sizeof satellite;
    if (responder.isBmc) {
        request.req.addr = reinterpret_cast<unsigned char*>(&bmc);
        request.req.addr_len = sizeof bmc;
    }
    request.req.msgid = ++lastMessage_;
    const auto code = static_cast<unsigned>(command.code);
    request.req.msg = {static_cast<unsigned char>(code >> 8U),
        static_cast<unsigned char>(code & 0xFFU), static_cast<unsigned short>(data.size()),
        data.data()};
    // The kernel repeats a message that is lost between the BMC and a satellite.
    request.retries = 1;
    request.retry_time_ms = static_cast<unsigned>(timeout.count()) / 2;
    if (::ioctl(file_.number(), IPMICTL_SEND_COMMAND_SETTIME, &request) == 0)
        return true;
    if (responder.isBmc || (errno != EINVAL && errno != EAGAIN))
        fail();
    return false;
}

// Returns nothing for a message that is not the answer to the last command.
Bytes IpmiDevice::receive()
{
    std::array<unsigned char, IPMI_MAX_MSG_LENGTH> data{};
    ipmi_addr address{};
    ipmi_recv received{};
    received.addr = reinterpret_cast<unsigned char*>(&address);
    received.addr_len = sizeof address;
    received.msg.data = data.data();
    received.msg.data_len = data.size();
    // A message that is too long is received without its end.
    if (::ioctl(file_.number(), IPMICTL_RECEIVE_MSG_TRUNC, &received) != 0 && errno != EMSGSIZE) {
        if (errno == EAGAIN || errno == EINTR)
            return {};
        fail();
    }
    if (received.recv_type != IPMI_RESPONSE_RECV_TYPE || received.msgid != lastMessage_)
        return {};
    const std::size_t size = std::min<std::size_t>(received.msg.data_len, data.size());
    return {data.begin(), data.begin() + size};
}

} // namespace Ipmi
