// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/output/JsonDocument.h"

#include "host/broker/DateTime.h"
#include "tests/support/TemporaryFolder.h"
#include "tests/tools/InstanceTest.h"
#include "tests/tools/ToolTest.h"
#include "tools/output/Output.h"

#include <gtest/gtest.h>
#include <nlohmann/json.hpp>

#include <fcntl.h>
#include <unistd.h>

#include <cstdint>
#include <limits>

namespace {

using nlohmann::json;

class JsonDocumentTest : public Testing::InstanceTest {
protected:
    std::string text(const std::vector<const Host::Instance*>& instances) const
    {
        const std::string file = (folder_.path() / "document.json").string();
        const int descriptor = ::open(file.c_str(), O_WRONLY | O_CREAT | O_TRUNC, 0600);
        Tools::Output out(descriptor);
        Tools::writeJson(out, "ZUMLO_NumericSensor", instances);
        out.flush();
        ::close(descriptor);
        return Testing::contentOf(file);
    }

    json properties() const
    {
        return json::parse(text({&instance_})).at("instances").at(0).at("properties");
    }

    Testing::TemporaryFolder folder_;
};

TEST_F(JsonDocumentTest, WithoutInstancesHasAnEmptyList)
{
    EXPECT_EQ(text({}), "{\n  \"namespace\": \"root/cimv2\",\n"
                        "  \"class\": \"ZUMLO_NumericSensor\",\n  \"instances\": []\n}\n");
}

TEST_F(JsonDocumentTest, IsIndentedThroughout)
{
    setCodes("OperationalStatus", {2});
    EXPECT_EQ(text({&instance_, &instance_}), R"({
  "namespace": "root/cimv2",
  "class": "ZUMLO_NumericSensor",
  "instances": [
    {
      "path": "root/cimv2:ZUMLO_NumericSensor",
      "properties": {
        "OperationalStatus": [
          2
        ]
      }
    },
    {
      "path": "root/cimv2:ZUMLO_NumericSensor",
      "properties": {
        "OperationalStatus": [
          2
        ]
      }
    }
  ]
}
)");
}

TEST_F(JsonDocumentTest, EachTypeHasItsForm)
{
    setText("Text", "t");
    setNumber("Signed", -5);
    instance_.setProperty("Large", Host::Value::integer(CMPI_uint64, ~std::uint64_t{0}));
    instance_.setProperty("Flag", Host::Value::boolean(true));
    instance_.setProperty("Real", Host::Value::real(CMPI_real64, 0.5));
    instance_.setProperty("Path", Host::Value::of(request_.makePath("root/cimv2", "Other")));
    instance_.setProperty("Time",
        Host::Value::of(Host::DateTime::parse(request_.arena(), "19700101000000.000000+000")));
    setCodes("List", {1, 2});
    setCodes("EmptyList", {});
    EXPECT_EQ(properties(),
        json({{"Text", "t"}, {"Signed", -5}, {"Large", ~std::uint64_t{0}}, {"Flag", true},
            {"Real", 0.5}, {"Path", "root/cimv2:Other"}, {"Time", "19700101000000.000000+000"},
            {"List", {1, 2}}, {"EmptyList", json::array()}}));
}

TEST_F(JsonDocumentTest, PropertyWithoutValueIsLeftOut)
{
    instance_.setProperty("Nothing", Host::Value::null(CMPI_uint16));
    setText("Empty", "");
    EXPECT_EQ(properties(), json({{"Empty", ""}}));
}

TEST_F(JsonDocumentTest, ElementWithoutValueKeepsItsPlace)
{
    Host::Array& array = Host::Array::make(request_.arena(), CMPI_string, 2);
    array.set(1, Host::Value::text(request_.arena(), "second"));
    instance_.setProperty("List", Host::Value::of(array));
    EXPECT_EQ(properties(), json({{"List", {nullptr, "second"}}}));
}

TEST_F(JsonDocumentTest, BytesThatAreNoTextAreReplaced)
{
    setText("Text", "a\xFF"
                    "b\xC3");
    EXPECT_EQ(properties(), json({{"Text", "a\xEF\xBF\xBD"
                                           "b\xEF\xBF\xBD"}}));
}

TEST_F(JsonDocumentTest, TextThatATerminalWouldObeyIsEscapedAndKeepsItsMeaning)
{
    const std::string odd = "\x1B[31m \x7F \xC2\x9B \xE2\x80\xAE \"quoted\" \\ 温度";
    setText("Text", odd);
    EXPECT_EQ(properties(), json({{"Text", odd}}));
    for (const char* const raw : {"\x1B", "\x7F", "\xC2\x9B", "\xE2\x80\xAE"})
        EXPECT_EQ(text({&instance_}).find(raw), std::string::npos);
    EXPECT_NE(text({&instance_}).find("温度"), std::string::npos);
}

TEST_F(JsonDocumentTest, NumberThatJsonCannotHoldIsLeftOut)
{
    instance_.setProperty(
        "Real", Host::Value::real(CMPI_real64, std::numeric_limits<double>::infinity()));
    EXPECT_EQ(properties(), json::object());
}

} // namespace
