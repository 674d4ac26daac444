// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/collect/SdrRepository.h"

#include <algorithm>
#include <array>
#include <cstdio>
#include <set>
#include <stdexcept>
#include <string>

namespace Ipmi {

namespace {

using CompletionCode::success;

// Returns whether the controller cannot return that many bytes.
bool meansTooMany(std::uint8_t completionCode)
{
    using namespace CompletionCode;
    constexpr std::array codes = {requestTooLong, lengthOutOfRange, tooManyBytes, unspecified};
    return std::find(codes.begin(), codes.end(), completionCode) != codes.end();
}

[[noreturn]] void fail(const char* what, const Bytes& answer)
{
    std::array<char, 128> text{};
    std::snprintf(text.data(), text.size(),
        "the BMC's sensor data records cannot be read: %s is answered %02X, in %zu bytes", what,
        answer.front(), answer.size());
    throw std::runtime_error(text.data());
}

std::uint8_t lowByte(unsigned number)
{
    return static_cast<std::uint8_t>(number & 0xFFU);
}

std::uint16_t wordAt(const Bytes& bytes, std::size_t at)
{
    return static_cast<std::uint16_t>(bytes[at] | bytes[at + 1] << 8U);
}

class RecordReader {
public:
    explicit RecordReader(Bmc& bmc) : bmc_(bmc) { reserve(); }

    // Reads the header of a record, and all of an analog sensor's record. Returns the identifier of
    // the next record.
    std::uint16_t read(std::uint16_t id, Bytes& record)
    {
        constexpr std::size_t fewestBytes = 8;
        constexpr std::size_t answerHeader = 3; // completion code, identifier of the next record
        int failures = 20;                      // other readers cancel the reservation, too
        std::uint16_t next = id;
        record.clear();
        while (record.size() < sizeOf(record)) {
            const std::size_t wanted = std::min(sizeOf(record) - record.size(), bytesAtOnce_);
            const Bytes answer = ask(id, record.size(), wanted);
            const std::size_t size = answer.size() - std::min(answer.size(), answerHeader);
            if (answer.front() == success && size > 0 && size <= wanted) {
                record.insert(record.end(), answer.begin() + answerHeader, answer.end());
                next = wordAt(answer, 1);
                continue;
            }
            const bool isCanceled = answer.front() == CompletionCode::reservationCanceled;
            const bool isTooMuch = meansTooMany(answer.front()) && wanted > fewestBytes;
            if (--failures == 0 || (!isCanceled && !isTooMuch))
                fail("Get SDR", answer);
            if (isTooMuch) {
                bytesAtOnce_ = wanted / 2;
            } else {
                reserve();
                record.clear(); // it may have changed
            }
        }
        return next;
    }

private:
    void reserve()
    {
        const Bytes answer = bmc_.ask({{}, CommandCode::reserveSdrRepository, {}});
        if (answer.front() != success || answer.size() < 3)
            fail("Reserve SDR Repository", answer);
        reservation_ = {answer[1], answer[2]};
    }

    // Returns how much of a record that begins with these bytes is read.
    static std::size_t sizeOf(const Bytes& record)
    {
        constexpr std::size_t headerSize = 5; // identifier, version, type, length of the rest
        if (record.size() < headerSize || record[3] != fullSensorRecord)
            return headerSize;
        return headerSize + record[4];
    }

    Bytes ask(std::uint16_t id, std::size_t offset, std::size_t count)
    {
        return bmc_.ask({{}, CommandCode::getSdr,
            {reservation_[0], reservation_[1], lowByte(id), lowByte(id >> 8U),
                lowByte(static_cast<unsigned>(offset)), lowByte(static_cast<unsigned>(count))}});
    }

    Bmc& bmc_;
    std::array<std::uint8_t, 2> reservation_{};
    std::size_t bytesAtOnce_ = 32;
};

} // namespace

RepositoryStamp stampOfRepository(Bmc& bmc)
{
    constexpr std::size_t size = 15;
    constexpr auto begin = 2; // of the number of records, free space and times
    constexpr auto end = 14;
    const Bytes answer = bmc.ask({{}, CommandCode::getSdrRepositoryInfo, {}});
    if (answer.front() != success || answer.size() < size)
        fail("Get SDR Repository Info", answer);
    RepositoryStamp stamp(answer.begin() + begin, answer.begin() + end);
    stamp[2] = stamp[3] = 0; // the free space
    return stamp;
}

std::vector<SensorRecord> readRepository(Bmc& bmc)
{
    constexpr std::uint16_t first = 0;
    constexpr std::uint16_t last = 0xFFFF;
    std::vector<SensorRecord> sensors;
    RecordReader reader(bmc);
    Bytes record;
    std::set<std::uint16_t> visited; // a faulty repository may lead back to an earlier record
    for (std::uint16_t id = first; id != last && visited.insert(id).second;) {
        id = reader.read(id, record);
        if (auto sensor = readSensorRecord(record))
            sensors.push_back(*std::move(sensor));
    }
    return sensors;
}

} // namespace Ipmi
