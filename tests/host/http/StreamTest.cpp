// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Resources that are streams, as clients read them.

#include "host/http/ResourceCheck.h"
#include "tests/host/http/HttpTest.h"
#include "tests/support/ErrorOf.h"
#include "tests/support/WaitUntil.h"

#include <condition_variable>
#include <mutex>

namespace {

using namespace HttpTests;
using Host::Http::RequestHead;

// What the streams of a test have in common.
struct Source {
    std::mutex mutex;
    std::condition_variable changed;
    std::vector<std::string> pieces;
    std::atomic<int> open{0};
};

class StubStream : public Host::Http::Stream {
public:
    explicit StubStream(Source& source) : source_(source) { ++source_.open; }
    ~StubStream() override { --source_.open; }

    std::shared_ptr<const std::string> next() override
    {
        std::unique_lock lock(source_.mutex);
        source_.changed.wait(lock, [&] { return isOver_ || at_ < source_.pieces.size(); });
        return isOver_ ? nullptr : std::make_shared<const std::string>(source_.pieces.at(at_++));
    }

    void end() noexcept override
    {
        const std::lock_guard lock(source_.mutex);
        isOver_ = true;
        source_.changed.notify_all();
    }

private:
    Source& source_;
    std::size_t at_ = 0;
    bool isOver_ = false;
};

class StreamResource : public Host::Http::Resource {
public:
    Host::Http::Representation represent(const RequestHead&) override
    {
        return {{{"Content-Type", "text/event-stream"}}, nullptr, 200,
            std::make_unique<StubStream>(source)};
    }

    void add(std::string piece)
    {
        const std::lock_guard lock(source.mutex);
        source.pieces.push_back(std::move(piece));
        source.changed.notify_all();
    }

    Source source;
};

class FileResource : public Host::Http::Resource {
public:
    Host::Http::Representation represent(const RequestHead&) override
    {
        return {{}, std::make_shared<const std::string>("file")};
    }
};

const std::string request = "GET /stream HTTP/1.1\r\nHost: localhost\r\n\r\n";

class StreamTest : public HttpTest {
protected:
    StreamTest()
    {
        resources.emplace("/stream", stream);
        resources.emplace("/file", file);
    }
    void TearDown() override { server.reset(); } // which uses the stream

    HttpClient openStream()
    {
        HttpClient client = connect();
        client.send(request);
        return client;
    }

    bool waitForOpen(int count)
    {
        return Testing::waitUntil([&] { return stream.source.open == count; });
    }

    static bool receives(HttpClient& client, const std::string& text)
    {
        std::string all;
        while (all.find(text) == std::string::npos) {
            const std::string part = client.receiveSome();
            if (part.empty())
                return false;
            all += part;
        }
        return true;
    }

    StreamResource stream;
    FileResource file;
};

TEST_F(StreamTest, PiecesArriveWhenTheyComeIntoBeing)
{
    start();
    stream.add("first");
    HttpClient client = openStream();
    EXPECT_TRUE(receives(client, "first"));
    EXPECT_FALSE(client.hasReplyWithin(std::chrono::milliseconds(50)));
    stream.add("second");
    EXPECT_TRUE(receives(client, "second"));
}

TEST_F(StreamTest, TakesNoSlotAndNoTimeoutEndsItWhileItWaits)
{
    limits.workers = 1;
    limits.idleTimeout = std::chrono::seconds(1);
    limits.requestTimeout = std::chrono::seconds(1);
    limits.answerTimeout = std::chrono::seconds(1);
    start();
    std::vector<HttpClient> clients;
    for (int i = 0; i < 32; ++i)
        clients.push_back(openStream());
    ASSERT_TRUE(waitForOpen(32));
    EXPECT_EQ(ask(post()).status, 200);
    std::this_thread::sleep_for(std::chrono::milliseconds(2500));
    stream.add("late");
    for (HttpClient& client : clients)
        EXPECT_TRUE(receives(client, "late"));
}

TEST_F(StreamTest, EndsSoonWhenTheClientClosesTheConnection)
{
    start();
    {
        const HttpClient client = openStream();
        ASSERT_TRUE(waitForOpen(1));
    }
    EXPECT_TRUE(waitForOpen(0));
}

TEST_F(StreamTest, EndsWhenTheClientDoesNotRead)
{
    limits.requestTimeout = std::chrono::seconds(1);
    start();
    HttpClient client = openStream();
    stream.add(std::string(std::size_t{32} << 20, 'x'));
    ASSERT_TRUE(waitForOpen(1));
    EXPECT_TRUE(waitForOpen(0));
}

TEST_F(StreamTest, ShutdownEndsItAtOnce)
{
    start();
    stream.add("first");
    HttpClient client = openStream();
    ASSERT_TRUE(receives(client, "first"));
    server->beginShutdown();
    EXPECT_TRUE(server->waitUntilIdle(std::chrono::milliseconds(500)));
    EXPECT_TRUE(receives(client, "0\r\n\r\n"));
}

TEST_F(StreamTest, ShutdownDoesNotWaitForAClientThatDoesNotRead)
{
    start();
    HttpClient client = openStream();
    stream.add(std::string(std::size_t{32} << 20, 'x'));
    ASSERT_TRUE(receives(client, "xxx"));
    server->beginShutdown();
    EXPECT_TRUE(server->waitUntilIdle(std::chrono::seconds(5)));
}

TEST_F(StreamTest, NewPasswordsEndIt)
{
    start();
    const HttpClient client = openStream();
    ASSERT_TRUE(waitForOpen(1));
    server->replacePasswords(nullptr);
    EXPECT_TRUE(waitForOpen(0));
}

TEST_F(StreamTest, HalfOfTheConnectionsOfAnAddressStayFreeForOtherRequests)
{
    limits.maximumConnectionsPerAddress = 4;
    start();
    const HttpClient first = openStream();
    const HttpClient second = openStream();
    ASSERT_TRUE(waitForOpen(2));
    const HttpReply refusal = ask(request);
    EXPECT_EQ(refusal.status, 503);
    EXPECT_EQ(refusal.field("retry-after"), "10");
    EXPECT_EQ(ask(post()).status, 200);
}

TEST_F(StreamTest, HalfOfAllConnectionsStayFreeForOtherRequests)
{
    limits.maximumConnections = 2;
    start();
    const HttpClient first = openStream();
    ASSERT_TRUE(waitForOpen(1));
    EXPECT_EQ(ask(request).status, 503);
}

TEST_F(StreamTest, HeadOpensNone)
{
    start();
    HttpClient client = connect();
    client.send("HEAD /stream HTTP/1.1\r\nHost: localhost\r\nConnection: close\r\n\r\n");
    while (!client.receiveSome().empty()) {}
    EXPECT_TRUE(waitForOpen(0));
}

TEST(QueryTest, IsDecodedAsFormsAreEncoded)
{
    using Query = std::vector<std::pair<std::string, std::string>>;
    const auto query = [](const std::string& target) {
        return Host::Http::queryOf({"GET", target, "HTTP/1.1", {}});
    };
    EXPECT_EQ(query("/x"), Query());
    EXPECT_EQ(query("/x?"), Query());
    EXPECT_EQ(query("/x?a=1&b+c=%26+%C2%B0&d&=e&a=2"),
        (Query{{"a", "1"}, {"b c", "& °"}, {"d", ""}, {"", "e"}, {"a", "2"}}));
}

TEST(WeightedElementsTest, AreInTheOrderOfTheField)
{
    const RequestHead head{"GET", "/", "HTTP/1.1",
        {{"accept-language", "de-AT, de;q=0.8"}, {"Accept-Language", "en;q=0"}}};
    const auto elements = Host::Http::weightedElements(head, "Accept-Language");
    ASSERT_EQ(elements.size(), 3U);
    EXPECT_EQ(elements[0].value, "de-AT");
    EXPECT_EQ(elements[0].weight, 1);
    EXPECT_EQ(elements[1].value, "de");
    EXPECT_EQ(elements[1].weight, 0.8);
    EXPECT_EQ(elements[2].weight, 0);
}

} // namespace
