// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Clients of all kinds send requests to a server process while a chip of the machine appears and
// disappears: every answer is complete and without error, and the server leaks nothing.
// SENSOR_PROFILE_SOAK_SECONDS is the duration.

#include "platform/utilities/ProviderUtilities.h"
#include "tests/support/CimCall.h"
#include "tests/support/HttpClient.h"
#include "tests/support/MountNamespace.h"
#include "tests/support/TlsClient.h"
#include "tests/support/WaitUntil.h"
#include "tests/tools/ServerProcess.h"
#include "tests/tools/ToolTest.h"

#include <expat.h>
#include <gmock/gmock.h>

#include <unistd.h>

#include <atomic>
#include <chrono>
#include <functional>
#include <thread>

namespace {

using namespace Testing;
using namespace std::chrono_literals;
using Clock = std::chrono::steady_clock;

std::chrono::seconds soakTime()
{
    const char* const wanted = std::getenv("SENSOR_PROFILE_SOAK_SECONDS");
    return std::chrono::seconds(wanted == nullptr ? 5 : std::atoi(wanted));
}

const std::string allSensors =
    cimRequest("EnumerateInstances", cimClassParameter("ZUMLO_NumericSensor"));

std::string devicesOfTheSystem()
{
    return cimRequest("Associators",
        cimParameter("ObjectName",
            cimInstanceName("ZUMLO_ComputerSystem",
                {{"CreationClassName", "ZUMLO_ComputerSystem"}, {"Name", Vorn::getSystemName()}})));
}

// Returns a request for a sensor of the chip that stays.
std::string oneSensor()
{
    const std::string sensor = cimInstanceName(
        "ZUMLO_NumericSensor", {{"CreationClassName", "ZUMLO_NumericSensor"},
                                   {"DeviceID", "Package id 0:/hwmon/coretemp-isa-0000/temp1"},
                                   {"SystemCreationClassName", "ZUMLO_ComputerSystem"},
                                   {"SystemName", Vorn::getSystemName()}});
    return cimRequest("GetInstance", cimParameter("InstanceName", sensor));
}

bool isWellFormed(const std::string& text)
{
    const std::unique_ptr<XML_ParserStruct, decltype(&XML_ParserFree)> parser(
        XML_ParserCreate(nullptr), &XML_ParserFree);
    return XML_Parse(parser.get(), text.data(), static_cast<int>(text.size()), XML_TRUE) ==
           XML_STATUS_OK;
}

// Returns the number of sensors in the response; -1 when it is incomplete or contains an error.
int sensorsOf(const HttpReply& reply)
{
    if (reply.status != 200 || !reply.body.ends_with("</CIM>\n") || !isWellFormed(reply.body) ||
        countOf(reply.body, "<ERROR ") != 0 || countOf(reply.body, "<IRETURNVALUE>") != 1)
        return -1;
    return static_cast<int>(countOf(reply.body, "<INSTANCE CLASSNAME=\"ZUMLO_NumericSensor\">"));
}

// Counts the answers with and without the sensor of the chip.
struct Seen {
    std::atomic<int> answers{0};
    std::atomic<int> scrapes{0};
    std::atomic<int> withChip{0};
    std::atomic<int> withoutChip{0};
};

class ServeSoakTest : public MountNamespaceTest {
protected:
    void SetUp() override
    {
        MountNamespaceTest::SetUp();
        if (IsSkipped() || HasFailure())
            return;
        // The test is the longest one and yields the processors to the others.
        EXPECT_NE(::nice(10), -1);
        sysfs_ = std::make_unique<BoundSysfs>("hotplug");
        // By default, the address sanitizer would keep up to 256 MB of freed memory.
        const std::string file = (folder_.path() / "one").string();
        makeCertificate(file, "localhost");
        server_ = std::make_unique<ServerProcess>(
            std::vector<std::string>{"--certificate", file + ".crt", "--key", file + ".key"},
            std::map<std::string, std::string>{
                {"ASAN_OPTIONS", "quarantine_size_mb=1:thread_local_quarantine_size_kb=64"},
                {"RYNLOG_LOG", "off"}});
    }

    // Sends ten requests on a connection: one connection for all requests would hide a leak in each
    // connection.
    void askAll(HttpClient&& client, const std::string& request, int least, int most)
    {
        for (int i = 0; i < 10; ++i) {
            client.send(request);
            const HttpReply reply = client.receive();
            const int sensors = sensorsOf(reply);
            ++seen_.answers;
            if (least != most)
                ++(sensors == most ? seen_.withChip : seen_.withoutChip);
            ASSERT_TRUE(sensors == least || sensors == most) << sensors << ' ' << reply.body;
        }
    }

    // Scrapes ten times. A chip that disappears during the harvest may be missing or lost.
    void scrape()
    {
        HttpClient client(server_->port());
        for (int i = 0; i < 10; ++i) {
            client.send("GET /metrics HTTP/1.1\r\nHost: localhost\r\n\r\n");
            const HttpReply reply = client.receive();
            const std::size_t sensors = countOf(reply.body, "\nsensor_profile_health{");
            ++seen_.scrapes;
            ASSERT_TRUE(reply.status == 200 && sensors >= 2 && sensors <= 3) << reply.body;
        }
    }

    // Closes a connection in the middle of the answer, and another one in the middle of the
    // request.
    void breakOff()
    {
        HttpClient reading(server_->port());
        reading.send(allSensors);
        reading.receiveSome();
        reading.closeHard();
        HttpClient writing(server_->port());
        writing.send("POST /elsewhere HTTP/1.1\r\nHost: localhost\r\nContent-Length: 0\r\n\r\n");
        EXPECT_EQ(writing.receive().status, 404);
        writing.send(allSensors.substr(0, 150));
    }

    void soak(Clock::duration time)
    {
        const auto end = Clock::now() + time;
        std::vector<std::thread> clients;
        const auto keep = [&](std::function<void()> asking) {
            clients.emplace_back([end, asking = std::move(asking)] {
                try {
                    while (Clock::now() < end && !HasFailure())
                        asking();
                } catch (const std::exception& error) {
                    ADD_FAILURE() << error.what();
                }
            });
        };
        const auto connect = [this] { return HttpClient(server_->port()); };
        keep([&] { askAll(connect(), allSensors, 2, 3); });
        keep([&] { askAll(TlsClient(server_->port("https")), allSensors, 2, 3); });
        keep([&] { askAll(connect(), devicesOfTheSystem(), 2, 3); });
        keep([&] { askAll(connect(), oneSensor(), 1, 1); });
        keep([this] { breakOff(); });
        keep([this] { scrape(); });
        keep([this] { scrape(); });
        while (Clock::now() < end) {
            sysfs_->rename("hwmon/hwmon2", "gone");
            std::this_thread::sleep_for(30ms);
            sysfs_->renew("gone");
            sysfs_->rename("gone", "hwmon/hwmon2");
            std::this_thread::sleep_for(30ms);
        }
        for (std::thread& client : clients)
            client.join();
        // The last request may have listed the machine without the chip, whose folder is not open
        // then.
        readAllChips();
    }

    // The folder of each chip stays open once the machine has been listed, by the provider and, for
    // the metrics and the history, by the tool.
    void readAllChips()
    {
        askAll(HttpClient(server_->port()), allSensors, 3, 3);
        scrape();
    }

    std::size_t residentKilobytes() const { return server_->residentKilobytes(); }

    std::size_t descriptors() const
    {
        const std::string folder = "/proc/" + std::to_string(server_->id()) + "/fd";
        return static_cast<std::size_t>(
            std::distance(std::filesystem::directory_iterator(folder), {}));
    }

    // Returns how many there are once the connections of clients that have ended are closed.
    std::size_t settledDescriptors() const
    {
        std::size_t count = descriptors();
        for (std::size_t before = 0; before != count; count = descriptors()) {
            before = count;
            std::this_thread::sleep_for(300ms);
        }
        return count;
    }

    // The server closes its side of connections a little after the clients.
    bool waitForDescriptors(std::size_t count) const
    {
        return waitUntil([&] { return descriptors() == count; }, 10s);
    }

    TemporaryFolder folder_;
    std::unique_ptr<BoundSysfs> sysfs_;
    std::unique_ptr<ServerProcess> server_;
    Seen seen_;
};

TEST_F(ServeSoakTest, ErrorsAreNotTakenForAnswers)
{
    HttpClient client(server_->port());
    client.send(cimRequest("EnumerateInstances", cimClassParameter("No_Class")));
    const HttpReply error = client.receive();
    EXPECT_EQ(error.status, 200);
    EXPECT_EQ(sensorsOf(error), -1);
    client.send(allSensors);
    HttpReply cut = client.receive();
    EXPECT_EQ(sensorsOf(cut), 3);
    cut.body.resize(cut.body.size() - 1);
    EXPECT_EQ(sensorsOf(cut), -1);
}

TEST_F(ServeSoakTest, NothingStaysBehindWhileTheMachineChanges)
{
    readAllChips();
    const std::size_t descriptorsAtRest = settledDescriptors();
    soak(3s);
    ASSERT_TRUE(waitForDescriptors(descriptorsAtRest)) << descriptors();
    const std::size_t residentBefore = residentKilobytes();
    soak(soakTime());
    EXPECT_TRUE(waitForDescriptors(descriptorsAtRest)) << descriptors();
    const std::size_t residentAfter = residentKilobytes();
    RecordProperty("answers", seen_.answers);
    RecordProperty("scrapes", seen_.scrapes);
    RecordProperty("withoutChip", seen_.withoutChip);
    RecordProperty("residentBefore", std::to_string(residentBefore));
    RecordProperty("residentAfter", std::to_string(residentAfter));
    EXPECT_GT(seen_.answers, 100);
    EXPECT_GT(seen_.scrapes, 100);
    EXPECT_GT(seen_.withChip, 0);
    EXPECT_GT(seen_.withoutChip, 0);
    EXPECT_LT(residentAfter, residentBefore + std::size_t{SENSOR_PROFILE_SOAK_GROWTH} * 1024);
    EXPECT_EQ(server_->end(SIGTERM).code, 0) << server_->log();
}

} // namespace
