// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The metrics of `sensorctl metrics` and `sensorctl serve`, as Prometheus reads them. The expected
// output is that of `sensorctl metrics --model schema/demo-model.json` without the harvest's
// duration and source.

#include "tests/support/HttpClient.h"
#include "tests/support/TlsClient.h"
#include "tests/tools/Scrape.h"
#include "tests/tools/ServeTest.h"

#include <gmock/gmock.h>

#include <sys/stat.h>

#include <filesystem>
#include <future>

namespace {

using namespace Testing;
using testing::AllOf;
using testing::Contains;
using testing::HasSubstr;
using testing::Not;
using testing::StartsWith;

const std::string demonstration = SENSOR_PROFILE_SOURCE_DIR "/schema/demo-model.json";
const std::string golden = SENSOR_PROFILE_SOURCE_DIR "/tests/data/tools/demonstration-metrics.txt";

std::string get(const std::string& fields = "", const std::string& method = "GET")
{
    return method + " /metrics HTTP/1.1\r\nHost: localhost\r\n" + fields + "\r\n";
}

// Returns which sources are up.
std::map<std::string, double> sourcesIn(const std::string& text)
{
    std::map<std::string, double> states;
    for (const Series& each : seriesIn(text))
        if (each.name == "sensor_profile_source_up") {
            EXPECT_TRUE(states.emplace(each.labels.at("source"), each.value).second);
        }
    return states;
}

class MetricsTest : public ServeTest {
protected:
    // Returns the metrics of the sources, which the command reads through the provider. Expects
    // those of a server, which reads records, to be the same.
    std::string metricsOfSources(const std::string& sources) const
    {
        const std::map<std::string, std::string> environment = {{"VORN_INSTRUMENTATION", sources}};
        const std::string text = run({"metrics"}, {.environment = environment}).out;
        const ServerProcess server({}, environment);
        const std::string served = ask(HttpClient(server.port()), get()).body;
        EXPECT_THAT(comparable(served), StartsWith(comparable(text)));
        EXPECT_EQ(sourcesIn(served), sourcesIn(text));
        return text;
    }

    // Returns the metrics of a machine that consists of the nodes.
    std::string metricsOf(const std::string& nodes) const
    {
        return metricsOfSources("model:" + model(nodes));
    }
};

TEST_F(MetricsTest, OfTheDemonstrationAreTheGoldenOutput)
{
    const Ended ended = run({"metrics", "--model", demonstration});
    EXPECT_EQ(ended.code, 0);
    EXPECT_EQ(ended.err, "");
    EXPECT_EQ(comparable(ended.out), contentOf(golden));
}

TEST_F(MetricsTest, PromtoolAcceptsThemWithoutAWarning)
{
    const std::string file =
        folder_.write("metrics", run({"metrics", "--model", demonstration}).out);
    const Ended ended = run({"-c", "promtool check metrics <" + file}, {.program = "/bin/sh"});
    EXPECT_EQ(ended.code, 0);
    EXPECT_EQ(ended.out + ended.err, "");
}

TEST_F(MetricsTest, AbsentReadingIsAnAbsentSeries)
{
    const std::string text = metricsOf(
        R"({ "type": "temperature", "path": "/c/a", "description": "A", "status": 13,
             "baseUnits": 2, "upperCritical": 90.5 })");
    EXPECT_THAT(text, Not(HasSubstr("\nsensor_profile_reading_celsius")));
    const std::string labels = R"({device_id="A:/c/a",chip="c",device="",label="A",)";
    EXPECT_THAT(linesOf(text),
        AllOf(Contains("sensor_profile_limit_celsius" + labels + "limit=\"upper_critical\"} 90"),
            Contains("sensor_profile_state" + labels + "state=\"lost\"} 1"),
            Contains("sensor_profile_state" + labels + "state=\"normal\"} 0")));
}

TEST_F(MetricsTest, ExactlyOneStateOfASensorIsSet)
{
    std::map<std::string, int> set;
    for (const Series& each : seriesIn(run({"metrics", "--model", demonstration}).out))
        if (each.name == "sensor_profile_state")
            set[each.labels.at("device_id")] += each.value == 1 ? 1 : 0;
    EXPECT_EQ(set.size(), 40U);
    EXPECT_THAT(set, testing::Each(testing::Pair(testing::_, 1)));
}

TEST_F(MetricsTest, OfAnotherUnitIsNoFamily)
{
    const std::string text = metricsOf(
        R"({ "type": "temperature", "path": "/c/a", "description": "A", "status": 1,
             "baseUnits": 3, "reading": 100, "upperCritical": 190 },
           { "type": "temperature", "path": "/c/b", "description": "B", "status": 1,
             "reading": 40 })");
    std::map<std::string, double> readings;
    for (const Series& each : seriesIn(text)) {
        EXPECT_THAT(each.name, Not(StartsWith("sensor_profile_limit"))); // 190 degrees Fahrenheit
        if (each.name == "sensor_profile_reading_celsius")
            readings[each.labels.at("label")] = each.value;
    }
    EXPECT_EQ(readings, (std::map<std::string, double>{{"B", 40}}));
}

TEST_F(MetricsTest, LabelsAreEscapedAndStayWhole)
{
    std::string name = "\"quoted\" back\\slash\nline\ttab \x7F € \xEF\xBB\xBF";
    for (unsigned plane = 1; plane <= 16; ++plane) // U+1F9AD, U+2F9AD, ...
        name += {static_cast<char>(0xF0 | (plane >> 2)),
            static_cast<char>(0x80 | (plane & 3) << 4 | 0xF), '\xA6', '\xAD'};
    nlohmann::json node = {{"type", "voltage"}, {"path", "/c/ä \"x\""}, {"description", name},
        {"status", 1}, {"baseUnits", 5}, {"reading", 1.25}};
    const std::string text = metricsOf(node.dump());
    const auto all = seriesIn(text);
    const auto reading = std::find_if(all.begin(), all.end(),
        [](const Series& each) { return each.name == "sensor_profile_reading_volts"; });
    ASSERT_NE(reading, all.end());
    EXPECT_EQ(reading->labels.at("label"), name);
    EXPECT_EQ(reading->value, 1.25);
    const Ended ended = run({"-c", "promtool check metrics <" + folder_.write("metrics", text)},
        {.program = "/bin/sh"});
    EXPECT_EQ(ended.out + ended.err, "");
}

TEST_F(MetricsTest, SensorsWithOneLabelDifferByTheirIdentifier)
{
    const auto all = seriesIn(run({"metrics", "--model", smallModel()}).out);
    std::set<std::string> fans;
    for (const Series& each : all)
        if (each.name == "sensor_profile_health" && each.labels.at("label") == "Fan")
            fans.insert(each.labels.at("device_id"));
    EXPECT_EQ(fans, (std::set<std::string>{"Fan:/board/fan1", "Fan:/board/fan2"}));
}

TEST_F(MetricsTest, FileIsReplacedAndReadableByAll)
{
    const std::string file = (folder_.path() / "sensors.prom").string();
    const ::mode_t before = ::umask(077);
    const Ended ended = run({"metrics", "--model", demonstration, "--textfile", file});
    ::umask(before);
    EXPECT_EQ(ended.code, 0);
    EXPECT_EQ(ended.out + ended.err, "");
    EXPECT_EQ(comparable(contentOf(file)), contentOf(golden));
    EXPECT_EQ(std::filesystem::status(file).permissions(), std::filesystem::perms(0644));
    const auto inode = [&] {
        struct stat status {};
        ::stat(file.c_str(), &status);
        return status.st_ino;
    };
    const auto first = inode();
    EXPECT_EQ(run({"metrics", "--model", demonstration, "--textfile", file}).code, 0);
    EXPECT_NE(inode(), first);
    EXPECT_EQ(run({"metrics", "--model", demonstration, "--textfile", "/none/x"}).code, 1);
}

TEST_F(MetricsTest, MachineWithoutSensorsIsReported)
{
    const Ended ended = run({"metrics", "--model", model("")});
    EXPECT_EQ(ended.code, 3);
    EXPECT_THAT(ended.out, HasSubstr("\nsensor_profile_sensors{kind=\"fan\"} 0\n"));
    EXPECT_THAT(ended.err, HasSubstr("this machine has no sensors"));
}

using States = std::map<std::string, double>;

TEST_F(MetricsTest, SourceThatFailsTakesNoSensorsOfOthersAway)
{
    const std::string broken = "model:" + folder_.write("broken.json", "{");
    const std::string whole = "model:" + smallModel();
    const std::string damaged = "ipmi:" + folder_.write("ipmi.json", "{");
    for (const std::string& list :
        {whole + "," + broken, broken + "," + whole, whole + "," + damaged}) {
        const std::string text = metricsOfSources(list);
        States expected{{whole, 1}, {broken, 0}};
        if (list.ends_with(damaged))
            expected = {{whole, 1}, {damaged, 0}};
        EXPECT_EQ(sourcesIn(text), expected);
        std::set<std::string> sensors;
        for (const Series& each : seriesIn(text))
            if (each.name == "sensor_profile_health")
                sensors.insert(each.labels.at("device_id"));
        EXPECT_EQ(sensors, (std::set<std::string>{"CPU 1:/cpu0/temp1", "CPU 2:/cpu1/temp1",
                               "+12V:/board/in1", "Fan:/board/fan1", "Fan:/board/fan2"}))
            << list;
    }
    EXPECT_EQ(sourcesIn(metricsOfSources(whole + "," + whole)), (States{{whole, 1}}));
    EXPECT_EQ(sourcesIn(metricsOfSources(broken)), (States{{broken, 0}}));
    EXPECT_EQ(
        sourcesIn(metricsOfSources("hwmon:fast," + whole)), (States{{"hwmon", 0}, {whole, 1}}));
}

TEST_F(MetricsTest, OddDescriptionsAreThoseOfTheProvider)
{
    const nlohmann::json machine = {
        {"nodes", {{{"type", "temperature"}, {"path", "/c/a"}, {"description", " A"}},
                      {{"type", "temperature"}, {"path", "/c/b"}, {"description", "B \t"}},
                      {{"type", "temperature"}, {"path", "/c/c "}, {"description", "C: x:"}},
                      {{"type", "temperature"}, {"path", "/c\n/d"}, {"description", "D\n"}},
                      {{"type", "temperature"}, {"path", "e"}, {"description", ":"}}}}};
    const std::string source = "model:" + folder_.write("odd.json", machine.dump());
    const std::string text = metricsOfSources(source);
    EXPECT_EQ(sourcesIn(text), (States{{source, 1}}));
    std::map<std::string, std::string> chips;
    for (const Series& each : seriesIn(text))
        if (each.name == "sensor_profile_health")
            chips[each.labels.at("device_id")] = each.labels.at("chip");
    EXPECT_EQ(chips, (std::map<std::string, std::string>{{"A:/c/a", "c"}, {"B \t:/c/b", "c"},
                         {"C: x::/c/c", "c"}, {"D\n:/c\\n/d", "c\\n"}, {"::e", "/"}}));
    const std::string expected = source.substr(source.find('/'));
    const Ended ended = run({"check", "--model", expected, "--expect", expected});
    EXPECT_THAT(ended.out, Not(HasSubstr("missing")));
}

// ---- The server ----

TEST_F(MetricsTest, ServerGivesThoseOfTheCommandAndItsOwn)
{
    const ServerProcess server(withModel());
    ask(HttpClient(server.port()));
    ask(HttpClient(server.port()), request("", "EnumerateInstances"));
    ask(HttpClient(server.port()), request("", "CreateEverything"));
    ask(HttpClient(server.port()), cimRequest("GetClass", cimClassParameter("No_Class")));
    ask(HttpClient(server.port()), "GET /no-page HTTP/1.1\r\nHost: localhost\r\n\r\n");
    const HttpReply reply = ask(HttpClient(server.port()), get());
    EXPECT_EQ(reply.status, 200);
    EXPECT_EQ(reply.field("content-type"), "text/plain; version=0.0.4; charset=utf-8");
    EXPECT_EQ(reply.field("vary"), "Accept");
    const std::string here = comparable(run({"metrics", "--model", smallModel()}).out);
    EXPECT_THAT(comparable(reply.body), StartsWith(here));
    const std::string requests = "sensor_profile_requests_total{operation=";
    EXPECT_THAT(linesOf(reply.body),
        AllOf(Contains(requests + "\"EnumerateInstanceNames\",result=\"ok\"} 1"),
            Contains(requests + "\"EnumerateInstances\",result=\"ok\"} 1"),
            Contains(requests + "\"GetClass\",result=\"CIM_ERR_NOT_FOUND\"} 1"),
            Contains(requests + "\"other\",result=\"CIM_ERR_NOT_SUPPORTED\"} 1"),
            Contains(requests + "\"PullInstancePaths\",result=\"ok\"} 0"),
            Contains("sensor_profile_responses_total{code=\"200\"} 4"),
            Contains("sensor_profile_responses_total{code=\"404\"} 1"),
            Contains("sensor_profile_held_objects 0")));
    const Ended ended =
        run({"-c", "promtool check metrics <" + folder_.write("metrics", reply.body)},
            {.program = "/bin/sh"});
    EXPECT_EQ(ended.out + ended.err, "");
}

TEST_F(MetricsTest, ServerReadsWhatTheProviderPublishes)
{
    nlohmann::json nodes;
    for (const char* const type : {"temperature", "voltage", "tachometer"})
        for (unsigned status = 0; status <= 27; ++status)
            for (const double reading : {0.0, -12.3456, 3.3, 1e300}) {
                const std::string number = std::to_string(nodes.size());
                nodes.push_back({{"type", type}, {"path", "/" + number}, {"status", status},
                    {"description", " Sensor\t" + number + ": "}, {"reading", reading},
                    {"possibleStates", {1, 12, 16, 20, 21, 22, 23, 24, 25, 26, status}},
                    {"baseUnits", std::array{2, 5, 19, 7, 0, 900}.at(nodes.size() % 6)},
                    {"lowerNonCritical", reading / 2}, {"upperNonCritical", 1},
                    {"lowerCritical", 0}, {"upperCritical", 2}, {"lowerFatal", -4.0005},
                    {"upperFatal", 5e11}});
            }
    const std::string source =
        "model:" + folder_.write("all.json", nlohmann::json{{"nodes", std::move(nodes)}}.dump());
    const std::string twice = source + "," + source; // of two with one DeviceID, one is published
    const std::string expected = comparable(metricsOfSources(twice));
    EXPECT_EQ(countOf(expected, "\nsensor_profile_health{"), 3U * 28 * 4);
    // A server that is given a provider reads through it, too.
    const ServerProcess server({"--provider", sensorLibrary}, {{"VORN_INSTRUMENTATION", twice}});
    EXPECT_THAT(comparable(ask(HttpClient(server.port()), get()).body), StartsWith(expected));
}

TEST_F(MetricsTest, OpenEnumerationsHoldObjects)
{
    const ServerProcess server(withModel());
    ask(HttpClient(server.port()), cimRequest("OpenEnumerateInstances",
                                       cimClassParameter("ZUMLO_NumericSensor") +
                                           cimParameter("MaxObjectCount", "<VALUE>1</VALUE>")));
    EXPECT_THAT(linesOf(ask(HttpClient(server.port()), get()).body),
        Contains("sensor_profile_held_objects 5"));
}

TEST_F(MetricsTest, OpenMetricsIsGivenToThoseWhoPreferIt)
{
    const ServerProcess server({"--model", demonstration});
    const auto formOf = [&](const std::string& fields) {
        return ask(HttpClient(server.port()), get(fields)).field("content-type").substr(0, 16);
    };
    EXPECT_EQ(formOf(acceptOfPrometheus), "application/open");
    EXPECT_EQ(formOf("Accept: text/plain;q=0.5, application/openmetrics-text;q=0.4\r\n"),
        "text/plain; vers");
    EXPECT_EQ(formOf("Accept: */*\r\n"), "text/plain; vers");
    EXPECT_EQ(formOf("Accept: application/json\r\n"), "text/plain; vers");

    // The parser of the Python client is strict.
    const HttpReply reply = ask(HttpClient(server.port()), get(acceptOfPrometheus));
    const Ended ended = run({"-c", openMetricsParser, folder_.write("open", reply.body)},
        {.program = "/usr/bin/python3"});
    EXPECT_EQ(ended.err, "");
    const HttpReply text = ask(HttpClient(server.port()), get());
    EXPECT_EQ(ended.out, std::to_string(seriesIn(text.body).size()) + "\n");
}

TEST_F(MetricsTest, SourceThatFailsWhileServingIsShown)
{
    const std::string file = smallModel();
    const ServerProcess server({"--model", file});
    const std::string up = "sensor_profile_source_up{source=\"model:" + file + "\"} ";
    EXPECT_THAT(linesOf(ask(HttpClient(server.port()), get()).body), Contains(up + "1"));
    folder_.write("model.json", "no JSON");
    EXPECT_THAT(linesOf(ask(HttpClient(server.port()), get()).body), Contains(up + "0"));
    smallModel();
    EXPECT_THAT(linesOf(ask(HttpClient(server.port()), get()).body), Contains(up + "1"));
}

TEST_F(MetricsTest, ServerThatDemandsASignInDemandsItOfScrapesToo)
{
    const ServerProcess server(
        encrypted("localhost", {"--passwords", secret("passwords", userLine)}));
    TlsClient client(server.port("https"));
    client.send(get());
    EXPECT_EQ(client.receive().status, 401);
    client.send(get(asAnn));
    EXPECT_EQ(client.receive().status, 200);
}

TEST_F(MetricsTest, ScrapesOfTenThousandSensorsAtOnceShareHarvests)
{
    std::string nodes;
    for (int i = 0; i < 10'000; ++i) {
        const std::string number = std::to_string(i);
        nodes += (i == 0 ? "" : ",") + std::string(R"({"type": "temperature", "path": "/b/)") +
                 number + R"(", "description": "Sensor )" + number +
                 R"(", "status": 1, "baseUnits": 2, "reading": 41, "upperCritical": 95})";
    }
    const ServerProcess server({"--model", model(nodes)});
    std::vector<std::future<HttpReply>> scrapes;
    std::set<std::string> harvests; // by their duration
    for (const std::string& fields : {acceptOfPrometheus, std::string(), acceptOfPrometheus,
             std::string(), std::string(), std::string()})
        scrapes.push_back(std::async(std::launch::async,
            [&server, fields] { return ask(HttpClient(server.port()), get(fields)); }));
    for (std::future<HttpReply>& each : scrapes) {
        const HttpReply reply = each.get();
        EXPECT_EQ(reply.status, 200);
        EXPECT_EQ(countOf(reply.body, "\nsensor_profile_health{"), 10'000U);
        const std::string duration = "\nsensor_profile_harvest_duration_seconds ";
        const std::size_t at = reply.body.find(duration) + duration.size();
        harvests.insert(reply.body.substr(at, reply.body.find('\n', at) - at));
    }
    EXPECT_LT(harvests.size(), scrapes.size());
}

} // namespace
