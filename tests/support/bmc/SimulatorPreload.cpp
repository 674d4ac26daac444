// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Preloaded into ipmi_sim, it appends each command that the BMC answers to the file BMC_COMMANDS,
// as a line `NETFUNCTION COMMAND LUN FIRSTBYTE`, and spoils the answers to the commands that lines
// of the file BMC_FAULTS name: `NETFUNCTION COMMAND LUN FIRSTBYTE ACTION [INDEX] VALUE`, in
// hexadecimal numbers, with * for any. The actions are
//   code VALUE       the answer is this completion code
//   set INDEX VALUE  the bits are set in this byte of the answer, of which 0 is the completion code
//   length VALUE     the answer has this many bytes
//   drop             there is no answer

#include <OpenIPMI/lanserv.h>

#include <dlfcn.h>
#include <fcntl.h>
#include <unistd.h>

#include <cstdint>
#include <cstdio>
#include <cstdlib>
#include <fstream>
#include <sstream>
#include <string>

namespace {

struct Answer {
    std::uint8_t* bytes;
    unsigned size;
};

bool matches(std::istream& line, unsigned value)
{
    std::string pattern;
    line >> pattern;
    return pattern == "*" || (!pattern.empty() && std::stoul(pattern, nullptr, 16) == value);
}

unsigned firstByteOf(const msg_t& message)
{
    return message.len == 0 ? 0x100 : message.data[0];
}

// Returns false when there is to be no answer.
bool spoil(std::istream& fault, Answer& answer)
{
    std::string action;
    unsigned index = 0;
    unsigned value = 0;
    fault >> action >> std::hex;
    if (action == "drop")
        return false;
    if (action == "set")
        fault >> index;
    fault >> value;
    if (action == "code")
        answer.bytes[0] = static_cast<std::uint8_t>(value);
    if (action == "code")
        answer.size = 1;
    else if (action == "length" && value < answer.size)
        answer.size = value;
    else if (action == "set" && index < answer.size)
        answer.bytes[index] = static_cast<std::uint8_t>(answer.bytes[index] | value);
    return true;
}

void record(const msg_t& message)
{
    char line[32];
    const int length = std::snprintf(line, sizeof line, "%02x %02x %x %02x\n", message.netfn,
        message.cmd, message.rs_lun, firstByteOf(message));
    static const int file =
        ::open(std::getenv("BMC_COMMANDS"), O_WRONLY | O_CREAT | O_APPEND | O_CLOEXEC, 0600);
    (void)!::write(file, line, static_cast<std::size_t>(length));
}

} // namespace

extern "C" __attribute__((visibility("default"))) void ipmi_handle_smi_rsp(
    channel_t* channel, msg_t* message, std::uint8_t* bytes, int size)
{
    static const auto next =
        reinterpret_cast<decltype(&ipmi_handle_smi_rsp)>(::dlsym(RTLD_NEXT, "ipmi_handle_smi_rsp"));
    record(*message);
    Answer answer{bytes, static_cast<unsigned>(size)};
    bool isAnswered = true;
    std::ifstream faults(std::getenv("BMC_FAULTS"));
    for (std::string text; std::getline(faults, text);) {
        std::istringstream line(text);
        if (matches(line, message->netfn) && matches(line, message->cmd) &&
            matches(line, message->rs_lun) && matches(line, firstByteOf(*message)))
            isAnswered = spoil(line, answer) && isAnswered;
    }
    if (isAnswered)
        next(channel, message, answer.bytes, static_cast<int>(answer.size));
}
