// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tests/tools/ToolTest.h"

#include <gmock/gmock.h>

namespace {

using nlohmann::json;
using testing::HasSubstr;
using testing::Not;
using namespace Testing;

class ListTest : public ToolTest {
protected:
    Ended listed(const std::string& file, const RunOptions& options = {}) const
    {
        return run({"list", "--model", file}, options);
    }

    json listedAsCim(const std::string& file) const
    {
        const Ended ended = run({"list", "--cim", "--model", file});
        EXPECT_EQ(ended.code, 0) << ended.err;
        EXPECT_EQ(ended.err, "");
        return json::parse(ended.out);
    }

    // Returns the properties of the instance with that name.
    static json propertiesOf(const json& document, const std::string& name)
    {
        for (const json& instance : document.at("instances"))
            if (instance.at("properties").at("ElementName") == name)
                return instance.at("properties");
        ADD_FAILURE() << "no " << name;
        return {};
    }
};

TEST_F(ListTest, SensorsAreShownBesideACollectionThatCannotBeRead)
{
    const Ended ended = run({"list"},
        {.environment = {{"RYNLOG_LOG", ""},
             {"VORN_INSTRUMENTATION",
                 "model:" + smallModel() + ",ipmi:" + folder_.write("damaged.json", "{")}}});
    EXPECT_EQ(ended.code, 0);
    EXPECT_THAT(ended.out, HasSubstr("\ncpu0\n  CPU 1 "));
    EXPECT_THAT(ended.err, HasSubstr("damaged.json"));
}

TEST_F(ListTest, GroupsSensorsByTheFolderOfTheirPaths)
{
    const Ended ended = listed(smallModel());
    EXPECT_EQ(ended.code, 0);
    EXPECT_EQ(ended.err, "");
    const std::string wide = "  NAME   READING      STATE          LOW  LOW CRIT  LOW FATAL  HIGH  "
                             "HIGH CRIT  HIGH FATAL  DEVICE ID\n"
                             "board\n"
                             "  +12V     12.75 V    Warning high     -      10.5          -  12.5  "
                             "        -           -  +12V:/board/in1\n";
    EXPECT_EQ(ended.out.substr(0, wide.size()), wide);
    EXPECT_EQ(listed(smallModel(), {.environment = {{"COLUMNS", "80"}}}).out,
        "  NAME   READING      STATE          LOW/CRIT/FATAL  HIGH/CRIT/FATAL\n"
        "board\n"
        "  +12V     12.75 V    Warning high   -/10.5          12.5\n"
        "  Fan       1200 RPM  Normal         300             -\n"
        "  Fan          -      Lost           -               -\n"
        "cpu0\n"
        "  CPU 1       41 C    Normal         5/-/-10         80/95/105\n"
        "cpu1\n"
        "  CPU 2       97 C    Critical high  -               -/95\n"
        "5 sensors: 2 normal, 1 warning, 1 critical, 1 lost.\n");
}

TEST_F(ListTest, SortsNaturallyAndWithoutRegardToCase)
{
    std::string nodes;
    for (const char* const label : {"temp10", "Temp2", "12 V", "3.3 V", "temp1"})
        nodes += std::string(nodes.empty() ? "" : ",") +
                 R"({ "type": "voltage", "status": 1, "path": "/b/)" + label +
                 R"(", "description": ")" + label + R"(" })";
    const std::string file = model(nodes + R"(, { "type": "voltage", "status": 1, "path": "/a10/x",
        "description": "x" }, { "type": "voltage", "status": 1, "path": "/A9/y",
        "description": "y" })");
    const Ended ended = run({"list", "--csv", "--model", file});
    std::vector<std::string> labels;
    for (const std::string& line : linesOf(ended.out))
        labels.push_back(line.substr(0, line.find(",voltage")));
    labels.erase(labels.begin());
    EXPECT_THAT(labels, testing::ElementsAre("A9,,y", "a10,,x", "b,,3.3 V", "b,,12 V", "b,,temp1",
                            "b,,Temp2", "b,,temp10"));
}

TEST_F(ListTest, ReadingsAndLimitsAreRoundedAlike)
{
    const std::string file = model(R"({ "type": "voltage", "path": "/a", "status": 23,
        "description": "12 V", "baseUnits": 5, "reading": 12.599, "upperNonCritical": 12.599 })");
    EXPECT_THAT(listed(file, {.environment = {{"COLUMNS", "80"}}}).out,
        HasSubstr("    12.60 V  Warning high  12.6  12 V:/a\n"));
}

TEST_F(ListTest, FlatHasTheChipInEachLine)
{
    const Ended ended =
        run({"list", "--flat", "--model", smallModel()}, {.environment = {{"COLUMNS", "90"}}});
    EXPECT_THAT(ended.out, testing::StartsWith("NAME   CHIP   READING      STATE "));
    EXPECT_THAT(ended.out, HasSubstr("\nFan    board     1200 RPM  Normal "));
    EXPECT_EQ(linesOf(ended.out).size(), 6U);
}

TEST_F(ListTest, CsvHasAFieldForEachValue)
{
    const std::string file = model(R"(
        { "type": "voltage", "path": "/b/in1", "description": "a,\"b\"", "status": 1,
          "baseUnits": 5, "reading": 1.5, "upperCritical": 2 },
        { "type": "tachometer", "path": "/b/fan1", "description": "Lüfter", "status": 13 })");
    const Ended ended = run({"list", "--csv", "--model", file});
    EXPECT_EQ(ended.code, 0);
    EXPECT_EQ(ended.out,
        "chip,device,label,kind,value,unit,state,lowWarning,lowCritical,lowFatal,highWarning,"
        "highCritical,highFatal,deviceId\n"
        "b,,\"a,\"\"b\"\"\",voltage,1.5,V,Normal,,,,,2,,\"a,\"\"b\"\":/b/in1\"\n"
        "b,,Lüfter,fan,,,Lost,,,,,,,Lüfter:/b/fan1\n");
}

TEST_F(ListTest, ModelPathMayBeRelativeAndHoldAnyCharacter)
{
    const std::string odd = folder_.write("a,b\\c d:e.json", contentOf(smallModel()));
    EXPECT_EQ(listed(odd).out, listed(smallModel()).out);
    const std::string relative = std::filesystem::relative(odd).string();
    EXPECT_EQ(listed(relative).out, listed(odd).out);
}

TEST_F(ListTest, WithoutModelShowsWhatTheSettingNames)
{
    const RunOptions options{.environment = {{"VORN_INSTRUMENTATION", "model:" + smallModel()}}};
    EXPECT_EQ(run({"list"}, options).out, listed(smallModel()).out);
}

TEST_F(ListTest, ModelOptionOverridesTheSetting)
{
    const RunOptions options{.environment = {{"VORN_INSTRUMENTATION", "nonsense"}}};
    EXPECT_EQ(listed(smallModel(), options).out, listed(smallModel()).out);
}

TEST_F(ListTest, UnlimitedLinesHoldLongNamesInFull)
{
    const std::string name(200, 'n');
    const Ended ended = listed(model(
        R"({ "type": "voltage", "path": "/a", "status": 1, "description": ")" + name + "\" }"));
    EXPECT_THAT(ended.out, HasSubstr("\n  " + name + " "));
}

TEST_F(ListTest, ColumnsSettingLimitsLinesAndCutsNames)
{
    const std::string name(200, 'n');
    const std::string file = model(
        R"({ "type": "voltage", "path": "/a", "status": 1, "reading": 1, "baseUnits": 5,
             "upperCritical": 2, "description": ")" +
        name + "\" }");
    const Ended ended = listed(file, {.environment = {{"COLUMNS", "60"}}});
    const auto lines = linesOf(ended.out);
    ASSERT_EQ(lines.size(), 4U);
    EXPECT_THAT(lines[2], testing::ContainsRegex("^  n+~  "));
    EXPECT_THAT(lines[2], testing::EndsWith("-/2"));
    EXPECT_LE(lines[0].size(), 60U);
}

TEST_F(ListTest, ControlCharactersInNamesAreEscaped)
{
    const std::string file = model(R"({ "type": "voltage", "path": "/a", "status": 1,
        "description": "a\u001b[31mb\nc\u009bd\u202ee\u007ff" })");
    const Ended table = listed(file);
    EXPECT_THAT(table.out, HasSubstr(R"(a\x1B[31mb\nc\u009Bd\u202Ee\x7Ff)"));
    for (const auto& arguments :
        std::vector<std::vector<std::string>>{{"list"}, {"list", "--cim"}, {"record"}}) {
        std::vector<std::string> all = arguments;
        all.insert(all.end(), {"--model", file});
        const std::string out = run(all).out;
        EXPECT_THAT(out, Not(HasSubstr("\x1B")));
        EXPECT_THAT(out, Not(HasSubstr("\x7F")));
        EXPECT_THAT(out, Not(HasSubstr("\xC2\x9B")));
        EXPECT_THAT(out, Not(HasSubstr("\xE2\x80\xAE")));
    }
    EXPECT_EQ(listedAsCim(file)["instances"][0]["properties"]["ElementName"],
        "a\x1B[31mb\nc\xC2\x9B"
        "d\xE2\x80\xAE"
        "e\x7F"
        "f");
}

TEST_F(ListTest, NamesInOtherScriptsAreEscapedWithoutUtf8)
{
    const std::string file = model(R"({ "type": "voltage", "path": "/a", "status": 1,
        "description": "温度 Größe" })");
    EXPECT_THAT(
        listed(file, {.environment = {{"LC_ALL", "C.UTF-8"}}}).out, HasSubstr("\n  温度 Größe  "));
    for (const char* const locale : {"C", "de_DE.ISO-8859-1"})
        EXPECT_THAT(listed(file, {.environment = {{"LC_ALL", locale}}}).out,
            HasSubstr(R"(  \u6E29\u5EA6 Gr\u00F6\u00DFe  )"));
}

TEST_F(ListTest, CimNamesNamespaceClassAndPath)
{
    const json document = listedAsCim(smallModel());
    EXPECT_EQ(document.size(), 3U);
    EXPECT_EQ(document.at("namespace"), "root/cimv2");
    EXPECT_EQ(document.at("class"), "ZUMLO_NumericSensor");
    ASSERT_EQ(document.at("instances").size(), 5U);
    const json& first = document["instances"][0];
    EXPECT_EQ(first.size(), 2U);
    const std::string system = first["properties"]["SystemName"];
    EXPECT_EQ(first["path"],
        "//" + system +
            "/root/cimv2:ZUMLO_NumericSensor.CreationClassName=\"ZUMLO_NumericSensor\","
            "DeviceID=\"+12V:/board/in1\",SystemCreationClassName=\"ZUMLO_ComputerSystem\","
            "SystemName=\"" +
            system + "\"");
}

TEST_F(ListTest, CimHoldsEachPropertyWithItsType)
{
    const json properties = propertiesOf(listedAsCim(smallModel()), "CPU 1");
    EXPECT_EQ(properties.at("DeviceID"), "CPU 1:/cpu0/temp1");
    EXPECT_EQ(properties.at("CurrentReading"), 41);
    EXPECT_EQ(properties.at("UnitModifier"), 0);
    EXPECT_EQ(properties.at("LowerThresholdFatal"), -10);
    EXPECT_EQ(properties.at("SensorType"), 2);
    EXPECT_EQ(properties.at("OperationalStatus"), json({2}));
    EXPECT_EQ(properties.at("SupportedThresholds"), json({0, 1, 2, 3, 4, 5}));
    EXPECT_EQ(properties.at("PossibleStates").at(1), "CriticalHigh");
    EXPECT_EQ(properties.size(), 27U); // all properties of the class but LowerThresholdCritical
}

TEST_F(ListTest, CimLeavesOutWhatTheInstanceLacks)
{
    const json document = listedAsCim(smallModel());
    EXPECT_FALSE(propertiesOf(document, "CPU 1").contains("LowerThresholdCritical"));
    const json fan = propertiesOf(document, "CPU 2");
    for (const char* const absent : {"LowerThresholdNonCritical", "UpperThresholdNonCritical",
             "LowerThresholdCritical", "LowerThresholdFatal", "UpperThresholdFatal"})
        EXPECT_FALSE(fan.contains(absent)) << absent;
    EXPECT_EQ(fan.at("UpperThresholdCritical"), 95);
}

TEST_F(ListTest, CimOfAMachineWithoutSensorsIsStillADocument)
{
    const Ended ended = run({"list", "--cim", "--model", model("")});
    EXPECT_EQ(ended.code, 3);
    EXPECT_EQ(
        json::parse(ended.out), json({{"namespace", "root/cimv2"}, {"class", "ZUMLO_NumericSensor"},
                                    {"instances", json::array()}}));
    EXPECT_EQ(ended.err,
        "sensorctl: " + folder_.path().string() + "/model.json: this machine has no sensors\n");
}

TEST_F(ListTest, MachineWithoutSensorsIsSaidOnStandardError)
{
    const Ended ended =
        run({"list"}, {.environment = {{"VORN_INSTRUMENTATION", "model:" + model("")}}});
    EXPECT_EQ(ended.code, 3);
    EXPECT_EQ(ended.out, "");
    EXPECT_THAT(ended.err, testing::StartsWith("sensorctl: this machine has no sensors"));
}

TEST_F(ListTest, ColorIsThereOnlyWhenAskedFor)
{
    const std::string file = smallModel();
    EXPECT_THAT(run({"list", "--model", file}).out, Not(HasSubstr("\x1B[")));
    EXPECT_THAT(run({"list", "--model", file, "--color", "never"}).out, Not(HasSubstr("\x1B[")));
    const std::string colored = run({"list", "--model", file, "--color", "always"}).out;
    EXPECT_THAT(colored, HasSubstr("\x1B[1;31mCritical high\x1B[0m"));
    EXPECT_THAT(colored, HasSubstr("\x1B[33mWarning high\x1B[0m"));
    EXPECT_THAT(colored, HasSubstr("\x1B[33mLost\x1B[0m"));
    EXPECT_EQ(countOf(colored, "\x1B[32m"), 2U);
    EXPECT_EQ(countOf(colored, "\x1B[32mNormal\x1B[0m"), 2U);
}

TEST_F(ListTest, LargeMachineComesOutWhole)
{
    std::ostringstream nodes;
    for (int i = 0; i < 3000; ++i)
        nodes << (i == 0 ? "" : ",") << R"({ "type": "voltage", "status": 1, "path": "/)" << i
              << R"(", "description": "V" })";
    const json document = listedAsCim(model(nodes.str()));
    EXPECT_EQ(document["instances"].size(), 3000U);
}

} // namespace
