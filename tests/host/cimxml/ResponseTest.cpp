// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Responses and the objects in them.

#include "host/broker/Array.h"
#include "host/broker/Instance.h"
#include "host/cimxml/InstanceElement.h"
#include "tests/host/cimxml/CimXmlTest.h"

#include <limits>

namespace CimXmlTests {

namespace {

using Host::Value;
using Host::CimXml::InstanceMarkup;
using Host::CimXml::OperationKind;
using Host::CimXml::ResponseWriter;
using testing::HasSubstr;

const std::string head = R"(<?xml version="1.0" encoding="utf-8"?>)"
                         "\n"
                         R"(<CIM CIMVERSION="2.0" DTDVERSION="2.0"><MESSAGE ID="4711" )"
                         R"(PROTOCOLVERSION="1.0"><SIMPLERSP><IMETHODRESPONSE NAME=")";
const std::string tail = "</IMETHODRESPONSE></SIMPLERSP></MESSAGE></CIM>\n";
const std::string nameXml =
    R"(<INSTANCENAME CLASSNAME="Thing"><KEYBINDING NAME="Name"><KEYVALUE VALUETYPE="string">a)"
    R"(</KEYVALUE></KEYBINDING><KEYBINDING NAME="Index"><KEYVALUE VALUETYPE="numeric">7)"
    R"(</KEYVALUE></KEYBINDING></INSTANCENAME>)";
const std::string instanceXml =
    R"(<INSTANCE CLASSNAME="Thing"><PROPERTY NAME="Name" TYPE="string"><VALUE>a</VALUE></PROPERTY>)"
    R"(<PROPERTY NAME="Index" TYPE="uint16"><VALUE>7</VALUE></PROPERTY></INSTANCE>)";
const std::string nameSpaceXml =
    R"(<NAMESPACEPATH><HOST>box</HOST><LOCALNAMESPACEPATH><NAMESPACE NAME="root"></NAMESPACE>)"
    R"(<NAMESPACE NAME="test"></NAMESPACE></LOCALNAMESPACEPATH></NAMESPACEPATH>)";
const std::string pathXml = "<INSTANCEPATH>" + nameSpaceXml + nameXml + "</INSTANCEPATH>";

class ResponseTest : public CimXmlTest {
protected:
    // Returns the whole response, whose objects the function appends.
    template <typename AppendObjects>
    std::string response(
        const std::string& name, OperationKind kind, const AppendObjects& appendObjects)
    {
        ResponseWriter writer(
            Message(call(name)), kind, *repository, {"box", Testing::testNameSpace}, {});
        std::string out;
        writer.begin(out);
        appendObjects(writer, out);
        return out;
    }
    // Returns the content of the IRETURNVALUE.
    template <typename AppendObject>
    std::string result(OperationKind kind, const AppendObject& appendObject)
    {
        const std::string all = response("X", kind, [&](ResponseWriter& writer, std::string& out) {
            appendObject(writer, out);
            writer.finish(out);
        });
        const auto begin = all.find("<IRETURNVALUE>") + 14;
        return all.substr(begin, all.find("</IRETURNVALUE>") - begin);
    }
    std::string instanceBy(OperationKind kind)
    {
        return result(kind,
            [&](ResponseWriter& writer, std::string& out) { writer.instance(out, instance()); });
    }
    std::string pathBy(OperationKind kind)
    {
        return result(
            kind, [&](ResponseWriter& writer, std::string& out) { writer.path(out, path()); });
    }
    std::string classNameBy(OperationKind kind)
    {
        return result(
            kind, [](ResponseWriter& writer, std::string& out) { writer.className(out, "Thing"); });
    }

    Host::Instance& emptyInstance(const char* className = "Thing")
    {
        return request.makeInstance(request.makePath(Testing::testNameSpace, className));
    }
    Host::ObjectPath& path()
    {
        Host::ObjectPath& made = request.makePath(Testing::testNameSpace, "Thing");
        made.addKey("Name", Value::text(request.arena(), "a"));
        made.addKey("Index", Value::integer(CMPI_uint16, 7));
        return made;
    }
    Host::Instance& instance()
    {
        broker.setClassInformation(repository);
        Host::Instance& made = emptyInstance();
        made.setProperty("Name", Value::text(request.arena(), "a"));
        made.setProperty("Index", Value::integer(CMPI_uint16, 7));
        return made;
    }
    static std::string valueXml(const Value& value)
    {
        std::string out;
        Host::CimXml::writeValue(out, value);
        return out;
    }
    std::string textXml(std::string_view text)
    {
        return valueXml(Value::text(request.arena(), text));
    }
    static std::string markupOf(const Host::Instance& instance,
        const Host::ClassDeclaration* declared = nullptr,
        const Host::CimXml::ObjectSelection& selection = {})
    {
        std::string out;
        InstanceMarkup(selection).write(out, instance, declared);
        return out;
    }
};

TEST_F(ResponseTest, WrapsInstancesAsTheOperationDoes)
{
    EXPECT_EQ(instanceBy(OperationKind::getInstance), instanceXml);
    EXPECT_EQ(instanceBy(OperationKind::enumerateInstances),
        "<VALUE.NAMEDINSTANCE>" + nameXml + instanceXml + "</VALUE.NAMEDINSTANCE>");
    for (const auto kind : {OperationKind::associators, OperationKind::references})
        EXPECT_EQ(instanceBy(kind),
            "<VALUE.OBJECTWITHPATH>" + pathXml + instanceXml + "</VALUE.OBJECTWITHPATH>");
    for (const auto kind :
        {OperationKind::openEnumerateInstances, OperationKind::pullInstancesWithPath})
        EXPECT_EQ(instanceBy(kind),
            "<VALUE.INSTANCEWITHPATH>" + pathXml + instanceXml + "</VALUE.INSTANCEWITHPATH>");
}

TEST_F(ResponseTest, WritesAnInstanceTheSameWhateverWasWrittenBefore)
{
    const Host::ClassDeclaration* const thing = &Testing::classNamed(*repository, "Thing");
    const Host::ClassDeclaration* const gauge = &Testing::classNamed(*repository, "Gauge");
    const Value text = Value::text(request.arena(), "a");
    const Value number = Value::integer(CMPI_uint16, 7);
    const auto instanceWith = [this](const std::vector<std::pair<const char*, Value>>& properties) {
        Host::Instance& made = emptyInstance();
        for (const auto& [name, value] : properties)
            made.setProperty(name, value);
        return &made;
    };
    const auto list = [this](CMPIType type, const std::vector<Value>& values) {
        Host::Array& made =
            Host::Array::make(request.arena(), type, static_cast<CMPICount>(values.size()));
        for (std::size_t i = 0; i < values.size(); ++i)
            made.set(static_cast<CMPICount>(i), values[i]);
        return Value::of(made);
    };
    const Value otherText = Value::text(request.arena(), "b");
    const Value noText = Value::null(CMPI_string);
    const std::vector<Host::Instance*> instances = {
        instanceWith({{"Name", text}, {"Index", number}}),
        instanceWith({{"Index", number}, {"Name", text}}),
        instanceWith({{"Name", Value()}, {"Unknown", text}, {"Index", text}}),
        instanceWith({}),
        instanceWith({{"name", text}, {"INDEX", Value()}}),
        instanceWith({{"Unknown", number}, {"Name", text}, {"Index", number}}),
        instanceWith({{"List", list(CMPI_uint16, {number, number})}, {"Name", text}}),
        instanceWith({{"List", list(CMPI_uint16, {number, number})}, {"Index", number}}),
        instanceWith({{"List", list(CMPI_uint16, {number, Value::integer(CMPI_uint16, 8)})}}),
        instanceWith({{"List", list(CMPI_uint16, {number})}}),
        instanceWith({{"List", Value::null(CMPI_uint16A)}}),
        instanceWith({{"List", list(CMPI_string, {text, otherText})}}),
        instanceWith({{"List", list(CMPI_string, {Value::text(request.arena(), "a"), otherText})}}),
        instanceWith({{"List", list(CMPI_string, {text, text})}}),
        instanceWith({{"List", list(CMPI_string, {noText, text})}}),
        instanceWith({{"List", list(CMPI_string, {noText, noText})}}),
    };
    Host::CimXml::ObjectSelection selection;
    selection.localOnly = true;
    selection.includeQualifiers = true;
    selection.includeClassOrigin = true;
    for (const bool writesNulls : {false, true}) {
        selection.writesNulls = writesNulls;
        InstanceMarkup writer(selection);
        for (const Host::ClassDeclaration* const declared : {thing, gauge, thing, {}, gauge})
            for (const Host::Instance* const each : instances) {
                std::string out;
                writer.write(out, *each, declared);
                EXPECT_EQ(out, markupOf(*each, declared, selection));
            }
    }
}

TEST_F(ResponseTest, WrapsPathsAndClassNamesAsTheOperationDoes)
{
    EXPECT_EQ(pathBy(OperationKind::enumerateInstanceNames), nameXml);
    EXPECT_EQ(pathBy(OperationKind::associatorNames), "<OBJECTPATH>" + pathXml + "</OBJECTPATH>");
    EXPECT_EQ(pathBy(OperationKind::referenceNames), "<OBJECTPATH>" + pathXml + "</OBJECTPATH>");
    EXPECT_EQ(pathBy(OperationKind::pullInstancePaths), pathXml);
    const std::string name = "<CLASSNAME NAME=\"Thing\"></CLASSNAME>";
    EXPECT_EQ(classNameBy(OperationKind::enumerateClassNames), name);
    EXPECT_EQ(classNameBy(OperationKind::associatorNames),
        "<OBJECTPATH><CLASSPATH>" + nameSpaceXml + name + "</CLASSPATH></OBJECTPATH>");
}

TEST_F(ResponseTest, WritesClassesAndQualifiers)
{
    const auto single = [this](OperationKind kind) {
        return result(kind, [this](ResponseWriter& writer, std::string& out) {
            writer.classDeclaration(out, Testing::classNamed(*repository, "Single"));
        });
    };
    const std::string declared =
        R"(<CLASS NAME="Single"><PROPERTY NAME="InstanceID" TYPE="string"></PROPERTY></CLASS>)";
    EXPECT_EQ(single(OperationKind::enumerateClasses), declared);
    EXPECT_EQ(single(OperationKind::associators),
        "<VALUE.OBJECTWITHPATH><CLASSPATH>" + nameSpaceXml +
            "<CLASSNAME NAME=\"Single\"></CLASSNAME></CLASSPATH>" + declared +
            "</VALUE.OBJECTWITHPATH>");
    const std::string key = result(OperationKind::getQualifier, [this](ResponseWriter& writer,
                                                                    std::string& out) {
        writer.qualifierDeclaration(out, *repository->findQualifier(Testing::testNameSpace, "Key"));
    });
    EXPECT_THAT(key, testing::StartsWith("<QUALIFIER.DECLARATION NAME=\"Key\""));
}

TEST_F(ResponseTest, WithoutObjectsTheReturnValueIsEmptyOrLeftOut)
{
    const auto empty = [this](const std::string& name, OperationKind kind) {
        return response(
            name, kind, [](ResponseWriter& writer, std::string& out) { writer.finish(out); });
    };
    EXPECT_EQ(empty("EnumerateInstances", OperationKind::enumerateInstances),
        head + "EnumerateInstances\"><IRETURNVALUE></IRETURNVALUE>" + tail);
    EXPECT_EQ(empty("CloseEnumeration", OperationKind::closeEnumeration),
        head + "CloseEnumeration\">" + tail);
}

TEST_F(ResponseTest, SaysWhetherAnEnumerationGoesOn)
{
    const auto pulled = [this](const std::optional<std::string>& context) {
        return response("PullInstancePaths", OperationKind::pullInstancePaths,
            [&](ResponseWriter& writer, std::string& out) { writer.finish(out, context); });
    };
    const auto expected = [](const std::string& ended, const std::string& context) {
        return head +
               R"(PullInstancePaths"><IRETURNVALUE></IRETURNVALUE>)"
               R"(<PARAMVALUE NAME="EndOfSequence" PARAMTYPE="boolean"><VALUE>)" +
               ended +
               R"(</VALUE></PARAMVALUE><PARAMVALUE NAME="EnumerationContext" PARAMTYPE="string">)" +
               "<VALUE>" + context + "</VALUE></PARAMVALUE>" + tail;
    };
    EXPECT_EQ(pulled("c&1"), expected("FALSE", "c&amp;1"));
    EXPECT_EQ(pulled(std::nullopt), expected("TRUE", ""));
}

TEST_F(ResponseTest, ReportsFailuresWithCodeAndText)
{
    EXPECT_EQ(errorResponse(Message(call("GetInstance")), CMPI_RC_ERR_NOT_FOUND, "no \"x\" <here>"),
        head + R"(GetInstance"><ERROR CODE="6" DESCRIPTION="no &quot;x&quot; &lt;here&gt;">)" +
            "</ERROR>" + tail);
}

TEST_F(ResponseTest, WritesTheValueOfAProperty)
{
    const auto property = [this](const Value& value) {
        return result(OperationKind::getProperty,
            [&](ResponseWriter& writer, std::string& out) { writer.value(out, value); });
    };
    EXPECT_EQ(property(Value::integer(CMPI_sint32, 5)), "<VALUE>5</VALUE>");
    EXPECT_EQ(property(Value::null(CMPI_sint32)), "");
}

TEST_F(ResponseTest, RepeatsWhatTheRequestSaysEscaped)
{
    std::string body = call("Get&lt;Instance");
    body.replace(body.find("4711"), 4, "&quot;&amp;&#233;");
    EXPECT_THAT(errorResponse(Message(body), CMPI_RC_ERR_NOT_SUPPORTED, "x"),
        testing::AllOf(
            HasSubstr("ID=\"&quot;&amp;\xC3\xA9\""), HasSubstr("NAME=\"Get&lt;Instance\"")));
}

TEST_F(ResponseTest, WritesValuesOfEveryType)
{
    EXPECT_EQ(valueXml(Value::boolean(true)), "<VALUE>TRUE</VALUE>");
    EXPECT_EQ(valueXml(Value::integer(CMPI_sint8, 0x80)), "<VALUE>-128</VALUE>");
    EXPECT_EQ(valueXml(Value::integer(CMPI_char16, 0xE9)), "<VALUE>\xC3\xA9</VALUE>");
    EXPECT_EQ(valueXml(Value::integer(CMPI_char16, 0xD800)), "<VALUE>\xEF\xBF\xBD</VALUE>");
    EXPECT_EQ(valueXml(Value::real(CMPI_real64, 1)), "<VALUE>1.0</VALUE>");
    EXPECT_EQ(valueXml(Value::real(CMPI_real64, 1e300)), "<VALUE>1.0e+300</VALUE>");
    EXPECT_EQ(valueXml(Value::real(CMPI_real32, 0.1)), "<VALUE>0.1</VALUE>");
    const double infinity = std::numeric_limits<double>::infinity();
    EXPECT_EQ(valueXml(Value::real(CMPI_real64, -infinity)), "<VALUE>-INF</VALUE>");
    EXPECT_EQ(valueXml(Value::null(CMPI_string)), "");
    EXPECT_EQ(textXml(""), "<VALUE></VALUE>");
}

TEST_F(ResponseTest, WritesTextThatEveryClientCanRead)
{
    EXPECT_EQ(textXml("<a b='c' d=\"e\">&\t\n"),
        "<VALUE>&lt;a b=&apos;c&apos; d=&quot;e&quot;&gt;&amp;\t\n</VALUE>");
    EXPECT_EQ(textXml("\x01\x7F\xEF\xBF\xBF"), "<VALUE>\xEF\xBF\xBD\x7F\xEF\xBF\xBD</VALUE>");
    EXPECT_EQ(textXml("\xFFz\xC3\xA9"), "<VALUE>\xEF\xBF\xBDz\xC3\xA9</VALUE>");
    EXPECT_EQ(textXml("\xC0\x80"), "<VALUE>\xEF\xBF\xBD\xEF\xBF\xBD</VALUE>");
    EXPECT_EQ(textXml("\xF0\x9F\x98\x80"), "<VALUE>\xF0\x9F\x98\x80</VALUE>");
    EXPECT_EQ(textXml("\xF0\x9F"), "<VALUE>\xEF\xBF\xBD\xEF\xBF\xBD</VALUE>");
}

TEST_F(ResponseTest, LeavesNullsInArraysOut)
{
    Host::Array& array = Host::Array::make(request.arena(), CMPI_uint8, 3);
    array.set(0, Value::integer(CMPI_uint8, 1));
    array.set(2, Value::integer(CMPI_uint8, 3));
    Host::Instance& made = emptyInstance();
    made.setProperty("L", Value::of(array));
    EXPECT_EQ(markupOf(made),
        R"(<INSTANCE CLASSNAME="Thing"><PROPERTY.ARRAY NAME="L" TYPE="uint8"><VALUE.ARRAY>)"
        R"(<VALUE>1</VALUE><VALUE>3</VALUE></VALUE.ARRAY></PROPERTY.ARRAY></INSTANCE>)");
}

TEST_F(ResponseTest, TakesFromTheClassWhatAValueDoesNotSay)
{
    const auto& declared = Testing::classNamed(*repository, "Gauge");
    Host::Instance& made = emptyInstance("Gauge");
    made.setProperty("Levels", Value());
    made.setProperty("Percent", Value::null(CMPI_uint8));
    Host::CimXml::ObjectSelection selection;
    EXPECT_EQ(markupOf(made, &declared),
        R"(<INSTANCE CLASSNAME="Gauge"><PROPERTY.ARRAY NAME="Levels" TYPE="sint32">)"
        R"(</PROPERTY.ARRAY><PROPERTY NAME="Percent" TYPE="uint8"></PROPERTY></INSTANCE>)");
    selection.includeClassOrigin = true;
    selection.properties = {"LEVELS"};
    EXPECT_EQ(markupOf(made, &declared, selection),
        R"(<INSTANCE CLASSNAME="Gauge"><PROPERTY.ARRAY NAME="Levels" TYPE="sint32" )"
        R"(CLASSORIGIN="Thing" PROPAGATED="true"></PROPERTY.ARRAY></INSTANCE>)");
}

TEST_F(ResponseTest, WritesANullForAListedPropertyThatTheInstanceLacks)
{
    const auto& declared = Testing::classNamed(*repository, "Gauge");
    Host::Instance& made = emptyInstance("Gauge");
    made.setProperty("Percent", Value::integer(CMPI_uint8, 7));
    Host::CimXml::ObjectSelection selection;
    selection.properties = {"percent", "LEVELS", "Unknown"};
    const std::string begin = R"(<INSTANCE CLASSNAME="Gauge"><PROPERTY NAME="Percent" )"
                              R"(TYPE="uint8"><VALUE>7</VALUE></PROPERTY>)";
    EXPECT_EQ(markupOf(made, &declared, selection), begin + "</INSTANCE>");
    selection.writesNulls = true;
    EXPECT_EQ(markupOf(made, &declared, selection),
        begin + R"(<PROPERTY.ARRAY NAME="Levels" TYPE="sint32"></PROPERTY.ARRAY></INSTANCE>)");
    EXPECT_EQ(markupOf(made, nullptr, selection), begin + "</INSTANCE>");
}

TEST_F(ResponseTest, WritesReferencesWithWhatTheyKnow)
{
    Host::Instance& made = emptyInstance("Link");
    Host::ObjectPath& target = path();
    made.setProperty("Owner", Value::of(target));
    const auto& declared = Testing::classNamed(*repository, "Link");
    const std::string begin = R"(<INSTANCE CLASSNAME="Link"><PROPERTY.REFERENCE NAME="Owner" )"
                              R"(REFERENCECLASS="Thing"><VALUE.REFERENCE>)";
    const std::string end = "</VALUE.REFERENCE></PROPERTY.REFERENCE></INSTANCE>";
    EXPECT_EQ(markupOf(made, &declared),
        begin + R"(<LOCALINSTANCEPATH><LOCALNAMESPACEPATH><NAMESPACE NAME="root"></NAMESPACE>)" +
            R"(<NAMESPACE NAME="test"></NAMESPACE></LOCALNAMESPACEPATH>)" + nameXml +
            "</LOCALINSTANCEPATH>" + end);
    target.setHost("box");
    EXPECT_EQ(markupOf(made, &declared), begin + pathXml + end);
    target.setNameSpace(nullptr);
    EXPECT_EQ(markupOf(made, &declared), begin + nameXml + end);
}

TEST_F(ResponseTest, WritesEmbeddedInstancesAsText)
{
    Host::Instance& inner = emptyInstance("Single");
    inner.setProperty("InstanceID", Value::text(request.arena(), "<"));
    Host::Instance& outer = emptyInstance();
    outer.setProperty("In", Value::of(inner));
    EXPECT_EQ(markupOf(outer),
        R"(<INSTANCE CLASSNAME="Thing"><PROPERTY NAME="In" TYPE="string" EmbeddedObject="instance">)"
        R"(<VALUE>&lt;INSTANCE CLASSNAME=&quot;Single&quot;&gt;&lt;PROPERTY )"
        R"(NAME=&quot;InstanceID&quot; TYPE=&quot;string&quot;&gt;&lt;VALUE&gt;&amp;lt;&lt;/VALUE)"
        R"(&gt;&lt;/PROPERTY&gt;&lt;/INSTANCE&gt;</VALUE></PROPERTY></INSTANCE>)");
}

} // namespace

} // namespace CimXmlTests
