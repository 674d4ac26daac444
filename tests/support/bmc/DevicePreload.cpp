// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Preloaded into a reader of /dev/ipmi0, it connects the device to the system interface of ipmi_sim
// at the loopback port SIMULATED_BMC. Each command takes SIMULATED_BMC_DELAY milliseconds more. As
// the kernel does, it bridges commands to satellites by Send Message and Get Message (IPMI 2.0,
// sections 22.6 and 22.7). A device whose BMC has ended since it was opened answers each command at
// once with the code of a timeout, also when the BMC has started again; none opens while there is
// no BMC. While there is a file SIMULATED_REMOVAL, the kernel has removed the device. Commands to
// satellites fail with the error number SIMULATED_SATELLITE_ERROR. Where SIMULATED_LATE_ANSWERS is
// set, an answer to the command before is received before each answer. Where SIMULATED_CLOCK_JUMPS
// is set, the clock of the day jumps back by an hour each time it is read.

#include <arpa/inet.h>
#include <linux/ipmi.h>
#include <sys/ioctl.h>
#include <sys/socket.h>
#include <sys/syscall.h>

#include <dlfcn.h>
#include <fcntl.h>
#include <poll.h>
#include <time.h> // NOLINT(modernize-deprecated-headers): <ctime> need not declare clock_gettime
#include <unistd.h>

#include <algorithm>
#include <array>
#include <cerrno>
#include <cstdarg>
#include <cstdint>
#include <cstdlib>
#include <cstring>
#include <numeric>
#include <optional>
#include <vector>

namespace {

using Bytes = std::vector<std::uint8_t>;

// Bytes of the protocol, which has no published name; ipmi_sim calls it "VM".
constexpr std::uint8_t endOfMessage = 0xA0;
constexpr std::uint8_t startOfControl = 0xA1;
constexpr std::uint8_t escape = 0xAA;

constexpr std::uint8_t application = 0x06; // a network function
constexpr std::uint8_t sendMessage = 0x34;
constexpr std::uint8_t getMessage = 0x33;

struct Request {
    long id = 0;
    std::uint8_t netFunction = 0;
    std::uint8_t command = 0;
    bool isBridged = false;
};

struct Device {
    int socket = -1;
    std::uint8_t sequence = 0;
    std::array<Request, 256> requests{}; // by their sequence numbers
    Request last;                        // of the reader
};

Device device;

std::uint8_t checksum(const Bytes& bytes, std::size_t from)
{
    return static_cast<std::uint8_t>(
        -std::accumulate(bytes.begin() + static_cast<std::ptrdiff_t>(from), bytes.end(), 0));
}

// Returns what open() does.
int connectedSocket()
{
    sockaddr_in address{};
    address.sin_family = AF_INET;
    address.sin_port = htons(static_cast<std::uint16_t>(std::atoi(std::getenv("SIMULATED_BMC"))));
    address.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
    const int socket = ::socket(AF_INET, SOCK_STREAM | SOCK_CLOEXEC, 0);
    if (::connect(socket, reinterpret_cast<sockaddr*>(&address), sizeof address) == 0)
        return socket;
    ::close(socket);
    errno = ENODEV;
    return -1;
}

bool isConnected()
{
    std::uint8_t byte = 0;
    const ssize_t count = ::recv(device.socket, &byte, 1, MSG_PEEK | MSG_DONTWAIT);
    return count > 0 || (count < 0 && errno == EAGAIN);
}

void send(const Request& request, std::uint8_t lun, std::uint8_t netFunction, std::uint8_t command,
    const Bytes& data)
{
    if (const char* const delay = std::getenv("SIMULATED_BMC_DELAY"))
        ::usleep(static_cast<unsigned>(std::atoi(delay)) * 1000);
    device.requests.at(++device.sequence) = request;
    Bytes message = {device.sequence, static_cast<std::uint8_t>(netFunction << 2U | lun), command};
    message.insert(message.end(), data.begin(), data.end());
    message.push_back(checksum(message, 0));
    Bytes frame;
    for (const std::uint8_t byte : message) {
        const bool isSpecial = byte == endOfMessage || byte == startOfControl || byte == escape;
        if (isSpecial)
            frame.push_back(escape);
        frame.push_back(isSpecial ? byte | 0x10U : byte);
    }
    frame.push_back(endOfMessage);
    (void)::send(device.socket, frame.data(), frame.size(), MSG_NOSIGNAL);
}

std::optional<std::uint8_t> nextByte()
{
    constexpr int timeout = 100; // in milliseconds
    pollfd input{device.socket, POLLIN, 0};
    std::uint8_t byte = 0;
    if (::poll(&input, 1, timeout) != 1 || ::recv(device.socket, &byte, 1, 0) != 1)
        return std::nullopt;
    return byte;
}

// Returns the next message: sequence number, network function, command, completion code, data.
std::optional<Bytes> receive()
{
    Bytes message;
    bool isEscaped = false;
    while (const auto byte = nextByte()) {
        if (*byte == endOfMessage && message.size() >= 5 && checksum(message, 0) == 0) {
            message.pop_back();
            return message;
        }
        if (*byte == endOfMessage || *byte == startOfControl)
            message.clear();
        else if (*byte != escape)
            message.push_back(isEscaped ? *byte & 0xEFU : *byte);
        isEscaped = *byte == escape;
    }
    return std::nullopt;
}

bool isForSatellite(const ipmi_req& request)
{
    int type = 0;
    std::memcpy(&type, request.addr, sizeof type);
    return type == IPMI_IPMB_ADDR_TYPE;
}

// Returns what ioctl() does.
int submit(const ipmi_req& request)
{
    const char* const error = std::getenv("SIMULATED_SATELLITE_ERROR");
    if (error != nullptr && isForSatellite(request)) {
        errno = std::atoi(error);
        return -1;
    }
    Request sent{request.msgid, request.msg.netfn, request.msg.cmd};
    device.last = sent;
    const Bytes data(request.msg.data, request.msg.data + request.msg.data_len);
    ipmi_addr address{};
    std::memcpy(&address, request.addr, std::min<std::size_t>(request.addr_len, sizeof address));
    if (address.addr_type == IPMI_SYSTEM_INTERFACE_ADDR_TYPE) {
        ipmi_system_interface_addr bmc{};
        std::memcpy(&bmc, &address, sizeof bmc);
        send(sent, bmc.lun, sent.netFunction, sent.command, data);
        return 0;
    }
    ipmi_ipmb_addr satellite{};
    std::memcpy(&satellite, &address, sizeof satellite);
    sent.isBridged = true;
    constexpr std::uint8_t bmcAddress = 0x20;
    constexpr std::uint8_t messageLun = 2;
    Bytes message = {static_cast<std::uint8_t>(satellite.channel), satellite.slave_addr,
        static_cast<std::uint8_t>(sent.netFunction << 2U | satellite.lun)};
    message.push_back(checksum(message, 1));
    const std::size_t second = message.size();
    message.insert(message.end(),
        {bmcAddress, static_cast<std::uint8_t>((device.sequence & 0x3FU) << 2U | messageLun),
            sent.command});
    message.insert(message.end(), data.begin(), data.end());
    message.push_back(checksum(message, second));
    send(sent, 0, application, sendMessage, message);
    return 0;
}

struct Answer {
    Request request;
    Bytes data; // from the completion code on
};

// Waits for what the satellite answers. Returns nothing where it does not answer.
std::optional<Bytes> fetchBridged(const Request& request)
{
    constexpr int attempts = 20;
    constexpr std::size_t codeAt = 3;    // of the answer to Get Message
    constexpr std::size_t answerAt = 10; // the completion code in the message
    for (int attempt = 0; attempt < attempts; ++attempt) {
        send({}, 0, application, getMessage, {});
        const auto message = receive();
        if (message && (*message)[codeAt] == 0 && message->size() > answerAt + 1 &&
            (*message)[answerAt - 1] == request.command)
            return Bytes(message->begin() + answerAt, message->end() - 1);
        ::usleep(5000);
    }
    return std::nullopt;
}

std::optional<Answer> nextAnswer()
{
    constexpr std::uint8_t timedOut = 0xC3;
    if (!isConnected())
        return Answer{device.last, {timedOut}};
    const auto message = receive();
    if (!message)
        return std::nullopt;
    const Request request = device.requests.at((*message)[0]);
    Bytes data(message->begin() + 3, message->end());
    if (!request.isBridged)
        return Answer{request, data};
    if (data.front() != 0)
        return std::nullopt; // the kernel repeats such a message until its timeout
    auto bridged = fetchBridged(request);
    return bridged ? std::optional(Answer{request, *std::move(bridged)}) : std::nullopt;
}

// Returns an answer of zeros to the command before, in every other call.
std::optional<Answer> lateAnswer()
{
    static bool isDue = false;
    isDue = !isDue;
    if (!isDue || std::getenv("SIMULATED_LATE_ANSWERS") == nullptr)
        return std::nullopt;
    Request request = device.requests.at(device.sequence);
    --request.id;
    return Answer{request, Bytes(16)};
}

int deliver(ipmi_recv& received)
{
    const auto late = lateAnswer();
    const auto answer = late ? late : nextAnswer();
    if (!answer) {
        errno = EAGAIN;
        return -1;
    }
    received.recv_type = IPMI_RESPONSE_RECV_TYPE;
    received.msgid = answer->request.id;
    received.msg.netfn = answer->request.netFunction | 1U;
    received.msg.cmd = answer->request.command;
    received.msg.data_len = static_cast<unsigned short>(
        std::min<std::size_t>(answer->data.size(), received.msg.data_len));
    std::copy_n(answer->data.begin(), received.msg.data_len, received.msg.data);
    const ipmi_system_interface_addr bmc{IPMI_SYSTEM_INTERFACE_ADDR_TYPE, IPMI_BMC_CHANNEL, 0};
    received.addr_len = std::min<unsigned>(received.addr_len, sizeof bmc);
    std::memcpy(received.addr, &bmc, received.addr_len);
    return 0;
}

template <typename Function>
Function next(const char* name)
{
    return reinterpret_cast<Function>(::dlsym(RTLD_NEXT, name));
}

bool isRemoved()
{
    const char* const file = std::getenv("SIMULATED_REMOVAL");
    return file != nullptr && ::access(file, F_OK) == 0;
}

int openOr(const char* function, const char* path, int flags, mode_t mode)
{
    if (std::getenv("SIMULATED_BMC") != nullptr && std::strcmp(path, "/dev/ipmi0") == 0) {
        if (!isRemoved())
            return device.socket = connectedSocket();
        errno = ENOENT;
        return -1;
    }
    return next<int (*)(const char*, int, ...)>(function)(path, flags, mode);
}

} // namespace

#define EXPORTED extern "C" __attribute__((visibility("default")))

EXPORTED int open(const char* path, int flags, ...)
{
    va_list arguments;
    va_start(arguments, flags);
    const mode_t mode = va_arg(arguments, mode_t);
    va_end(arguments);
    return openOr("open", path, flags, mode);
}

EXPORTED int open64(const char* path, int flags, ...)
{
    va_list arguments;
    va_start(arguments, flags);
    const mode_t mode = va_arg(arguments, mode_t);
    va_end(arguments);
    return openOr("open64", path, flags, mode);
}

EXPORTED int clock_gettime(clockid_t clock, timespec* time) noexcept
{
    const long result = ::syscall(SYS_clock_gettime, clock, time);
    static long jumps = 0;
    if (clock == CLOCK_REALTIME && std::getenv("SIMULATED_CLOCK_JUMPS") != nullptr)
        time->tv_sec -= 3600 * ++jumps;
    return static_cast<int>(result);
}

EXPORTED int ioctl(int file, unsigned long request, ...) noexcept
{
    va_list arguments;
    va_start(arguments, request);
    void* const argument = va_arg(arguments, void*);
    va_end(arguments);
    if (file < 0 || file != device.socket)
        return next<int (*)(int, unsigned long, ...)>("ioctl")(file, request, argument);
    if (isRemoved()) {
        errno = ENODEV;
        return -1;
    }
    switch (request) {
    case IPMICTL_SEND_COMMAND:
        return submit(*static_cast<const ipmi_req*>(argument));
    case IPMICTL_SEND_COMMAND_SETTIME:
        return submit(static_cast<const ipmi_req_settime*>(argument)->req);
    case IPMICTL_RECEIVE_MSG:
    case IPMICTL_RECEIVE_MSG_TRUNC:
        return deliver(*static_cast<ipmi_recv*>(argument));
    default:
        return 0;
    }
}
