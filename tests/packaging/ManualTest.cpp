// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The manual pages are well formed, and name the options and properties that exist.

#include "tests/packaging/Installation.h"
#include "tests/support/ExportedNames.h"
#include "tests/tools/ToolTest.h"

#include <gmock/gmock.h>

#include <regex>
#include <set>

namespace ManualTests {

using testing::HasSubstr;
using namespace Testing;

const std::string folder = SENSOR_PROFILE_SOURCE_DIR "/packaging/man/";

std::string rendered(const std::string& page)
{
    return outputOf("mandoc -T utf8 -O width=200 '" + folder + page + "' | col -bx");
}

std::set<std::string> longOptions(const std::string& text)
{
    // Those of node_exporter have a dot.
    static const std::regex option("--[a-z][a-z-]*(?![a-z-]|\\.[a-z])");
    std::set<std::string> options;
    for (std::sregex_iterator each(text.begin(), text.end(), option), end; each != end; ++each)
        options.insert(each->str());
    return options;
}

class ManualPageTest : public testing::TestWithParam<const char*> {};

TEST_P(ManualPageTest, IsFreeOfWarnings)
{
    const std::string file = folder + GetParam();
    EXPECT_EQ(outputOf("mandoc -T lint -W warning '" + file + "' 2>&1"), "");
    EXPECT_EQ(outputOf("LC_ALL=C.UTF-8 MANWIDTH=80 man --warnings -E UTF-8 -l '" + file +
                       "' 2>&1 >/dev/null"),
        "");
}

INSTANTIATE_TEST_SUITE_P(ManualPages, ManualPageTest,
    testing::Values(
        "sensorctl.1", "sensor-profile-model.5", "sensor-profile.7", "sensor-profile-register.8"));

// Returns the help of the tool and of each of its commands, by the name of the command.
std::map<std::string, std::string> helpByCommand()
{
    static const std::regex command("\n  ([a-z]+) +[A-Z]");
    const std::string help = run({"--help"}).out;
    std::map<std::string, std::string> texts = {{"", help}};
    for (std::sregex_iterator each(help.begin(), help.end(), command), end; each != end; ++each)
        texts[(*each)[1]] = run({(*each)[1], "--help"}).out;
    return texts;
}

TEST(ManualOfTheToolTest, HasEveryCommandAndTheOptionsThereAre)
{
    const std::string page = rendered("sensorctl.1");
    std::set<std::string> options;
    for (const auto& [command, help] : helpByCommand()) {
        EXPECT_THAT(page, HasSubstr("\n     sensorctl " + command));
        options.merge(longOptions(help));
    }
    EXPECT_GE(options.size(), 20U);
    // The limits of the server, which its help leaves out.
    for (const std::string& option : longOptions(page)) {
        if (!options.contains(option)) {
            EXPECT_THAT(
                run({"serve", option, "x"}).err, HasSubstr(option + ": Value x not in range"));
        }
        options.erase(option);
    }
    EXPECT_EQ(options, std::set<std::string>());
}

// Returns the examples with output of a page, as blocks of a document for run-commands.
std::string examplesOf(const std::string& page)
{
    static const std::regex block("\n\\.Bd -literal(?: -offset indent)?(\n\\$ [^]*?\n)\\.Ed");
    std::string document;
    for (std::sregex_iterator each(page.begin(), page.end(), block), end; each != end; ++each)
        document += "```text" + (*each)[1].str() + "```\n";
    for (const auto& [escape, text] : {std::pair("\\\\-", "-"), {"\\\\\\(de", "°"}, {"\\\\&", ""}})
        document = std::regex_replace(document, std::regex(escape), text);
    return document;
}

class ManualExamplesTest : public testing::TestWithParam<const char*> {};

TEST_P(ManualExamplesTest, PrintWhatThePageShows)
{
    const std::string examples = examplesOf(contentOf(folder + GetParam()));
    EXPECT_GE(countOf(examples, "```text\n$ "), 4U);
    const TemporaryFolder files;
    const Ended ended = run({files.write("examples", examples)},
        {.program = SENSOR_PROFILE_SOURCE_DIR "/tests/docs/run-commands",
            .environment = {{"PATH", SENSOR_PROFILE_BINARY_DIR "/bin:/usr/bin:/bin"},
                {"COLUMNS", "80"}, {"LC_ALL", "C.UTF-8"},
                {"VORN_INSTRUMENTATION",
                    "model:" SENSOR_PROFILE_SOURCE_DIR "/schema/demo-model.json"}}});
    EXPECT_EQ(ended.code, 0) << ended.out << ended.err;
}

INSTANTIATE_TEST_SUITE_P(
    ManualPages, ManualExamplesTest, testing::Values("sensorctl.1", "sensor-profile.7"));

// The settings in the file are options, and the ports have their default values.
TEST(SettingsOfTheServiceTest, AreOptionsOfTheServer)
{
    static const std::regex setting("#([a-z-]+) = (.*)");
    const std::string help = run({"serve", "--help"}).out;
    const std::set<std::string> options = longOptions(help);
    int settings = 0;
    std::smatch match;
    for (const std::string& line :
        linesOf(contentOf(SENSOR_PROFILE_SOURCE_DIR "/packaging/serve.conf"))) {
        if (!std::regex_match(line, match, setting)) {
            EXPECT_TRUE(line.empty() || line.starts_with("# ")) << line;
            continue;
        }
        ++settings;
        EXPECT_TRUE(options.contains("--" + match[1].str())) << line;
        if (std::regex_search(help, std::regex("--" + match[1].str() + " [A-Z]+="))) {
            EXPECT_THAT(
                help, testing::ContainsRegex("--" + match[1].str() + " [A-Z]+=" + match[2].str()));
        }
    }
    EXPECT_GE(settings, 7);
}

TEST(ManualOfRegisteringTest, HasTheOptionsOfTheCommand)
{
    const Ended help = run({"--help"}, {.program = installedFile("sbin/sensor-profile-register")});
    EXPECT_EQ(longOptions(rendered("sensor-profile-register.8")), longOptions(help.out));
}

TEST(ManualOfTheModelTest, HasTheMembersOfTheSchema)
{
    const auto schema = nlohmann::json::parse(
        contentOf(SENSOR_PROFILE_SOURCE_DIR "/schema/sensor-profile-model.schema.json"));
    const std::string page = rendered("sensor-profile-model.5");
    for (const auto& [name, member] : schema.at("/$defs/node/properties"_json_pointer).items())
        EXPECT_THAT(page, HasSubstr(name));
}

// The row of each status of a model file in the tables of docs/operations.md; a row may be for
// several statuses.
const std::string meaninglessStatus = "has a status that means nothing";
const std::map<unsigned, std::string> rowsOfStatuses = {{0, "has no status"},
    {1, "is within its limits"}, {2, "starts"}, {3, "starts"}, {8, "is dormant"},
    {9, meaninglessStatus}, {10, "starts"}, {12, "is offline"}, {13, "is faulty"},
    {16, "is switched off"}, {17, "has not been there"}, {20, "will fail soon"},
    {21, "is in an alarm"}, {22, "reached a lower or upper limit of the first"},
    {23, "reached a lower or upper limit of the first"}, {24, "is beyond a limit"},
    {25, "reached a limit of the second"}, {26, "reached a limit of the second"}};

// Returns the codes in a list such as "1 normal, 12 offline".
std::vector<unsigned> codesIn(const std::string& list)
{
    static const std::regex code("([0-9]+) +[a-z]+ ?[a-z]*[,.]");
    std::vector<unsigned> codes;
    for (std::sregex_iterator each(list.begin(), list.end(), code), end; each != end; ++each)
        codes.push_back(static_cast<unsigned>(std::stoul((*each)[1])));
    return codes;
}

TEST(ManualOfTheModelTest, HasTheStatusesOfTheOperationsPage)
{
    std::vector<unsigned> expected;
    for (const auto& [status, row] : rowsOfStatuses)
        if (row != meaninglessStatus)
            expected.push_back(status);
    const std::string page = rendered("sensor-profile-model.5");
    const auto begin = page.find("A code: ");
    ASSERT_NE(begin, std::string::npos);
    EXPECT_EQ(codesIn(page.substr(begin, page.find("0 when left out") - begin)), expected);
    const auto schema = nlohmann::json::parse(
        contentOf(SENSOR_PROFILE_SOURCE_DIR "/schema/sensor-profile-model.schema.json"));
    EXPECT_EQ(
        codesIn(schema.at("/$defs/node/properties/status/description"_json_pointer)), expected);
}

// Returns the properties of a sensor with a status of the model file.
nlohmann::json shownWith(unsigned status)
{
    const TemporaryFolder files;
    const std::string model = files.write("model.json",
        R"({"nodes": [{"type": "voltage", "path": "/1", "description": "S", "reading": 1, "status": )" +
            std::to_string(status) + "}]}");
    const auto document = nlohmann::json::parse(run({"list", "--cim", "--model", model}).out);
    return document["instances"][0]["properties"];
}

TEST(ManualOfTheClassesTest, LinksToTheOperationsPage)
{
    EXPECT_THAT(rendered("sensor-profile.7"),
        HasSubstr(" /usr/share/doc/sensor-profile-provider/operations.md"));
}

// The row of each state in the tables agrees with the properties of a sensor with that status.
TEST(OperationsPageTest, HasTheStatesThatSensorsShow)
{
    const std::string page = contentOf(SENSOR_PROFILE_SOURCE_DIR "/docs/operations.md");
    for (const auto& [status, row] : rowsOfStatuses) {
        const auto shown = shownWith(status);
        const std::string state = shown["CurrentState"].get<std::string>();
        const std::string operational = shown["OperationalStatus"].empty()
                                            ? "an empty list"
                                            : shown["OperationalStatus"][0].dump();
        const std::regex line("\n\\| " + row + "[^|]*\\|[^|]*" +
                              (state.empty() ? "empty" : "`" + state + "`") + "[^|]*\\| " +
                              shown["HealthState"].dump() + " \\|[^|]*\\b" + operational +
                              "\\b[^|]*\\| " + shown["EnabledState"].dump() + " \\|");
        EXPECT_TRUE(std::regex_search(page, line)) << status << ": " << shown.dump();
    }
}

// Returns the part of a page between a text and the next match of an expression.
std::string partOf(const std::string& page, const std::string& start, const std::regex& next)
{
    const auto begin = page.find(start);
    EXPECT_NE(begin, std::string::npos) << start;
    if (begin == std::string::npos)
        return "";
    const std::string rest = page.substr(begin + start.size());
    std::smatch end;
    return std::regex_search(rest, end, next) ? end.prefix().str() : rest;
}

// Each published property is named in the section of its class.
TEST(OperationsPageTest, DescribesEveryProperty)
{
    const std::map<std::string, std::string> starts = {{"ZUMLO_NumericSensor", "\nA sensor, "},
        {"ZUMLO_ComputerSystem", "\nThe computer, "},
        {"ZUMLO_SensorEnabledLogicalElementCapabilities", "\nThe capabilities, "},
        {"ZUMLO_SensorElementCapabilities", "\nThe associations "},
        {"ZUMLO_SensorSystemDevice", "\nThe associations "}};
    const std::string page = contentOf(SENSOR_PROFILE_SOURCE_DIR "/docs/operations.md");
    const std::string model = SENSOR_PROFILE_SOURCE_DIR "/schema/demo-model.json";
    std::size_t properties = 0;
    for (const auto& [className, start] : starts) {
        const std::string part =
            partOf(page, start, std::regex("\n(A|The) [a-z]+,? (`|have)|\n## "));
        EXPECT_THAT(part, HasSubstr("`" + className + "`"));
        const auto document =
            nlohmann::json::parse(run({"list", className, "--cim", "--model", model}).out);
        for (const auto& instance : document["instances"])
            for (const auto& [name, value] : instance["properties"].items()) {
                ++properties;
                EXPECT_THAT(part, HasSubstr("`" + name + "`")) << className;
            }
    }
    EXPECT_GT(properties, 40U);
}

} // namespace ManualTests
