// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Resources beside the operations, as clients read them.

#include "host/http/ResourceCheck.h"
#include "host/http/Service.h"
#include "tests/host/http/Hashes.h"
#include "tests/host/http/HttpTest.h"
#include "tests/support/LogCapture.h"

#include <unistd.h>

#include <array>
#include <future>

namespace {

using namespace HttpTests;
using Host::Http::HttpError;
using Host::Http::RequestHead;
using Host::Http::weightOf;
using testing::HasSubstr;

// Has a representation that names the requested target, unless a test sets what it does.
class StubResource : public Host::Http::Resource {
public:
    Host::Http::Representation represent(const RequestHead& head) override
    {
        ++calls;
        if (work)
            work();
        return {{{"Content-Type", "text/x-stub"}},
            std::make_shared<const std::string>("content of " + head.target + more)};
    }

    std::function<void()> work;
    std::string more; // of the content
    std::atomic<int> calls{0};
};

const std::string asAnn = "Authorization: Basic YW5uOnNlY3JldA==\r\n";

std::string get(const std::string& fields = "Host: localhost\r\n",
    const std::string& target = "/stub", const std::string& method = "GET")
{
    return method + " " + target + " HTTP/1.1\r\n" + fields + "\r\n";
}

class ResourceTest : public HttpTest {
protected:
    ResourceTest() { resources.emplace("/stub", stub); }

    void demandPassword()
    {
        passwords =
            std::make_shared<const Host::Http::Passwords>("ann:" + bcrypt + "\n", "passwords");
    }

    StubResource stub;
};

TEST_F(ResourceTest, IsReadByGet)
{
    start();
    const HttpReply reply = ask(get());
    EXPECT_EQ(reply.status, 200);
    EXPECT_EQ(reply.field("content-type"), "text/x-stub");
    EXPECT_EQ(reply.body, "content of /stub");
    EXPECT_EQ(operations.calls, 0);
}

TEST_F(ResourceTest, IsFoundByItsDecodedPathAndGetsTheWholeTarget)
{
    start();
    EXPECT_EQ(ask(get("Host: localhost\r\n", "/%73tub?a=b")).body, "content of /%73tub?a=b");
    EXPECT_EQ(ask(get("Host: localhost\r\n", "http://localhost/stub")).status, 200);
    EXPECT_EQ(ask(get("Host: localhost\r\n", "/stub/more")).status, 404);
}

TEST_F(ResourceTest, HeadGivesTheFieldsOfGetWithoutTheContent)
{
    start();
    HttpClient client = connect();
    client.send(get("Host: localhost\r\nConnection: close\r\n", "/stub", "HEAD"));
    std::string all;
    for (std::string part = client.receiveSome(); !part.empty(); part = client.receiveSome())
        all += part;
    EXPECT_THAT(all, testing::StartsWith("HTTP/1.1 200 "));
    EXPECT_THAT(all, HasSubstr("Content-Type: text/x-stub\r\n"));
    EXPECT_THAT(all, HasSubstr("Content-Length: 16\r\n"));
    EXPECT_THAT(all, testing::EndsWith("\r\n\r\n"));
}

TEST_F(ResourceTest, OtherMethodsAreNotAllowed)
{
    start();
    for (const char* const method : {"POST", "PUT", "DELETE", "OPTIONS", "M-POST"}) {
        const HttpReply reply =
            ask(get("Host: localhost\r\nContent-Length: 0\r\n", "/stub", method));
        EXPECT_EQ(reply.status, 405) << method;
        EXPECT_EQ(reply.field("allow"), "GET, HEAD") << method;
    }
    EXPECT_EQ(stub.calls, 0);
}

TEST_F(ResourceTest, BodyOfAGetIsIgnoredAndTheNextRequestAnswered)
{
    start();
    HttpClient client = connect();
    client.send(get("Host: localhost\r\nContent-Length: 4\r\n") + "body" + get());
    EXPECT_EQ(client.receive().body, "content of /stub");
    EXPECT_EQ(client.receive().body, "content of /stub");
}

TEST_F(ResourceTest, ThroughALoopbackAddressTheHostMustBeThisMachine)
{
    start();
    std::array<char, 256> name{};
    ASSERT_EQ(::gethostname(name.data(), name.size() - 1), 0);
    for (const std::string host : {"localhost", "LOCALHOST:80", "127.0.0.1", "127.1.2.3:5988",
             "[::1]", "[::1]:5988", static_cast<const char*>(name.data())})
        EXPECT_EQ(ask(get("Host: " + host + "\r\n")).status, 200) << host;
    for (const std::string host :
        {"attacker.example", "attacker.example:5988", "localhost.example", "127.0.0.1.example",
            "192.0.2.1", "[2001:db8::1]:80", "[::1", "::1", "", "[", "0.0.0.0"}) {
        const HttpReply reply = ask(get("Host: " + host + "\r\n"));
        EXPECT_EQ(reply.status, 421) << host;
        EXPECT_THAT(reply.body, HasSubstr("the Host must be localhost"));
    }
    EXPECT_EQ(ask(get("")).status, 400);
    EXPECT_EQ(ask("GET /stub HTTP/1.0\r\n\r\n").status, 200);
    // Operations of existing clients take any.
    EXPECT_EQ(ask("POST /cimom HTTP/1.1\r\nHost: proxy.example\r\n" +
                  post().substr(post().find("\r\n", post().find("Host:")) + 2))
                  .status,
        200);
}

TEST_F(ResourceTest, HostDoesNotMatterThroughOtherAddresses)
{
    RequestHead head{"GET", "/stub", "HTTP/1.1", {{"Host", "monitored.example:5989"}}};
    EXPECT_NO_THROW(checkResourceRequest(head, false));
    EXPECT_THROW(checkResourceRequest(head, true), HttpError);
}

TEST_F(ResourceTest, IsReadOnlyAfterASignIn)
{
    demandPassword();
    start();
    EXPECT_EQ(ask(get()).status, 401);
    EXPECT_EQ(stub.calls, 0);
    EXPECT_EQ(ask(get("Host: localhost\r\n" + asAnn)).status, 200);
}

TEST_F(ResourceTest, WaitsForNoOperationAndNoOperationWaitsForIt)
{
    limits.workers = 1;
    demandPassword();
    std::promise<void> goOn;
    const std::shared_future<void> signal = goOn.get_future().share();
    operations.doFirst([signal](const Message&, const Caller&) { signal.wait(); });
    start();
    HttpClient occupying = connect();
    occupying.send(post(asAnn));
    ASSERT_TRUE(Testing::waitUntil([this] { return operations.calls == 1; }));
    EXPECT_EQ(ask(get("Host: localhost\r\n" + asAnn)).status, 200);
    goOn.set_value();
    EXPECT_EQ(occupying.receive().status, 200);

    std::promise<void> goOnReading;
    stub.work = [&, reading = goOnReading.get_future().share()] { reading.wait(); };
    HttpClient reading = connect();
    reading.send(get("Host: localhost\r\n" + asAnn));
    ASSERT_TRUE(Testing::waitUntil([this] { return stub.calls == 2; }));
    EXPECT_EQ(ask(post(asAnn)).status, 200);
    goOnReading.set_value();
    EXPECT_EQ(reading.receive().status, 200);
}

TEST_F(ResourceTest, PagesOfOtherSitesMayOnlyLeadThere)
{
    start();
    const std::string local = "Host: localhost\r\nSec-Fetch-Site: ";
    EXPECT_EQ(ask(get(local + "cross-site\r\nSec-Fetch-Mode: no-cors\r\n")).status, 403);
    EXPECT_EQ(ask(get(local + "cross-site\r\n")).status, 403);
    EXPECT_EQ(stub.calls, 0);
    EXPECT_EQ(ask(get(local + "cross-site\r\nSec-Fetch-Mode: navigate\r\n")).status, 200);
    EXPECT_EQ(ask(get(local + "same-origin\r\nSec-Fetch-Mode: cors\r\n")).status, 200);
}

TEST_F(ResourceTest, TooManyReadersAtATimeAreRefused)
{
    std::promise<void> goOn;
    stub.work = [signal = goOn.get_future().share()] { signal.wait(); };
    limits.maximumQueue = 0;
    start();
    std::vector<HttpClient> readers;
    for (std::size_t i = 0; i < Host::Http::maximumReaders; ++i) {
        readers.push_back(connect());
        readers.back().send(get());
    }
    ASSERT_TRUE(
        Testing::waitUntil([this] { return stub.calls == int{Host::Http::maximumReaders}; }));
    const HttpReply refusal = ask(get());
    EXPECT_EQ(refusal.status, 503);
    EXPECT_EQ(refusal.field("retry-after"), "1");
    goOn.set_value();
    for (HttpClient& each : readers)
        EXPECT_EQ(each.receive().status, 200);
}

TEST_F(ResourceTest, RefusalIsLoggedWithMethodAndTarget)
{
    const Testing::LogCapture log(4000);
    start();
    ask(get("Host: attacker.example\r\n"));
    ask(get("Host: localhost\r\nContent-Length: 0\r\n", "/stub", "PUT"));
    ask(get(""));
    std::vector<std::string> texts;
    for (const Testing::LogLine& line : log.log())
        texts.push_back(line.text);
    EXPECT_THAT(texts, testing::ElementsAre(testing::StartsWith("421 to 127.0.0.1, GET /stub: "),
                           testing::StartsWith("405 to 127.0.0.1, PUT /stub: "),
                           testing::StartsWith("400 to 127.0.0.1, GET /stub: ")));
}

TEST_F(ResourceTest, ResponsesAreCountedByTheirStatus)
{
    demandPassword();
    start();
    ask(get());
    ask(post());
    ask(get("Host: localhost\r\n" + asAnn));
    ask(post(asAnn));
    stub.work = [] { throw std::runtime_error("broken"); };
    ask(get("Host: localhost\r\n" + asAnn));
    EXPECT_EQ(responses.get(), (std::map<unsigned, std::uint64_t>{{200, 2}, {401, 2}, {500, 1}}));
}

TEST_F(ResourceTest, MustBeFetchedInTheTimeOfARequest)
{
    using std::chrono::steady_clock;
    limits.requestTimeout = std::chrono::seconds(1);
    stub.more = std::string(std::size_t{16} << 20, 'x'); // more than the sockets take
    start();
    HttpClient client = connect();
    const auto begin = steady_clock::now();
    client.send(get());
    ASSERT_TRUE(client.hasReplyWithin(HttpClient::timeout));
    EXPECT_TRUE(server->waitUntilIdle(std::chrono::seconds(20)));
    EXPECT_LT(steady_clock::now() - begin, std::chrono::seconds(20));
}

TEST_F(ResourceTest, FailureIsAnswered)
{
    start();
    stub.work = [] { throw std::runtime_error("broken"); };
    EXPECT_EQ(ask(get()).status, 500);
    stub.work = [] { throw HttpError(503, "later"); };
    EXPECT_EQ(ask(get()).body, "later\n");
    stub.work = {};
    EXPECT_EQ(ask(get()).status, 200);
}

TEST_F(ResourceTest, MediaTypesHaveTheWeightThatTheRequestGivesThem)
{
    const auto weight = [](const std::string& accept) {
        return weightOf({"GET", "/", "HTTP/1.1", {{"Accept", accept}}}, "text/x-stub", "1.0.0");
    };
    EXPECT_EQ(weight("text/x-stub"), 1);
    EXPECT_EQ(weight("TEXT/X-Stub;version=1.0.0;q=0.5"), 0.5);
    EXPECT_EQ(weight("text/x-stub; version=\"1.0.0\" ; q=0.25 , */*;q=1"), 0.25);
    EXPECT_EQ(weight("text/x-stub;version=0.0.1,text/plain"), 0);
    EXPECT_EQ(weight("text/x-stub;version=0.0.1,text/x-stub;version=1.0.0;q=0.75"), 0.75);
    EXPECT_EQ(weight("*/*"), 0);
    for (const std::string malformed : {"x", "", "nan", "inf", "2", "-1"})
        EXPECT_EQ(weight("text/x-stub;q=" + malformed), 0) << malformed;
    EXPECT_EQ(weight(",,;,="), 0);
    EXPECT_EQ(weight(""), 0);
    EXPECT_EQ(weightOf({"GET", "/", "HTTP/1.1",
                           {{"Accept", "text/plain"}, {"Accept", "text/x-stub;q=0.5"}}},
                  "text/x-stub", "1.0.0"),
        0.5);
    EXPECT_EQ(weightOf({"GET", "/", "HTTP/1.1", {}}, "text/x-stub", "1.0.0"), 0);
}

} // namespace
