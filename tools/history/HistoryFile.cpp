// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/history/HistoryFile.h"

#include <fcntl.h>
#include <sys/stat.h>
#include <unistd.h>
#include <zlib.h>

#include <array>
#include <cerrno>
#include <cstdint>
#include <cstdio>
#include <stdexcept>
#include <system_error>
#include <type_traits>
#include <utility>

namespace Tools {

namespace {

// Numbers are in the byte order of the machine, to which the file belongs.
struct Header {
    std::array<char, 8> magic = {'s', 'e', 'n', 's', 'o', 'r', 's', '1'};
    std::uint32_t sizeOfSamples = sizeof(Samples);
    std::uint32_t count = 0; // of the sensors that follow
    SlotNumber newest = 0;
};
struct SensorHeader {
    SlotNumber lastSeen = 0;
    std::uint64_t sizeOfDeviceId = 0;
};
static_assert(std::has_unique_object_representations_v<Header> &&
              std::has_unique_object_representations_v<SensorHeader>);

constexpr std::uint64_t maximumDeviceId = 4096;          // longer ones are not stored
constexpr SlotNumber greatestSlot = SlotNumber{1} << 29; // in the year 2140
constexpr const char* damaged = "it is damaged or truncated";
constexpr ::mode_t modeOfFile = 0600;

void require(bool condition, const char* otherwise)
{
    if (!condition)
        throw std::runtime_error(otherwise);
}

[[noreturn]] void throwSystemError(int number = errno)
{
    throw std::system_error(number, std::generic_category());
}

// Opens a regular file that is no symbolic link. Returns -1 where there is none.
int openRegular(const std::string& file, int flags)
{
    constexpr int careful = O_NOFOLLOW | O_NONBLOCK | O_CLOEXEC; // a FIFO would block
    const int descriptor = ::open(file.c_str(), flags | careful, modeOfFile);
    if (descriptor == -1 && errno != ENOENT)
        throwSystemError();
    struct stat status {};
    if (descriptor != -1 && (::fstat(descriptor, &status) != 0 || !S_ISREG(status.st_mode))) {
        ::close(descriptor);
        throw std::runtime_error("it is no regular file");
    }
    return descriptor;
}

class Gzip {
public:
    // Owns the descriptor from now on.
    Gzip(int descriptor, const char* mode)
        : descriptor_(descriptor), file_(::gzdopen(descriptor, mode))
    {
        if (file_ != nullptr)
            return;
        ::close(descriptor);
        throwSystemError(ENOMEM);
    }
    ~Gzip()
    {
        if (file_ != nullptr)
            ::gzclose(file_);
    }
    Gzip(const Gzip&) = delete;
    Gzip& operator=(const Gzip&) = delete;

    void write(const void* bytes, std::size_t count)
    {
        if (::gzwrite(file_, bytes, static_cast<unsigned>(count)) == 0)
            throwSystemError();
    }
    // Writes the checksum and has the file on the disk.
    void finish()
    {
        const int copy = ::fcntl(descriptor_, F_DUPFD_CLOEXEC, 0);
        if (copy == -1)
            throwSystemError();
        const int result = ::gzclose(std::exchange(file_, nullptr));
        const int synchronized = ::fsync(copy);
        const int number = result == Z_ERRNO || result == Z_OK ? errno : ENOMEM;
        ::close(copy);
        if (result != Z_OK || synchronized != 0)
            throwSystemError(number);
    }

    bool read(void* bytes, std::size_t count)
    {
        return ::gzread(file_, bytes, static_cast<unsigned>(count)) == static_cast<int>(count);
    }
    // Returns whether all was read and has the right checksum. REQUIRES: nothing else is called
    // afterwards.
    bool closeAtEnd()
    {
        char next = 0;
        const bool isAtEnd = ::gzread(file_, &next, 1) == 0 && ::gzdirect(file_) == 0;
        return ::gzclose(std::exchange(file_, nullptr)) == Z_OK && isAtEnd;
    }

private:
    int descriptor_;
    ::gzFile file_;
};

} // namespace

void storeHistory(const SensorHistory& history,
    const std::function<void(const void* bytes, std::size_t count)>& write)
{
    // A sensor that is forgotten meanwhile is stored without samples.
    auto deviceIds = history.deviceIds();
    std::erase_if(
        deviceIds, [](const auto& each) { return each.empty() || each.size() > maximumDeviceId; });
    Header header;
    header.count = static_cast<std::uint32_t>(deviceIds.size());
    header.newest = history.newest();
    write(&header, sizeof header);
    for (const std::string& deviceId : deviceIds) {
        const auto entry =
            history.entryUntil(deviceId, header.newest).value_or(SensorHistory::Entry{});
        const SensorHeader sensor{entry.lastSeen, deviceId.size()};
        write(&sensor, sizeof sensor);
        write(deviceId.data(), deviceId.size());
        write(&entry.samples, sizeof entry.samples);
    }
}

StoredHistory parseHistory(const std::function<bool(void* bytes, std::size_t count)>& read)
{
    Header header;
    require(read(&header, sizeof header), damaged);
    require(header.magic == Header().magic && header.sizeOfSamples == sizeof(Samples),
        "it is of another version");
    require(header.count <= SensorHistory::maximumSensors, "it has too many sensors");
    require(header.newest >= 0 && header.newest <= greatestSlot, "it has an impossible time");
    SensorHistory::Entries entries;
    for (std::uint32_t i = 0; i < header.count; ++i) {
        SensorHeader sensor;
        require(read(&sensor, sizeof sensor), damaged);
        require(sensor.lastSeen >= 0 && sensor.lastSeen <= header.newest,
            "a sensor has an impossible time");
        require(sensor.sizeOfDeviceId > 0 && sensor.sizeOfDeviceId <= maximumDeviceId,
            "a sensor has an impossible name");
        std::string deviceId(sensor.sizeOfDeviceId, '\0');
        auto entry = std::make_unique<SensorHistory::Entry>();
        require(
            read(deviceId.data(), deviceId.size()) && read(&entry->samples, sizeof entry->samples),
            damaged);
        require(entry->samples.isValid(), "a sensor has an impossible state");
        entry->lastSeen = sensor.lastSeen;
        require(
            entries.emplace(std::move(deviceId), std::move(entry)).second, "it has a sensor twice");
    }
    return {std::move(entries), header.newest};
}

void writeHistoryFile(const std::string& file, const SensorHistory& history)
{
    const std::string newFile = file + ".new";
    try {
        const int descriptor = openRegular(newFile, O_WRONLY | O_CREAT | O_TRUNC);
        if (descriptor == -1)
            throwSystemError(ENOENT);
        Gzip gzip(descriptor, "wb1"); // fast: higher levels save little
        storeHistory(
            history, [&](const void* bytes, std::size_t count) { gzip.write(bytes, count); });
        gzip.finish();
        if (::rename(newFile.c_str(), file.c_str()) != 0)
            throwSystemError();
    } catch (const std::system_error& error) {
        throw std::runtime_error(newFile + ": " + error.code().message());
    } catch (const std::runtime_error& error) {
        throw std::runtime_error(newFile + ": " + error.what());
    }
}

void readHistoryFile(const std::string& file, SensorHistory& history)
{
    try {
        const int descriptor = openRegular(file, O_RDONLY);
        if (descriptor == -1)
            return;
        Gzip gzip(descriptor, "rb");
        auto [entries, newest] =
            parseHistory([&](void* bytes, std::size_t count) { return gzip.read(bytes, count); });
        require(gzip.closeAtEnd(), damaged);
        history.restore(std::move(entries), newest);
    } catch (const std::system_error& error) {
        throw std::runtime_error(file + ": " + error.code().message());
    } catch (const std::runtime_error& error) {
        throw std::runtime_error(file + ": " + error.what());
    }
}

} // namespace Tools
