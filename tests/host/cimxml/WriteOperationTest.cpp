// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The operations that change something, and the values they bring.

#include "host/broker/Instance.h"
#include "host/broker/ObjectPath.h"
#include "host/broker/Text.h"
#include "tests/host/cimxml/CimXmlTest.h"

namespace CimXmlTests {

namespace {

class WriteOperationTest : public CimXmlTest {
protected:
    static std::string create(const std::string& className, const std::string& properties)
    {
        return call("CreateInstance",
            parameter("NewInstance",
                "<INSTANCE CLASSNAME='" + className + "'>" + properties + "</INSTANCE>"));
    }
    std::string created(const std::string& className, const std::string& properties)
    {
        return toText(*read(create(className, properties)).instance);
    }
    static std::string property(const std::string& name, const std::string& type,
        const std::string& content, const std::string& kind = "PROPERTY")
    {
        return "<" + kind + " NAME='" + name + "' TYPE='" + type + "'>" + content + "</" + kind +
               ">";
    }
    std::string set(const std::string& name, const std::string& value)
    {
        return toText(read(call("SetProperty", parameter("InstanceName", thing()) +
                                                   valueOf("PropertyName", name) + value))
                          .newValue);
    }
};

TEST_F(WriteOperationTest, readsNewInstancesByTheClass)
{
    EXPECT_EQ(created("THING", property("name", "string", "<VALUE> a </VALUE>") +
                                   property("Index", "string", "<VALUE>7</VALUE>") +
                                   property("IsOn", "boolean", "<VALUE>TRUE</VALUE>") +
                                   property("Reading", "real64", "<VALUE>2.5e1</VALUE>") +
                                   property("Label", "string", "") +
                                   property("Levels", "sint32",
                                       "<VALUE.ARRAY><VALUE>-1</VALUE><VALUE.NULL/><VALUE>2</VALUE>"
                                       "</VALUE.ARRAY>",
                                       "PROPERTY.ARRAY")),
        "instance of Thing { Name = \" a \"; Index = 7; IsOn = TRUE; Reading = 25; Label = NULL; "
        "Levels = {-1, NULL, 2}; };");
    const auto operation = read(create("thing", ""));
    EXPECT_EQ(operation.className, "Thing");
    EXPECT_EQ(operation.path, nullptr);
}

TEST_F(WriteOperationTest, readsInstancesOfUnknownClassesByTheirTypes)
{
    EXPECT_EQ(created("Other", property("P", "uint8", "<VALUE>5</VALUE>") +
                                   property("C", "char16", "<VALUE>&#xE9;</VALUE>") +
                                   "<PROPERTY.REFERENCE NAME='R'><VALUE.REFERENCE>" + thing() +
                                   "</VALUE.REFERENCE></PROPERTY.REFERENCE>"),
        "instance of Other { P = 5; C = 233; R = \"root/test:Thing.Name=\\\"a\\\",Index=7\"; };");
    EXPECT_EQ(refusalOf(create("Other", property("P", "x", "<VALUE>5</VALUE>"))),
        "4 property \"P\": \"x\" is no type of a value");
}

TEST_F(WriteOperationTest, boundsThePropertiesOfClassesThatAreNotKnown)
{
    std::string properties;
    for (int number = 0; number < 1000; ++number)
        properties += property("P" + std::to_string(number), "string", "");
    EXPECT_EQ(refusalOf(create("Other", properties)), "read");
    EXPECT_EQ(refusalOf(create("Other", properties + property("P", "string", ""))),
        "4 more than 1000 properties of class \"Other\", which is not known");
}

TEST_F(WriteOperationTest, namesThePropertyThatIsWrong)
{
    EXPECT_EQ(refusalOf(create("Thing", property("None", "string", ""))),
        "4 property \"None\" is none of class Thing");
    EXPECT_EQ(
        refusalOf(create("Thing", property("Name", "string", "") + property("NAME", "string", ""))),
        "4 property \"NAME\" comes twice");
    EXPECT_EQ(refusalOf(create("Thing", property("Index", "uint16", "<VALUE>x</VALUE>"))),
        "4 property \"Index\": \"x\" is no value of type uint16");
    EXPECT_EQ(refusalOf(create("Thing", property("Levels", "sint32", "<VALUE>1</VALUE>"))),
        "4 property \"Levels\" is of type sint32[], which no VALUE can be");
    EXPECT_EQ(
        refusalOf(create("Thing", property("", "sint32", ""))), "4 a property with an empty name");
}

TEST_F(WriteOperationTest, readsModifiedInstancesAtTheirPath)
{
    const auto modify = [](const std::string& className) {
        return call("ModifyInstance",
            parameter("ModifiedInstance", "<VALUE.NAMEDINSTANCE>" + thing() +
                                              "<INSTANCE CLASSNAME='" + className + "'>" +
                                              property("Label", "string", "<VALUE>x</VALUE>") +
                                              "</INSTANCE></VALUE.NAMEDINSTANCE>") +
                parameter("PropertyList", "<VALUE.ARRAY><VALUE>label</VALUE></VALUE.ARRAY>"));
    };
    const auto operation = read(modify("thing"));
    EXPECT_EQ(operation.path->toText(), "root/test:Thing.Name=\"a\",Index=7");
    EXPECT_EQ(toText(*operation.instance), "instance of Thing { Label = \"x\"; };");
    EXPECT_EQ(operation.selection.properties->size(), 1U);
    EXPECT_TRUE(operation.selection.includeQualifiers);
    EXPECT_EQ(refusalOf(modify("Single")),
        "4 parameter ModifiedInstance is of another class than its path");
    EXPECT_THAT(refusalOf(call("ModifyInstance",
                    parameter("ModifiedInstance",
                        "<VALUE.NAMEDINSTANCE>" + thing() + "</VALUE.NAMEDINSTANCE>"))),
        testing::StartsWith("request-not-loosely-valid "));
}

TEST_F(WriteOperationTest, typesANewValueByItsProperty)
{
    EXPECT_EQ(set("label", parameter("NewValue", "<VALUE>5</VALUE>")), "\"5\"");
    EXPECT_EQ(set("Reading", parameter("NewValue", "<VALUE>5</VALUE>")), "5");
    EXPECT_EQ(set("Label", ""), "NULL");
    EXPECT_EQ(set("Levels", parameter("NewValue", "<VALUE.ARRAY/>")), "{}");
    EXPECT_EQ(set("None", parameter("NewValue", "<VALUE>5</VALUE>")), "NULL");
    EXPECT_EQ(refusalOf(call("SetProperty", parameter("InstanceName", thing()) +
                                                valueOf("PropertyName", "IsOn") +
                                                valueOf("NewValue", "5"))),
        "4 parameter NewValue: \"5\" is no value of type boolean");
}

TEST_F(WriteOperationTest, readsDeletionsAndQueries)
{
    EXPECT_EQ(read(call("DeleteInstance", parameter("InstanceName", thing()))).path->toText(),
        "root/test:Thing.Name=\"a\",Index=7");
    const auto query =
        read(call("ExecQuery", valueOf("QueryLanguage", "WQL") + valueOf("Query", "select *")));
    EXPECT_EQ(query.queryLanguage, "WQL");
    EXPECT_EQ(query.query, "select *");
}

} // namespace

} // namespace CimXmlTests
