// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Many clients of all kinds for a while: all that ask well are answered, and nothing stays behind.
// SENSOR_PROFILE_SOAK_SECONDS makes it longer.

#include "tests/host/http/HttpTest.h"
#include "tests/support/TemporaryFolder.h"
#include "tests/support/TlsClient.h"

#include <fstream>
#include <unistd.h>

namespace HttpTests {

namespace {

using Host::Http::Certificate;
using Testing::TlsClient;
using namespace std::chrono_literals;

std::chrono::seconds duration()
{
    const char* const wanted = std::getenv("SENSOR_PROFILE_SOAK_SECONDS");
    return std::chrono::seconds(wanted == nullptr ? 4 : std::atoi(wanted));
}

std::size_t residentKilobytes()
{
    std::ifstream status("/proc/self/statm");
    std::size_t total = 0;
    std::size_t resident = 0;
    status >> total >> resident;
    return resident * static_cast<std::size_t>(::sysconf(_SC_PAGESIZE)) / 1024;
}

class SoakTest : public HttpTest {
protected:
    SoakTest()
    {
        Testing::makeCertificate((folder_.path() / "one").string(), "one");
        certificate = Certificate::read(folder_.path() / "one.crt", folder_.path() / "one.key");
        limits.maximumConnections = 2000;
        limits.maximumConnectionsPerAddress = 2000;
        operations.answerWith(std::string(1000, 'x'));
        operations.doFirst([this](const Message& message, const Caller&) {
            if (message.methodName() == "Fail")
                throw std::runtime_error("failing");
            // For whoever comes next: now short, now in chunks.
            operations.answerWith(
                std::string(1000, 'x'), message.methodName() == "Large" ? 500 : 1);
        });
        auto sockets = Host::Http::listenOn({{{"127.0.0.1", 0}}, {{"127.0.0.1", 0}, true}});
        port = sockets[0].address().port();
        tlsPort_ = sockets[1].address().port();
        server.emplace(operations, std::move(sockets), limits, certificate);
    }

    template <typename Client>
    static void expectAnswer(Client& client, const std::string& request, int status = 200)
    {
        client.send(request);
        const HttpReply reply = client.receive();
        EXPECT_EQ(reply.status, status);
        if (status == 200) {
            EXPECT_EQ(reply.body.size() % 1000, 0U);
        }
    }

    void askWell()
    {
        HttpClient client = connect();
        for (int i = 0; i < 20; ++i)
            expectAnswer(client, cimRequest(i % 10 == 0 ? "Large" : "Small"));
    }
    void askEncrypted()
    {
        TlsClient client(tlsPort_);
        for (int i = 0; i < 5; ++i)
            expectAnswer(client, cimRequest("Large"));
    }
    void askBadly()
    {
        HttpClient client = connect();
        expectAnswer(client, post("", "<CIM/>"), 400);
        expectAnswer(client, cimRequest("Fail"), 500);
        client.send(post().substr(0, 150));
    }
    void breakOff()
    {
        HttpClient client = connect();
        client.send(cimRequest("Large"));
        client.receiveSome();
        client.closeHard();
    }

    // The clients of all kinds, so long.
    void soak(std::chrono::steady_clock::duration time)
    {
        const auto end = std::chrono::steady_clock::now() + time;
        std::vector<std::thread> clients;
        for (const auto kind : {&SoakTest::askWell, &SoakTest::askWell, &SoakTest::askEncrypted,
                 &SoakTest::askBadly, &SoakTest::breakOff})
            clients.emplace_back([this, end, kind] {
                try {
                    while (std::chrono::steady_clock::now() < end)
                        (this->*kind)();
                } catch (const std::exception& error) {
                    ADD_FAILURE() << error.what();
                }
            });
        for (std::thread& client : clients)
            client.join();
    }

    Testing::TemporaryFolder folder_;
    std::uint16_t tlsPort_ = 0;
};

TEST_F(SoakTest, NothingStaysBehind)
{
    soak(duration() / 2);
    [[maybe_unused]] const std::size_t before = residentKilobytes();
    soak(duration() / 2);
    EXPECT_GT(operations.calls, 100);
    EXPECT_TRUE(server->waitUntilIdle(10s));
    EXPECT_EQ(operations.answersAlive, 0);
#ifdef NDEBUG // the sanitizers keep what was freed
    EXPECT_LT(residentKilobytes(), before + 8 * 1024);
#endif
}

} // namespace

} // namespace HttpTests
