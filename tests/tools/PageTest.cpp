// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The page of `sensorctl serve` and what it is fed from, as browsers read them.

#include "tests/support/TlsClient.h"
#include "tests/support/WaitUntil.h"
#include "tests/tools/ServeTest.h"

#include <gmock/gmock.h>

#include <unistd.h>

#include <chrono>
#include <csignal>
#include <list>
#include <numeric>

namespace {

using namespace Testing;
using nlohmann::json;
using testing::HasSubstr;
using testing::Not;

std::string get(const std::string& target, const std::string& moreFields = "")
{
    return "GET " + target + " HTTP/1.1\r\nHost: localhost\r\n" + moreFields + "\r\n";
}

std::string thinnedHour()
{
    return "/api/history?span=hour&points=60";
}

// Reads the events of a stream.
class Events {
public:
    // By a request of HTTP/1.0, whose answer has no chunks.
    explicit Events(std::uint16_t port) : client_(port)
    {
        client_.send("GET /api/events HTTP/1.0\r\nHost: localhost\r\n\r\n");
    }

    // Returns the data of the next event of that name; null where the stream ends.
    json next(const std::string& name)
    {
        const std::string begin = "event: " + name + "\ndata: ";
        for (;;) {
            const std::size_t at = received_.find(begin);
            const std::size_t end = received_.find("\n\n", std::min(at, received_.size()));
            if (at != std::string::npos && end != std::string::npos) {
                const std::string data =
                    received_.substr(at + begin.size(), end - at - begin.size());
                received_.erase(0, end + 2);
                return json::parse(data);
            }
            const std::string part = client_.receiveSome();
            if (part.empty())
                return nullptr;
            received_ += part;
        }
    }

private:
    HttpClient client_;
    std::string received_;
};

class PageTest : public ServeTest {
protected:
    static HttpReply read(
        const ServerProcess& server, const std::string& target, const std::string& fields = "")
    {
        return ask(HttpClient(server.port()), get(target, fields));
    }

    static json readJson(const ServerProcess& server, const std::string& target)
    {
        const HttpReply reply = read(server, target);
        EXPECT_EQ(reply.field("content-type"), "application/json");
        return json::parse(reply.body);
    }
};

TEST_F(PageTest, TextsOfSensorsAreNoMarkup)
{
    const ServerProcess server({"--model", model(R"({ "type": "temperature", "path": "/<b>/a",
        "description": "<script>alert('1')</script>&\"\u202e", "status": 26, "baseUnits": 2,
        "reading": 97, "upperCritical": 95.5 })")});
    const HttpReply page = read(server, "/");
    EXPECT_EQ(page.status, 200);
    EXPECT_EQ(page.field("content-type"), "text/html; charset=utf-8");
    EXPECT_THAT(page.body,
        HasSubstr("<bdi>&lt;script&gt;alert(&apos;1&apos;)&lt;/script&gt;&amp;&quot;\u202e</bdi>"));
    EXPECT_THAT(page.body, HasSubstr("<bdi>&lt;b&gt;</bdi>"));
    EXPECT_THAT(page.body, HasSubstr("97\u00a0°C"));
    EXPECT_THAT(page.body, HasSubstr("High critical 95\u00a0°C"));
    EXPECT_THAT(page.body, Not(HasSubstr("<script>")));
}

TEST_F(PageTest, NothingOfItIsFromElsewhere)
{
    const ServerProcess server(withModel());
    for (const char* const target : {"/", "/web/Main.js", "/web/icon.svg"}) {
        const HttpReply reply = read(server, target);
        EXPECT_THAT(reply.field("content-security-policy"), HasSubstr("default-src 'none';"));
        EXPECT_EQ(reply.field("x-content-type-options"), "nosniff");
        EXPECT_EQ(reply.field("referrer-policy"), "no-referrer");
        EXPECT_EQ(reply.field("set-cookie"), "");
    }
    EXPECT_EQ(
        ask(HttpClient(server.port()), "GET / HTTP/1.1\r\nHost: attacker.example\r\n\r\n").status,
        421);
}

TEST_F(PageTest, AllOfItNeedsASignIn)
{
    const ServerProcess server(
        encrypted("localhost", {"--passwords", secret("passwords", userLine)}));
    for (const char* const target :
        {"/", "/web/Main.js", "/api/sensors", "/api/events", "/api/history?span=hour&points=60"}) {
        const HttpReply reply = read(server, target);
        EXPECT_EQ(reply.status, 401) << target;
        EXPECT_NE(reply.field("www-authenticate"), "") << target;
    }
    EXPECT_EQ(read(server, "/", asAnn).status, 200);
    EXPECT_EQ(read(server, "/web/Main.js", asAnn).status, 200);

    TlsClient client(server.port("https"));
    client.send(get("/api/events", asAnn));
    std::string received;
    while (received.find("event: sensors") == std::string::npos) {
        const std::string part = client.receiveSome();
        ASSERT_NE(part, "");
        received += part;
    }
}

TEST_F(PageTest, IsInThePreferredLanguage)
{
    const ServerProcess server(withModel());
    const auto languageOf = [&](const std::string& accepted) {
        const HttpReply page = read(server, "/", accepted);
        EXPECT_EQ(page.field("vary"), "Accept-Language");
        return page.body.substr(page.body.find("lang=\"") + 6, 2);
    };
    EXPECT_EQ(languageOf(""), "en");
    EXPECT_EQ(languageOf("Accept-Language: DE-at, en;q=0.5\r\n"), "de");
    EXPECT_EQ(languageOf("Accept-Language: xx, fr;q=0.3, ja;q=0.4\r\n"), "ja");
    EXPECT_EQ(languageOf("Accept-Language: es;q=0\r\n"), "en");
}

TEST_F(PageTest, ClientsOfOperationsMaySendThemThere)
{
    const ServerProcess server(withModel());
    std::string operation = request();
    operation.replace(operation.find("/cimom"), 6, "/");
    const HttpReply reply = ask(HttpClient(server.port()), operation);
    EXPECT_EQ(reply.status, 200);
    EXPECT_EQ(sensorsIn(reply.body), 5U);
}

TEST_F(PageTest, FilesAreReadAgainOnlyWhenTheyHaveChanged)
{
    const ServerProcess server(withModel());
    const HttpReply plain = read(server, "/web/Main.js");
    const HttpReply compressed = read(server, "/web/Main.js", "Accept-Encoding: br, gzip\r\n");
    EXPECT_EQ(plain.field("content-type"), "text/javascript; charset=utf-8");
    EXPECT_EQ(plain.field("content-encoding"), "");
    EXPECT_EQ(plain.body, contentOf(SENSOR_PROFILE_SOURCE_DIR "/web/Main.js"));
    EXPECT_EQ(compressed.field("content-encoding"), "gzip");
    EXPECT_LT(compressed.body.size(), plain.body.size());
    EXPECT_NE(compressed.field("etag"), plain.field("etag"));
    const HttpReply known =
        read(server, "/web/Main.js", "If-None-Match: \"x\", W/" + plain.field("etag") + "\r\n");
    EXPECT_EQ(known.status, 304);
    EXPECT_EQ(known.body, "");
    EXPECT_EQ(known.field("etag"), plain.field("etag"));
    EXPECT_THAT(
        known.field("content-length"), testing::AnyOf("", std::to_string(plain.body.size())));
    EXPECT_EQ(read(server, "/web/Main.js", "If-None-Match: \"x\"\r\n").status, 200);
    EXPECT_EQ(
        read(server, "/web/Main.js", "Accept-Encoding: gzip;q=0\r\n").field("content-encoding"),
        "");
    for (const char* const absent : {"/web/page.html", "/web/Main.js.gz", "/web/../host.mof"})
        EXPECT_EQ(read(server, absent).status, 404) << absent;
}

TEST_F(PageTest, WithoutItsFilesTheRestWorks)
{
    const std::string moved = install();
    std::filesystem::remove_all(folder_.path() / "share/sensor-profile/web");
    const ServerProcess server(withModel({"--provider", sensorLibrary}), {}, moved);
    EXPECT_THAT(server.log(), HasSubstr("the page is not installed: "));
    EXPECT_EQ(read(server, "/").status, 404);
    EXPECT_THAT(read(server, "/").body, HasSubstr("the page is not installed: "));
    EXPECT_EQ(readJson(server, "/api/sensors").size(), 5U);
}

TEST_F(PageTest, ListIsTheDocumentOfTheCommand)
{
    const ServerProcess server(withModel());
    EXPECT_EQ(
        readJson(server, "/api/sensors"), json::parse(run(withModel({"list", "--json"})).out));
}

TEST_F(PageTest, ChangeIsSentWithinThreeSeconds)
{
    const ServerProcess server(withModel());
    Events events(server.port());
    EXPECT_EQ(events.next("sensors").size(), 5U);
    const auto begin = std::chrono::steady_clock::now();
    model(R"({ "type": "tachometer", "path": "/board/fan1", "description": "Fan", "status": 25,
        "baseUnits": 19, "reading": 0, "lowerNonCritical": 300 })");
    const json changes = events.next("changes");
    EXPECT_LT(std::chrono::steady_clock::now() - begin, std::chrono::seconds(3));
    EXPECT_EQ(changes["gone"].size(), 4U);
    ASSERT_EQ(changes["sensors"].size(), 1U);
    EXPECT_EQ(changes["sensors"][0]["state"], "Critical low");
}

TEST_F(PageTest, SourceThatCannotBeReadIsNamed)
{
    const std::string file = smallModel();
    const ServerProcess server({"--model", file});
    const std::string name = "model:" + file;
    folder_.write("model.json", "{broken");
    EXPECT_THAT(read(server, "/").body,
        HasSubstr("Not all sensors of \u2068" + name + "\u2069 can be read."));
    EXPECT_THAT(read(server, "/", "Accept-Language: de\r\n").body,
        HasSubstr("Nicht alle Sensoren von \u2068" + name + "\u2069 "));
    Events events(server.port());
    EXPECT_EQ(events.next("sources")["lost"], json::array({name}));
    smallModel();
    EXPECT_EQ(events.next("sources")["lost"], json::array());
    EXPECT_THAT(read(server, "/").body, Not(HasSubstr("Not all sensors")));
}

#ifdef SENSOR_PROFILE_MEMORY_IS_EXACT // sanitizers need much more
TEST_F(PageTest, HundredOpenPagesTakeLessThanTwentyMegabytes)
{
    std::string nodes;
    for (int i = 0; i < 1000; ++i)
        nodes += (i > 0 ? ", " : "") +
                 (R"({ "type": "voltage", "status": 1, "reading": 12.5, "path": "/c/)" +
                     std::to_string(i) + R"(", "description": "V )" + std::to_string(i) + "\" }");
    const ServerProcess server({"--model", model(nodes), "--max-connections-per-address", "256"});
    {
        Events(server.port()).next("sensors");
    }
    const std::size_t before = server.residentKilobytes();
    std::list<Events> pages;
    for (int i = 0; i < 100; ++i)
        pages.emplace_back(server.port());
    for (Events& each : pages)
        EXPECT_EQ(each.next("sensors").size(), 1000U);
    const std::size_t growth = server.residentKilobytes() - before;
    RecordProperty("kilobytes", std::to_string(growth));
    EXPECT_LT(growth, 20U << 10U);
}
#endif

#ifdef SENSOR_PROFILE_MEMORY_IS_EXACT
TEST_F(PageTest, HistoryTakesLessThanTwentyFiveKilobytesForASensor)
{
    constexpr std::size_t count = 2000;
    std::string nodes;
    for (std::size_t i = 0; i < count; ++i)
        nodes += (i > 0 ? ", " : "") +
                 (R"({ "type": "voltage", "status": 1, "reading": 12.5, "path": "/c/)" +
                     std::to_string(i) + R"(", "description": "V )" + std::to_string(i) + "\" }");
    const std::string file = model(nodes);
    const auto residentWith = [&](const std::string& history) {
        const std::string folder = (folder_.path() / history).string();
        std::filesystem::create_directory(folder);
        const ServerProcess server(
            {"--model", file, "--history", history == "off" ? history : folder});
        EXPECT_TRUE(waitUntil(
            [&] { return history == "off" || read(server, thinnedHour()).body.size() > count; }));
        EXPECT_EQ(readJson(server, "/api/sensors").size(), count);
        return server.residentKilobytes();
    };
    EXPECT_LT(residentWith("kept"), residentWith("off") + 25 * count);
}
#endif

TEST_F(PageTest, EndOfTheServerEndsTheStreams)
{
    ServerProcess server(withModel());
    Events events(server.port());
    EXPECT_FALSE(events.next("sensors").is_null());
    const auto begin = std::chrono::steady_clock::now();
    EXPECT_EQ(server.end(SIGTERM).code, 0);
    EXPECT_LT(std::chrono::steady_clock::now() - begin, std::chrono::seconds(2));
    EXPECT_TRUE(events.next("changes").is_null());
}

TEST_F(PageTest, HistorySurvivesARestart)
{
    const std::string folder = (folder_.path() / "state").string();
    std::filesystem::create_directory(folder);
    const auto samplesIn = [](const json& history) {
        const json& states = history["sensors"][0]["states"];
        return std::accumulate(states.begin(), states.end(), 0, [](int sum, const json& run) {
            return sum + (run[0].is_null() ? 0 : run[1].get<int>());
        });
    };
    const std::string target = "/api/history?span=hour&device=CPU+1:/cpu0/temp1";
    const auto waitForSample = [&](const ServerProcess& server) {
        return waitUntil([&] { return read(server, target).status == 200; });
    };
    {
        ServerProcess server(withModel({"--history", folder}));
        ASSERT_TRUE(waitForSample(server));
        EXPECT_EQ(samplesIn(readJson(server, target)), 1);
        EXPECT_EQ(server.end(SIGTERM).code, 0);
    }
    // The file is of a machine that has one sensor more.
    model(R"({ "type": "temperature", "path": "/cpu1/temp1", "description": "CPU 2", "status": 1,
        "baseUnits": 2, "reading": 50 })");
    const ServerProcess again(
        {"--model", (folder_.path() / "model.json").string()}, {{"STATE_DIRECTORY", folder}});
    ASSERT_TRUE(waitForSample(again));
    EXPECT_GE(samplesIn(readJson(again, target)), 1);
    EXPECT_EQ(readJson(again, target)["sensors"][0]["deviceId"], "CPU 1:/cpu0/temp1");
}

TEST_F(PageTest, DamagedHistoryIsReportedAndBeginsAnew)
{
    folder_.write("history", "damaged");
    ServerProcess server(withModel({"--history", folder_.path().string()}));
    EXPECT_THAT(server.log(), HasSubstr("the history begins anew: "));
    EXPECT_EQ(server.end(SIGTERM).code, 0);
    EXPECT_THAT(contentOf((folder_.path() / "history").string()), testing::StartsWith("\x1f\x8b"));
    EXPECT_EQ(contentOf((folder_.path() / "history.bad").string()), "damaged");
}

TEST_F(PageTest, FolderOfTheHistoryMustExist)
{
    const Ended ended = failing(withModel({"--history", "/proc/none", "--check"}));
    EXPECT_EQ(ended.code, 2);
    EXPECT_THAT(
        ended.err, HasSubstr("--history needs a folder or off: there is no folder /proc/none"));
}

TEST_F(PageTest, FolderOfTheHistoryThatCannotBeLookedUpIsAMistakeInTheCommandLine)
{
    const std::string tooLong(300, 'x');
    const Ended ended = failing(withModel({"--history", "/" + tooLong, "--check"}));
    EXPECT_EQ(ended.code, 2);
    EXPECT_THAT(ended.err, HasSubstr("--history needs a folder or off: there is no folder /xxx"));
}

TEST_F(PageTest, FolderOfTheHistoryIsThatOfOneServer)
{
    auto arguments = withModel({"--history", folder_.path().string(), "--port", "0"});
    if (::geteuid() == 0)
        arguments.insert(arguments.end(), {"--user", "root"});
    const ServerProcess server(arguments);
    const Ended ended = failing(arguments);
    EXPECT_EQ(ended.code, 1);
    EXPECT_THAT(ended.err, HasSubstr("another process keeps its history there"));
}

TEST_F(PageTest, HistoryCanBeOff)
{
    const ServerProcess server(
        withModel({"--history", "off"}), {{"STATE_DIRECTORY", "/proc/none"}});
    EXPECT_EQ(read(server, thinnedHour()).status, 404);
    EXPECT_EQ(readJson(server, thinnedHour())["error"], "the server keeps no history");
}

TEST_F(PageTest, ParametersOfTheHistoryAreChecked)
{
    const ServerProcess server(withModel());
    for (const char* const query : {"", "?span=week", "?span=day", "?span=hour",
             "?span=hour&points=61", "?span=day&points=60&device=a", "?span=day&device=a&device=a",
             "?span=day&device=a&device=b&device=c&device=d&device=e&device=f&device=g"}) {
        EXPECT_EQ(read(server, std::string("/api/history") + query).status, 400) << query;
        EXPECT_TRUE(readJson(server, std::string("/api/history") + query)["error"].is_string());
    }
    EXPECT_EQ(read(server, "/api/history?span=day&device=a").status, 404);
}

} // namespace
