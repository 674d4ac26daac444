// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tests/host/http/HttpTest.h"
#include "tests/support/ErrorOf.h"
#include "tests/support/LogCapture.h"
#include "tests/support/TemporaryFolder.h"
#include "tests/support/TlsClient.h"

#include <csignal>
#include <sys/stat.h>

namespace HttpTests {

namespace {

using Host::Http::Certificate;
using testing::HasSubstr;
using Testing::makeCertificate;
using Testing::TlsClient;
using namespace std::chrono_literals;

class TlsTest : public HttpTest {
protected:
    void SetUp() override
    {
        makeCertificate(file("one"), "one");
        certificate = Certificate::read(file("one.crt"), file("one.key"));
        start({{{"127.0.0.1", 0}, true}});
    }

    std::string file(const std::string& name) const { return (folder_.path() / name).string(); }

    std::string problemWith(const std::string& certificateFile, const std::string& keyFile) const
    {
        const std::string error =
            Testing::errorOf([&] { Certificate::read(file(certificateFile), file(keyFile)); });
        return error.empty() ? "" : error.substr(folder_.path().string().size() + 1);
    }

    Testing::TemporaryFolder folder_;
};

TEST_F(TlsTest, AnswersAreTheSameAsWithout)
{
    operations.answerWith(std::string(1000, 'x'), 1000);
    TlsClient client(port);
    EXPECT_EQ(client.version(), "TLS1.3");
    EXPECT_EQ(client.subject(), "CN=one");
    for (int i = 0; i < 3; ++i) {
        client.send(post());
        EXPECT_EQ(client.receive().body, std::string(1'000'000, 'x'));
    }
}

TEST_F(TlsTest, OldVersionsAreRefused)
{
    EXPECT_EQ(TlsClient(port, "NORMAL:-VERS-ALL:+VERS-TLS1.2").version(), "TLS1.2");
    for (const char* const version : {"TLS1.1", "TLS1.0"})
        EXPECT_THROW(
            TlsClient(port, std::string("LEGACY:%VERIFY_ALLOW_BROKEN:-VERS-ALL:+VERS-") + version),
            std::runtime_error)
            << version;
}

TEST_F(TlsTest, PlainRequestsAreNotAnswered)
{
    HttpClient client = connect();
    client.send(post());
    std::string all;
    for (std::string some = client.receiveSome(); !some.empty(); some = client.receiveSome())
        all += some;
    EXPECT_EQ(all.find("HTTP"), std::string::npos);
    EXPECT_EQ(operations.calls, 0);
}

TEST_F(TlsTest, NewCertificateIsShownToNewConnections)
{
    TlsClient before(port);
    before.send(post());
    EXPECT_EQ(before.receive().status, 200);
    makeCertificate(file("two"), "two");
    server->replaceCertificate(Certificate::read(file("two.crt"), file("two.key")));
    certificate.reset();
    before.send(post());
    EXPECT_EQ(before.receive().status, 200);
    EXPECT_EQ(before.subject(), "CN=one");
    TlsClient after(port);
    EXPECT_EQ(after.subject(), "CN=two");
    after.send(post());
    EXPECT_EQ(after.receive().status, 200);
}

TEST_F(TlsTest, CertificatesMayBeReplacedWhileClientsCome)
{
    makeCertificate(file("two"), "two");
    std::atomic<bool> isOver = false;
    std::thread replacing([&] {
        for (int i = 0; !isOver; ++i) {
            const std::string name = i % 2 == 0 ? "two" : "one";
            server->replaceCertificate(Certificate::read(file(name + ".crt"), file(name + ".key")));
        }
    });
    for (int i = 0; i < 30; ++i) {
        TlsClient client(port);
        client.send(post());
        EXPECT_EQ(client.receive().status, 200);
    }
    isOver = true;
    replacing.join();
}

TEST_F(TlsTest, ClientsThatDoNotFinishTheHandshakeEnd)
{
    server.reset();
    limits.idleTimeout = 1s;
    start({{{"127.0.0.1", 0}, true}});
    HttpClient silent = connect();
    HttpClient begun = connect();
    begun.send(std::string_view("\x16\x03\x01\x02\x00\x01\x00", 7));
    for (HttpClient* const client : {&silent, &begun})
        while (!client->receiveSome().empty()) // the server sends an alert
            continue;
    TlsClient client(port);
    client.send(post());
    EXPECT_EQ(client.receive().status, 200);
}

TEST_F(TlsTest, ClientsThatAreTooManyEndBeforeTheHandshake)
{
    server.reset();
    limits.maximumConnections = 1;
    start({{{"127.0.0.1", 0}, true}});
    TlsClient client(port);
    beginPost(client);
    for (int i = 0; i < 3; ++i)
        EXPECT_TRUE(connect().isClosed());
    EXPECT_EQ(finishPost(client), 200);
}

TEST_F(TlsTest, RefusedClientsMayComeWhileCertificatesAreReplaced)
{
    server.reset();
    limits.maximumConnections = 1;
    start({{{"127.0.0.1", 0}, true}});
    certificate.reset(); // a replaced certificate is freed when no connection uses it
    TlsClient client(port);
    beginPost(client);
    std::jthread replacing([&](const std::stop_token& stop) {
        while (!stop.stop_requested())
            server->replaceCertificate(Certificate::read(file("one.crt"), file("one.key")));
    });
    // Several at once, so that the server accepts some whose handshake has already arrived.
    std::vector<std::jthread> clients;
    for (int i = 0; i < 8; ++i)
        clients.emplace_back([this] {
            for (int n = 0; n < 200; ++n)
                EXPECT_THROW(TlsClient{port}, std::runtime_error);
        });
    clients.clear();
    EXPECT_EQ(finishPost(client), 200);
}

// Writing to them would raise SIGPIPE, which terminates a process that does not ignore it.
TEST_F(TlsTest, ClientsThatVanishAmidTheirAnswerDoNoHarm)
{
    struct sigaction action = {};
    ASSERT_EQ(::sigaction(SIGPIPE, nullptr, &action), 0);
    ASSERT_EQ(action.sa_handler, SIG_DFL);
    operations.answerWith(std::string(10'000, 'x'), 1000);
    for (int i = 0; i < 20; ++i) {
        TlsClient client(port);
        client.send(post());
        client.receiveSome();
        client.closeHard();
    }
    expectNoAnswerAlive();
}

TEST_F(TlsTest, FilesThatCannotBeUsedAreNamed)
{
    EXPECT_EQ(problemWith("one.crt", "one.key"), "");
    EXPECT_THAT(problemWith("none", "one.key"), HasSubstr("none: No such file"));
    EXPECT_THAT(problemWith("one.crt", "none"), HasSubstr("none: No such file"));
    folder_.write("text", "no PEM");
    ::chmod(file("text").c_str(), 0600);
    EXPECT_THAT(problemWith("text", "one.key"), HasSubstr("text: no certificate in PEM form: "));
    EXPECT_THAT(problemWith("one.crt", "text"), HasSubstr("text: no private key in PEM form: "));
    EXPECT_THAT(problemWith("one.crt", "one.crt"), HasSubstr("one.crt: "));
    EXPECT_THAT(problemWith("one.key", "one.key"), HasSubstr("one.key: no certificate"));
    makeCertificate(file("two"), "two");
    EXPECT_EQ(problemWith("one.crt", "two.key"),
        "two.key: the private key does not belong to the certificate " + file("one.crt"));
    ::chmod(file("two.key").c_str(), 0644);
    EXPECT_THAT(problemWith("two.crt", "two.key"), HasSubstr("two.key: "));
    const std::string lock = "openssl pkcs8 -topk8 -v2 aes-256-cbc -passout pass:x -in '" +
                             file("one.key") + "' -out '" + file("locked") + "'";
    ASSERT_EQ(std::system(lock.c_str()), 0);
    ::chmod(file("locked").c_str(), 0600);
    EXPECT_EQ(
        problemWith("one.crt", "locked"), "locked: the private key is locked with a password");
}

TEST_F(TlsTest, CertificateWhoseTimeIsOverIsLogged)
{
    const std::string command = "openssl x509 -in '" + file("one.crt") + "' -signkey '" +
                                file("one.key") + "' -days -1 -out '" + file("old.crt") +
                                "' 2>/dev/null";
    ASSERT_EQ(std::system(command.c_str()), 0);
    const Testing::LogCapture log;
    EXPECT_EQ(problemWith("old.crt", "one.key"), "");
    ASSERT_EQ(log.log().size(), 1U);
    EXPECT_THAT(log.log()[0].text, HasSubstr("old.crt: the certificate's time is over"));
}

} // namespace

} // namespace HttpTests
