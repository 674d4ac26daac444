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

    json listedAsJson(const std::string& file) const
    {
        const Ended ended = run({"list", "--json", "--model", file});
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

TEST_F(ListTest, PrintsEachSensorInTheProvidersOrder)
{
    const Ended ended = listed(smallModel());
    EXPECT_EQ(ended.code, 0);
    EXPECT_EQ(ended.err, "");
    EXPECT_EQ(ended.out, "NAME   READING      STATE         HEALTH    LOWER    UPPER\n"
                         "+12V    12.750 V    WarningHigh   Warning   -/10.5   12.5\n"
                         "CPU 1       41 °C   Normal        OK        5/-/-10  80/95/105\n"
                         "CPU 2       97 °C   CriticalHigh  Critical  -        -/95\n"
                         "Fan       1200 RPM  Normal        OK        300      -\n"
                         "Fan          -      Lost Comm.    OK        -        -\n");
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
    EXPECT_THAT(ended.out, HasSubstr("\n" + name + " "));
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
    ASSERT_EQ(lines.size(), 2U);
    EXPECT_THAT(lines[1], HasSubstr("n…  "));
    EXPECT_THAT(lines[1], testing::EndsWith("-/2"));
    EXPECT_EQ(lines[0].size(), 60U);
}

TEST_F(ListTest, ControlCharactersInNamesAreEscaped)
{
    const std::string file = model(R"({ "type": "voltage", "path": "/a", "status": 1,
        "description": "a\u001b[31mb\nc\u009bd\u202ee\u007ff" })");
    const Ended table = listed(file);
    EXPECT_THAT(table.out, HasSubstr(R"(a\x1B[31mb\nc\u009Bd\u202Ee\x7Ff)"));
    for (const auto& arguments :
        std::vector<std::vector<std::string>>{{"list"}, {"list", "--json"}, {"record"}}) {
        std::vector<std::string> all = arguments;
        all.insert(all.end(), {"--model", file});
        const std::string out = run(all).out;
        EXPECT_THAT(out, Not(HasSubstr("\x1B")));
        EXPECT_THAT(out, Not(HasSubstr("\x7F")));
        EXPECT_THAT(out, Not(HasSubstr("\xC2\x9B")));
        EXPECT_THAT(out, Not(HasSubstr("\xE2\x80\xAE")));
    }
    EXPECT_EQ(listedAsJson(file)["instances"][0]["properties"]["ElementName"],
        "a\x1B[31mb\nc\xC2\x9B"
        "d\xE2\x80\xAE"
        "e\x7F"
        "f");
}

TEST_F(ListTest, NamesInOtherScriptsComeOutInAnyLocale)
{
    const std::string file = model(R"({ "type": "voltage", "path": "/a", "status": 1,
        "description": "温度 Größe" })");
    for (const char* const locale : {"C", "C.UTF-8", "de_DE.ISO-8859-1"})
        EXPECT_THAT(
            listed(file, {.environment = {{"LC_ALL", locale}}}).out, HasSubstr("\n温度 Größe  "));
}

TEST_F(ListTest, JsonNamesNamespaceClassAndPath)
{
    const json document = listedAsJson(smallModel());
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

TEST_F(ListTest, JsonHoldsEachPropertyWithItsType)
{
    const json properties = propertiesOf(listedAsJson(smallModel()), "CPU 1");
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

TEST_F(ListTest, JsonLeavesOutWhatTheInstanceLacks)
{
    const json document = listedAsJson(smallModel());
    EXPECT_FALSE(propertiesOf(document, "CPU 1").contains("LowerThresholdCritical"));
    const json fan = propertiesOf(document, "CPU 2");
    for (const char* const absent : {"LowerThresholdNonCritical", "UpperThresholdNonCritical",
             "LowerThresholdCritical", "LowerThresholdFatal", "UpperThresholdFatal"})
        EXPECT_FALSE(fan.contains(absent)) << absent;
    EXPECT_EQ(fan.at("UpperThresholdCritical"), 95);
}

TEST_F(ListTest, JsonOfAMachineWithoutSensorsIsStillADocument)
{
    const Ended ended = run({"list", "--json", "--model", model("")});
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
    EXPECT_THAT(colored, HasSubstr("\x1B[1;31mCritical\x1B[0m"));
    EXPECT_THAT(colored, HasSubstr("\x1B[33mWarningHigh\x1B[0m"));
    EXPECT_THAT(colored, HasSubstr("\x1B[32mOK\x1B[0m"));
}

TEST_F(ListTest, LargeMachineComesOutWhole)
{
    std::ostringstream nodes;
    for (int i = 0; i < 3000; ++i)
        nodes << (i == 0 ? "" : ",") << R"({ "type": "voltage", "status": 1, "path": "/)" << i
              << R"(", "description": "V" })";
    const json document = listedAsJson(model(nodes.str()));
    EXPECT_EQ(document["instances"].size(), 3000U);
}

} // namespace
