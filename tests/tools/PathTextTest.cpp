// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/cim/PathText.h"

#include "host/broker/Broker.h"
#include "host/broker/ObjectPath.h"
#include "host/broker/Request.h"
#include "tests/support/ErrorOf.h"
#include "tests/support/ShippedClasses.h"
#include "tools/UsageError.h"

#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <algorithm>

namespace {

class PathTextTest : public testing::Test {
protected:
    const Host::ObjectPath* read(std::string_view text)
    {
        return Tools::readPath(request_.arena(), *classes_, text);
    }

    // Returns the text of the path after it was read.
    std::string again(std::string_view text)
    {
        const Host::ObjectPath* const path = read(text);
        return path == nullptr ? "no path" : path->toText();
    }

    std::string mistakeIn(std::string_view text)
    {
        const std::string what = Testing::errorOf([&] { again(text); });
        EXPECT_EQ(what.substr(0, text.size() + 2), std::string(text) + ": ");
        return what.substr(std::min(text.size() + 2, what.size()));
    }

    const std::unique_ptr<const Host::Repository> classes_ = Testing::shippedClasses();
    Host::Broker broker_;
    Host::Request request_{broker_};
};

TEST_F(PathTextTest, ReadsWhatIsWritten)
{
    for (const char* const text : {"//host.example.org:5989/root/"
                                   "cimv2:ZUMLO_ComputerSystem.CreationClassName=\"x\",Name=\"a, "
                                   "b=c: \\\"quoted\\\" back\\\\slash\"",
             "root/interop:CIM_Namespace.Name=\"CPU 1:/cpu.0/temp1\",SystemName=\"\"",
             "root/cimv2:CIM_Sensor.A=1,B=-5,C=TRUE,D=18446744073709551615",
             "//h/root/cimv2:ZUMLO_SensorSystemDevice.GroupComponent=\"//h/root/"
             "cimv2:ZUMLO_ComputerSystem.Name=\\\"a\\\\\\\"b\\\"\",PartComponent=\"root/"
             "cimv2:ZUMLO_NumericSensor.DeviceID=\\\"d\\\"\""})
        EXPECT_EQ(again(text), text);
}

TEST_F(PathTextTest, ReferencesArePathsAndTextsAreTexts)
{
    const Host::ObjectPath* const path =
        read("ZUMLO_SensorSystemDevice.GROUPcomponent=\"ZUMLO_ComputerSystem.Name=\\\"n\\\"\","
             "Other=\"ZUMLO_ComputerSystem.Name=\\\"n\\\"\"");
    EXPECT_NE(path->key("GroupComponent")->path(), nullptr);
    EXPECT_TRUE(path->key("Other")->text());
}

TEST_F(PathTextTest, NamespaceIsTheUsualOneWhenNoneIsGiven)
{
    EXPECT_EQ(
        again("ZUMLO_ComputerSystem.Name=\"n\""), "root/cimv2:ZUMLO_ComputerSystem.Name=\"n\"");
}

TEST_F(PathTextTest, WhatNamesNoKnownClassIsMeantAsSomethingElse)
{
    for (const char* const text : {"", "CPU 1:/cpu0/temp1", "a.b=\"c\"", "//", "//h", "//h/n:C.k=1",
             "ZUMLO_ComputerSystem", "+12V:/board/in1", ":", ".", "\"", "x:y.z=\"ZUMLO_"})
        EXPECT_EQ(read(text), nullptr) << text;
}

TEST_F(PathTextTest, MistakesAreNamedWithTheirColumn)
{
    const std::string start = "ZUMLO_ComputerSystem.";
    EXPECT_EQ(mistakeIn(start), "column 22: expected the name of a key and =");
    EXPECT_EQ(mistakeIn(start + "Name"), "column 22: expected the name of a key and =");
    EXPECT_EQ(mistakeIn(start + "Name=\"a\",=1"), "column 31: expected the name of a key and =");
    EXPECT_EQ(mistakeIn(start + "Name=\"a"), "column 27: the quotes are not closed");
    EXPECT_EQ(mistakeIn(start + "Name=\"a\\"), "column 27: the quotes are not closed");
    EXPECT_EQ(mistakeIn(start + "Name=\"a\"b"), "column 30: expected a comma or the end");
    EXPECT_EQ(mistakeIn(start + "Name=blue"),
        "column 27: expected a text in quotes, a number, TRUE or FALSE");
    EXPECT_EQ(mistakeIn("ZUMLO_SensorSystemDevice.GroupComponent=\"x\""),
        "column 41: expected the path of an object of a known class, in quotes");
    EXPECT_EQ(mistakeIn("ZUMLO_SensorSystemDevice.GroupComponent=1"),
        "column 41: expected the path of an object of a known class, in quotes");
}

TEST_F(PathTextTest, EndlessNestingIsRefused)
{
    std::string path = "ZUMLO_ComputerSystem.Name=\"n\"";
    for (int depth = 0; depth < 9; ++depth) {
        std::string quoted;
        for (const char c : path)
            quoted.append(c == '"' || c == '\\' ? "\\" : "").append(1, c);
        path = "ZUMLO_SensorSystemDevice.GroupComponent=\"" + quoted + "\"";
    }
    EXPECT_THROW(read(path), Tools::UsageError);
}

} // namespace
