// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Object paths: the types of keys, the spellings that clients use, and the XML of paths.

#include "host/broker/ObjectPath.h"
#include "tests/host/cimxml/CimXmlTest.h"

namespace CimXmlTests {

namespace {

class PathTest : public CimXmlTest {
protected:
    static std::string flag(const std::string& on, const std::string& level, const std::string& at)
    {
        return instanceName(
            "Flag", binding("On", on) + binding("Level", level) + binding("At", at));
    }
    static std::string link(const std::string& owner)
    {
        return instanceName("Link", "<KEYBINDING NAME='Owner'><VALUE.REFERENCE>" + owner +
                                        "</VALUE.REFERENCE></KEYBINDING>");
    }
    static std::string keyOf(const std::string& attributes, const std::string& text)
    {
        return instanceName("Other", "<KEYBINDING NAME='K'><KEYVALUE " + attributes + ">" + text +
                                         "</KEYVALUE></KEYBINDING>");
    }
    const Host::Value& otherKey(const std::string& attributes, const std::string& text)
    {
        return *read(call("GetInstance", parameter("InstanceName", keyOf(attributes, text))))
                    .path->key("K");
    }
};

constexpr const char* dateTime = "20260102030405.000006+060";

TEST_F(PathTest, TypesKeysAsTheClassDeclaresThem)
{
    const auto operation = read(call("GetInstance", parameter("InstanceName", thing())));
    EXPECT_EQ(operation.path->toText(), "root/test:Thing.Name=\"a\",Index=7");
    EXPECT_EQ(operation.path->key("Index")->type(), CMPI_uint16);
    EXPECT_EQ(operation.path->key("Name")->type(), CMPI_string);
    EXPECT_EQ(pathText(flag("tRuE", " -0x80 ", dateTime)),
        "root/test:Flag.On=TRUE,Level=-128,At=\"" + std::string(dateTime) + "\"");
}

TEST_F(PathTest, SpellsNamesAsTheyAreDeclared)
{
    EXPECT_EQ(pathText(instanceName("tHING", binding("NAME", "A b ") + binding("index", "+1"))),
        "root/test:Thing.Name=\"A b \",Index=1");
}

TEST_F(PathTest, TakesTheOnlyKeyWithoutItsName)
{
    EXPECT_EQ(pathText(instanceName("single", "<KEYVALUE VALUETYPE='string'>x</KEYVALUE>")),
        "root/test:Single.InstanceID=\"x\"");
    EXPECT_EQ(pathRefusal(instanceName("Thing", "<KEYVALUE>x</KEYVALUE>")),
        "4 a key without name, but class Thing has 2 keys");
    EXPECT_EQ(pathRefusal(instanceName("Other", "<KEYVALUE>x</KEYVALUE>")),
        "5 class \"Other\" is not known, so its key has no name");
    EXPECT_THAT(pathRefusal(instanceName("Single", "<KEYVALUE>x</KEYVALUE><KEYVALUE/>")),
        testing::StartsWith("request-not-loosely-valid "));
}

TEST_F(PathTest, ReadsTextWithEntitiesCdataAndBlanks)
{
    EXPECT_EQ(pathText(instanceName("Single",
                  "<KEYVALUE> &lt;&amp;&#65;&#x1F600;<![CDATA[<b>]]><!-- c --> </KEYVALUE>")),
        "root/test:Single.InstanceID=\" <&A\xF0\x9F\x98\x80<b> \"");
    EXPECT_EQ(pathText(instanceName("Single", "<KEYVALUE>  </KEYVALUE>")),
        "root/test:Single.InstanceID=\"  \"");
    EXPECT_EQ(pathText(instanceName("Single", "<KEYVALUE/>")), "root/test:Single.InstanceID=\"\"");
}

TEST_F(PathTest, NamesTheKeyWhoseValueDoesNotFit)
{
    EXPECT_EQ(pathRefusal(instanceName("Thing", binding("Index", "65536"))),
        "4 key \"Index\": \"65536\" is no value of type uint16");
    for (const std::string text : {"-1", "", "1.0", "abc", "0x", "1 2", "--1"})
        EXPECT_THAT(pathRefusal(instanceName("Thing", binding("Index", text))),
            testing::StartsWith("4 key \"Index\": "))
            << text;
    EXPECT_THAT(pathRefusal(flag("yes", "1", dateTime)), testing::StartsWith("4 key \"On\": "));
    EXPECT_THAT(
        pathRefusal(flag("true", "128", dateTime)), testing::StartsWith("4 key \"Level\": "));
    EXPECT_THAT(
        pathRefusal(flag("true", "-129", dateTime)), testing::StartsWith("4 key \"Level\": "));
    EXPECT_THAT(pathRefusal(flag("true", "1", "now")), testing::StartsWith("4 key \"At\": "));
}

TEST_F(PathTest, BoundsTheKeysOfClassesThatAreNotKnown)
{
    std::string keys;
    for (int number = 0; number < 1000; ++number)
        keys += binding("K" + std::to_string(number), "x");
    EXPECT_EQ(pathRefusal(instanceName("Other", keys)), "read");
    EXPECT_EQ(pathRefusal(instanceName("Other", keys + binding("K", "x"))),
        "4 more than 1000 keys of class \"Other\", which is not known");
}

TEST_F(PathTest, RefusesKeysTheClassDoesNotHave)
{
    EXPECT_EQ(pathRefusal(instanceName("Thing", binding("Label", "x"))),
        "4 key \"Label\" is none of class Thing");
    EXPECT_EQ(pathRefusal(instanceName("Thing", binding("", "x"))), "4 a key with an empty name");
    EXPECT_EQ(pathRefusal(instanceName("Thing", binding("Name", "x") + binding("NAME", "y"))),
        "4 key \"NAME\" comes twice");
    EXPECT_EQ(
        pathRefusal(instanceName("Link", binding("Owner", "x"))), "4 key \"Owner\" is a reference");
    EXPECT_EQ(pathRefusal(instanceName("", "")), "4 a path without the name of a class");
    EXPECT_THAT(pathRefusal("<INSTANCENAME/>"), testing::StartsWith("request-not-loosely-valid "));
}

TEST_F(PathTest, ReadsReferencesInAllTheirForms)
{
    const std::string local = "<LOCALNAMESPACEPATH><NAMESPACE NAME='ROOT'/>"
                              "<NAMESPACE NAME='test'/></LOCALNAMESPACEPATH>";
    const auto owner = [this](const std::string& target) {
        return read(call("GetInstance", parameter("InstanceName", link(target))))
            .path->key("Owner")
            ->path()
            ->toText();
    };
    const std::string plain = "root/test:Thing.Name=\"a\",Index=7";
    EXPECT_EQ(owner(thing()), plain);
    EXPECT_EQ(owner("<LOCALINSTANCEPATH>" + local + thing() + "</LOCALINSTANCEPATH>"), plain);
    EXPECT_EQ(owner("<INSTANCEPATH><NAMESPACEPATH><HOST>h:5988</HOST>" + local +
                    "</NAMESPACEPATH>" + thing() + "</INSTANCEPATH>"),
        "//h:5988/" + plain);
    EXPECT_EQ(owner("<CLASSNAME NAME='THING'/>"), "root/test:Thing");
    const std::string host = "<HOST>h</HOST>";
    const std::string path = "<NAMESPACEPATH>" + host + local + "</NAMESPACEPATH>";
    for (const std::string& content : {thing(), path + thing() + thing(), path + path + thing(),
             "<NAMESPACEPATH>" + host + host + local + "</NAMESPACEPATH>" + thing(),
             "<NAMESPACEPATH>" + host + local + local + "</NAMESPACEPATH>" + thing()})
        EXPECT_THAT(pathRefusal(link("<INSTANCEPATH>" + content + "</INSTANCEPATH>")),
            testing::StartsWith("request-not-loosely-valid "))
            << content;
}

TEST_F(PathTest, BoundsHowDeepPathsStandInOneAnother)
{
    std::string name = instanceName("Other", "");
    const auto wrap = [&name] {
        name = instanceName("Other",
            "<KEYBINDING NAME='K'><VALUE.REFERENCE>" + name + "</VALUE.REFERENCE></KEYBINDING>");
    };
    for (int level = 1; level < 8; ++level)
        wrap();
    EXPECT_EQ(pathRefusal(name), "read");
    wrap();
    EXPECT_EQ(pathRefusal(name), "4 paths more than 8 deep in one another");
}

TEST_F(PathTest, GoesByTheKeyItselfWhereTheClassIsNotKnown)
{
    EXPECT_EQ(otherKey("", "5").type(), CMPI_string);
    EXPECT_EQ(otherKey("VALUETYPE='string'", "5").type(), CMPI_string);
    EXPECT_EQ(otherKey("VALUETYPE='boolean'", "TRUE").boolean(), true);
    EXPECT_EQ(otherKey("VALUETYPE='numeric'", "18446744073709551615").unsignedInteger(),
        18446744073709551615U);
    EXPECT_EQ(otherKey("VALUETYPE='NUMERIC'", "-5").signedInteger(), -5);
    EXPECT_EQ(otherKey("VALUETYPE='numeric'", "1.5").real(), 1.5);
    EXPECT_EQ(otherKey("TYPE='uint8' VALUETYPE='numeric'", "5").type(), CMPI_uint8);
    EXPECT_EQ(pathRefusal(keyOf("VALUETYPE='numeric'", "x")), "4 key \"K\": \"x\" is no number");
    EXPECT_EQ(
        pathRefusal(keyOf("VALUETYPE='numeric'", "+-1.5")), "4 key \"K\": \"+-1.5\" is no number");
    EXPECT_EQ(pathRefusal(keyOf("VALUETYPE='x'", "x")), "4 key \"K\": \"x\" is no VALUETYPE");
    EXPECT_EQ(pathRefusal(keyOf("TYPE='x'", "x")), "4 key \"K\": \"x\" is no type of a value");
}

TEST_F(PathTest, ReadsWhatItWroteAsTheSame)
{
    const std::string part =
        "<KEYBINDING NAME='Part'><VALUE.REFERENCE>" +
        instanceName("Single", binding("InstanceID", "&lt;&quot;&apos;&gt; ")) +
        "</VALUE.REFERENCE></KEYBINDING>";
    for (const std::string& name :
        {thing(), flag("false", "-7", dateTime), instanceName("Link", part),
            keyOf("VALUETYPE='numeric'", "-3"), keyOf("VALUETYPE='boolean'", "true"),
            keyOf("VALUETYPE='numeric'", "1e300"), instanceName("Single", "")}) {
        const auto* const path = read(call("GetInstance", parameter("InstanceName", name))).path;
        std::string written;
        Host::CimXml::writeInstanceName(written, *path);
        EXPECT_EQ(pathText(written), path->toText());
    }
}

} // namespace

} // namespace CimXmlTests
