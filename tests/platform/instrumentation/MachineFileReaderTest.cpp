// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "platform/instrumentation/machinefile/MachineFileReader.h"

#include "tests/platform/instrumentation/Walk.h"
#include "tests/support/Environment.h"
#include "tests/support/TemporaryFolder.h"

#include <gmock/gmock.h>

#include <clocale>
#include <cstdlib>
#include <filesystem>
#include <stdexcept>
#include <tuple>

namespace MachineFileReaderTests {

using namespace std::string_literals;
using testing::ElementsAre;
using Testing::errorOf;
using testing::HasSubstr;
using testing::IsEmpty;
using testing::SizeIs;
using testing::StartsWith;
using Vorn::MachineFileNode;
using Vorn::NodeLexicon::NodeType;

std::vector<MachineFileNode> readMachineFile(std::string_view text)
{
    return Vorn::readMachineFile(text).nodes;
}

// Returns a document with one node, which has the required and the given members.
std::string nodeWith(const std::string& members)
{
    return R"({"nodes":[{"type":"voltage","path":"/v","description":"V")" +
           (members.empty() ? "" : "," + members) + "}]}";
}

MachineFileNode nodeOf(const std::string& members)
{
    return readMachineFile(nodeWith(members)).at(0);
}

TEST(ModelTest, HoldsEveryMember)
{
    const auto nodes = readMachineFile(R"({ "nodes": [
      { "type": "temperature", "path": "/board/cpu0/temp1", "description": "CPU 1 Temp",
        "sensorType": 23, "status": 1, "possibleStates": [1, 23, 26], "baseUnits": 2,
        "reading": 41.5, "lowerNonCritical": 5, "upperNonCritical": 80, "lowerCritical": 0,
        "upperCritical": 95, "lowerFatal": -10, "upperFatal": 105 } ] })");
    ASSERT_THAT(nodes, SizeIs(1));
    const MachineFileNode& node = nodes[0];
    EXPECT_EQ(node.type, NodeType::Temperature);
    EXPECT_EQ(node.path, "/board/cpu0/temp1");
    EXPECT_EQ(node.description, "CPU 1 Temp");
    EXPECT_EQ(node.sensorType, 23U);
    const Vorn::NodeReading values{.status = 1,
        .reading = 41.5,
        .lowerNonCritical = 5,
        .upperNonCritical = 80,
        .lowerCritical = 0,
        .upperCritical = 95,
        .lowerFatal = -10,
        .upperFatal = 105,
        .baseUnits = 2,
        .possibleStates = {{1, 23, 26}}};
    EXPECT_EQ(node.values, values);
}

TEST(ModelTest, LeavesOutWhatIsNotThere)
{
    EXPECT_EQ(nodeOf("").values, Vorn::NodeReading{});
    EXPECT_EQ(nodeOf(R"("possibleStates":[])").values.possibleStates, std::vector<unsigned>{});
}

TEST(ModelTest, TakesTheTypesNumberForTheSensorType)
{
    const auto nodes = readMachineFile(R"({"nodes":[
        {"path":"/1","description":"","type":"temperature"},
        {"path":"/2","description":"","type":"voltage"},
        {"path":"/3","description":"","type":"tachometer"}]})");
    EXPECT_EQ(nodes.at(0).sensorType, 22U);
    EXPECT_EQ(nodes.at(1).sensorType, 21U);
    EXPECT_EQ(nodes.at(2).sensorType, 20U);
    EXPECT_EQ(nodes.at(2).type, NodeType::Tachometer);
    EXPECT_EQ(nodeOf(R"("sensorType":0)").sensorType, 0U);
}

TEST(ModelTest, MayBeEmpty)
{
    EXPECT_THAT(readMachineFile(R"({"nodes":[]})"), IsEmpty());
    EXPECT_THAT(readMachineFile("\xEF\xBB\xBF{\"nodes\":[]}\n"), IsEmpty());
}

TEST(ModelTest, ReadsNumbersOfEveryForm)
{
    EXPECT_EQ(nodeOf(R"("reading":-0.0)").values.reading, 0.0);
    EXPECT_EQ(nodeOf(R"("reading":1e3)").values.reading, 1000.0);
    EXPECT_EQ(nodeOf(R"("reading":-12)").values.reading, -12.0);
    EXPECT_EQ(nodeOf(R"("reading":3.25)").values.reading, 3.25);
    EXPECT_EQ(nodeOf(R"("reading":18446744073709551616)").values.reading, 18446744073709551616.0);
    EXPECT_EQ(nodeOf(R"("status":4294967295)").values.status, 4294967295U);
}

// Compiles a locale whose only property is its decimal comma. Throws when that fails.
void compileCommaLocale(const Testing::TemporaryFolder& folder)
{
    const std::string source =
        folder.write("source", "LC_NUMERIC\ndecimal_point \"<U002C>\"\nthousands_sep \"<U002E>\"\n"
                               "grouping 3;3\nEND LC_NUMERIC\n");
    const std::string target = folder.path() / "comma";
    // localedef warns about missing categories and exits with 1.
    std::ignore =
        std::system(("localedef -c -i " + source + " " + target + " > /dev/null 2>&1").c_str());
    if (!std::filesystem::exists(target + "/LC_NUMERIC"))
        throw std::runtime_error("localedef made no locale: is the package locales installed?");
}

TEST(ModelTest, ReadsNumbersAlikeInAProcessWithADecimalComma)
{
    const Testing::TemporaryFolder folder;
    compileCommaLocale(folder);
    const Testing::EnvironmentVariable locales("LOCPATH", folder.path());
    const std::string before = std::setlocale(LC_NUMERIC, nullptr);
    ASSERT_NE(std::setlocale(LC_NUMERIC, "comma"), nullptr);
    ASSERT_STREQ(std::localeconv()->decimal_point, ",");
    const auto reading = nodeOf(R"("reading":41.5)").values.reading;
    EXPECT_STREQ(std::localeconv()->decimal_point, ",");
    std::setlocale(LC_NUMERIC, before.c_str());
    EXPECT_EQ(reading, 41.5);
}

TEST(ModelTest, KeepsTextsAsTheyStand)
{
    const auto nodes = readMachineFile(
        R"({"nodes":[{"type":"voltage","path":"/\u00e4/\"\\","description":" 温度 \ud83c\udf21 "}]})");
    EXPECT_EQ(nodes.at(0).path, "/\u00E4/\"\\");
    EXPECT_EQ(nodes.at(0).description, " \u6E29\u5EA6 \U0001F321 ");
}

struct Refusal {
    std::string document;
    std::string error;
};

class RefusedModelTest : public testing::TestWithParam<Refusal> {};

TEST_P(RefusedModelTest, NamesThePlaceAndTheReason)
{
    EXPECT_EQ(errorOf([&] { readMachineFile(GetParam().document); }), GetParam().error);
}

const std::string code = "an unsigned 32-bit integer";
const std::string node = R"({"type":"voltage","path":"/v","description":"V"})";

const Refusal shapes[] = {
    {"[]", "the document: expected an object, found an array"},
    {"3", "the document: expected an object, found the number 3"},
    {"null", "the document: expected an object, found null"},
    {"\"nodes\"", "the document: expected an object, found the string \"nodes\""},
    {"{}", "the document: member \"nodes\" is missing"},
    {R"({"nodes":{}})", "/nodes: expected an array, found an object"},
    {R"({"nodes":null})", "/nodes: expected an array, found null"},
    {R"({"nodes":true})", "/nodes: expected an array, found true"},
    {R"({"nodes":[],"nodes":[]})", "/nodes: the member is there twice"},
    {R"({"nodes":[],"version":1})", "/version: there is no such member"},
    {R"({"a/b~c":1})", "/a~1b~0c: there is no such member"},
    {R"({"nodes":[1]})", "/nodes/0: expected an object, found the number 1"},
    {R"({"nodes":[[]]})", "/nodes/0: expected an object, found an array"},
    {R"({"nodes":[)" + node + R"(,false]})", "/nodes/1: expected an object, found false"},
};
INSTANTIATE_TEST_SUITE_P(Shapes, RefusedModelTest, testing::ValuesIn(shapes));

const Refusal members[] = {
    {R"({"nodes":[{"path":"/v","description":"V"}]})", "/nodes/0: member \"type\" is missing"},
    {R"({"nodes":[{"type":"voltage","description":"V"}]})", "/nodes/0: member \"path\" is missing"},
    {R"({"nodes":[{"type":"voltage","path":"/v"}]})",
        "/nodes/0: member \"description\" is missing"},
    {R"({"nodes":[{"type":"humidity"}]})",
        R"(/nodes/0/type: expected "temperature", "voltage" or "tachometer", found the string "humidity")"},
    {R"({"nodes":[{"type":22}]})",
        R"(/nodes/0/type: expected "temperature", "voltage" or "tachometer", found the number 22)"},
    {R"({"nodes":[{"path":7}]})", "/nodes/0/path: expected a string, found the number 7"},
    {R"({"nodes":[{"path":null}]})", "/nodes/0/path: expected a string, found null"},
    {R"({"nodes":[{"description":[]}]})",
        "/nodes/0/description: expected a string, found an array"},
    {R"({"nodes":[)" + node + "," + node + "]}",
        R"(/nodes/1/path: "/v" is the path of /nodes/0 already)"},
    {nodeWith(R"("type":"voltage")"), "/nodes/0/type: the member is there twice"},
    {nodeWith(R"("reading":1,"reading":1)"), "/nodes/0/reading: the member is there twice"},
    {nodeWith(R"("Reading":1)"), "/nodes/0/Reading: there is no such member"},
    {nodeWith(R"("":1)"), "/nodes/0/: there is no such member"},
    {nodeWith(R"("reading":"41.5")"),
        R"(/nodes/0/reading: expected a number, found the string "41.5")"},
    {nodeWith(R"("reading":null)"), "/nodes/0/reading: expected a number, found null"},
    {nodeWith(R"("upperFatal":{})"), "/nodes/0/upperFatal: expected a number, found an object"},
    {nodeWith(R"("lowerCritical":[1])"),
        "/nodes/0/lowerCritical: expected a number, found an array"},
    {nodeWith(R"("status":-1)"), "/nodes/0/status: expected " + code + ", found the number -1"},
    {nodeWith(R"("status":1.5)"), "/nodes/0/status: expected " + code + ", found the number 1.5"},
    {nodeWith(R"("status":"1")"), "/nodes/0/status: expected " + code + ", found the string \"1\""},
    {nodeWith(R"("baseUnits":4294967296)"),
        "/nodes/0/baseUnits: expected " + code + ", found the number 4294967296"},
    {nodeWith(R"("sensorType":true)"), "/nodes/0/sensorType: expected " + code + ", found true"},
    {nodeWith(R"("possibleStates":1)"),
        "/nodes/0/possibleStates: expected an array of unsigned 32-bit integers, found the "
        "number 1"},
    {nodeWith(R"("possibleStates":[1,"23"])"),
        "/nodes/0/possibleStates/1: expected " + code + ", found the string \"23\""},
    {nodeWith(R"("possibleStates":[[1]])"),
        "/nodes/0/possibleStates/0: expected " + code + ", found an array"},
    {nodeWith(R"("possibleStates":[1,2,4294967296])"),
        "/nodes/0/possibleStates/2: expected " + code + ", found the number 4294967296"},
    {R"({"nodes":[{"path":"/a\u0000b"}]})", "/nodes/0/path: the string holds the character NUL"},
    {R"({"nodes":[{"description":"\u0000"}]})",
        "/nodes/0/description: the string holds the character NUL"},
};
INSTANTIATE_TEST_SUITE_P(Members, RefusedModelTest, testing::ValuesIn(members));

const Refusal texts[] = {
    {"{\"nodes\":[]}\0"s, "line 1, column 13: the file holds the character NUL"},
    {"\0"s, "line 1, column 1: the file holds the character NUL"},
    {"{\n\"nodes\":\n[\0]}"s, "line 3, column 2: the file holds the character NUL"},
};
INSTANTIATE_TEST_SUITE_P(Nul, RefusedModelTest, testing::ValuesIn(texts));

TEST(BrokenJsonTest, IsPlacedByLineAndColumn)
{
    const std::pair<std::string, std::string> documents[] = {
        {"", "line 1, column 1: "},
        {"{\"nodes\": [", "line 1, column 12: "},
        {"{\n  \"nodes\": [\n    {,}\n  ]\n}", "line 3, column 6: "},
        {"{\"nodes\":[]} x", "line 1, column 14: "},
        {"{\"nodes\":[],}", "line 1, column 13: "},
        {"{'nodes':[]}", "line 1, column 2: "},
        {"{\"nodes\":[{\"path\":\"/a\n\"}]}", "line 1, column 22: "},
        {"{\"nodes\":[{\"path\":\"/a\xFF\"}]}", "line 1, column 22: "},
        {"{\"nodes\":[{\"path\":\"\\ud800\"}]}", "line 1, column 26: "},
        {nodeWith("\"reading\":01"), "line 1, column 70: "},
        {nodeWith("\"reading\":NaN"), "line 1, column 69: "},
    };
    for (const auto& [document, place] : documents)
        EXPECT_THAT(errorOf([&text = document] { readMachineFile(text); }), StartsWith(place))
            << document;
}

TEST(BrokenJsonTest, SaysWhatWasExpectedWithoutTheNameOfALibrary)
{
    const std::string error = errorOf([] { readMachineFile("{\"nodes\":[],}"); });
    EXPECT_THAT(error, HasSubstr("expected string literal"));
    EXPECT_THAT(error, testing::Not(HasSubstr("json.exception")));
}

TEST(BrokenJsonTest, ANumberBeyondADoubleIsRefused)
{
    EXPECT_THAT(errorOf([] { readMachineFile(nodeWith("\"reading\":1e999")); }),
        testing::MatchesRegex("line 1, column 7[0-9]: number overflow parsing '1e999'"));
}

TEST(BrokenJsonTest, EveryTruncationOfAModelIsRefused)
{
    const std::string document = nodeWith(R"("reading":41.5,"possibleStates":[1,23])");
    ASSERT_EQ(errorOf([&] { readMachineFile(document); }), "");
    for (std::size_t length = 0; length < document.size(); ++length)
        EXPECT_THAT(
            errorOf([&] { readMachineFile(document.substr(0, length)); }), StartsWith("line 1"))
            << length;
}

TEST(HostileModelTest, AHundredMegabytesOfNestingAreRefusedAtOnce)
{
    const std::string brackets(100'000'000, '[');
    EXPECT_EQ(errorOf([&] { readMachineFile(brackets); }),
        "line 1, column 6: the values are nested too deeply");
    std::string objects;
    while (objects.size() < 100'000'000)
        objects += "{\"nodes\":";
    EXPECT_EQ(errorOf([&] { readMachineFile(objects); }),
        "line 1, column 46: the values are nested too deeply");
}

TEST(HostileModelTest, ALongStringIsCutInTheMessage)
{
    const std::string longName(1'000'000, 'x');
    const auto lengthOf = [](const std::string& document) {
        return errorOf([&] { readMachineFile(document); }).size();
    };
    EXPECT_LT(lengthOf(nodeWith("\"" + longName + "\":1")), 400U);
    EXPECT_LT(lengthOf(nodeWith("\"reading\":\"" + longName + "\"")), 400U);
    EXPECT_LT(lengthOf("{\"" + longName), 400U);
    EXPECT_GT(lengthOf("{\"" + longName), 20U);
}

TEST(HostileModelTest, ControlCharactersAreEscapedInTheMessage)
{
    EXPECT_EQ(errorOf([] { readMachineFile(nodeWith(R"("a\nb":1)")); }),
        "/nodes/0/a\\nb: there is no such member");
}

} // namespace MachineFileReaderTests
