// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The operations of a read-only server, and their parameters.

#include "host/broker/ObjectPath.h"
#include "tests/host/cimxml/CimXmlTest.h"

namespace CimXmlTests {

namespace {

using Host::CimXml::OperationKind;
using testing::ElementsAre;
using testing::IsEmpty;
using testing::Optional;
using testing::StartsWith;

class OperationTest : public CimXmlTest {};

const std::string instanceParameter = parameter("InstanceName", thing());
const std::string objectParameter = parameter("ObjectName", thing());
const std::string gaugeParameter = classOf("ClassName", "gauge");
const std::string filterParameters = valueOf("Role", "Owner") + classOf("ResultClass", "single");
const std::string moreFilters = valueOf("ResultRole", "Part") + classOf("AssocClass", "LINK");

TEST_F(OperationTest, TakesEveryOperationWithWhatItNeeds)
{
    const std::string pull = valueOf("EnumerationContext", "c") + valueOf("MaxObjectCount", "9");
    const std::vector<std::tuple<std::string, std::string, OperationKind>> operations = {
        {"GetInstance", instanceParameter, OperationKind::getInstance},
        {"EnumerateInstances", gaugeParameter, OperationKind::enumerateInstances},
        {"EnumerateInstanceNames", gaugeParameter, OperationKind::enumerateInstanceNames},
        {"Associators", objectParameter + filterParameters + moreFilters,
            OperationKind::associators},
        {"AssociatorNames", objectParameter + filterParameters + moreFilters,
            OperationKind::associatorNames},
        {"References", objectParameter + filterParameters, OperationKind::references},
        {"ReferenceNames", objectParameter + filterParameters, OperationKind::referenceNames},
        {"GetClass", gaugeParameter, OperationKind::getClass},
        {"EnumerateClasses", "", OperationKind::enumerateClasses},
        {"EnumerateClassNames", gaugeParameter, OperationKind::enumerateClassNames},
        {"GetProperty", instanceParameter + valueOf("PropertyName", "Label"),
            OperationKind::getProperty},
        {"GetQualifier", valueOf("QualifierName", "Key"), OperationKind::getQualifier},
        {"EnumerateQualifiers", "", OperationKind::enumerateQualifiers},
        {"OpenEnumerateInstances", gaugeParameter, OperationKind::openEnumerateInstances},
        {"OpenEnumerateInstancePaths", gaugeParameter, OperationKind::openEnumerateInstancePaths},
        {"OpenAssociatorInstances", instanceParameter + filterParameters + moreFilters,
            OperationKind::openAssociatorInstances},
        {"OpenAssociatorInstancePaths", instanceParameter + filterParameters + moreFilters,
            OperationKind::openAssociatorInstancePaths},
        {"OpenReferenceInstances", instanceParameter + filterParameters,
            OperationKind::openReferenceInstances},
        {"OpenReferenceInstancePaths", instanceParameter + filterParameters,
            OperationKind::openReferenceInstancePaths},
        {"PullInstancesWithPath", pull, OperationKind::pullInstancesWithPath},
        {"PullInstancePaths", pull, OperationKind::pullInstancePaths},
        {"CloseEnumeration", valueOf("EnumerationContext", "c"), OperationKind::closeEnumeration},
    };
    for (const auto& [name, parameters, kind] : operations) {
        const Operation operation = read(call(name, parameters));
        EXPECT_EQ(operation.kind, kind) << name;
        EXPECT_EQ(operation.nameSpace, "root/test");
        EXPECT_EQ(refusalOf(call(name, parameters + valueOf("Strange", "1"))),
            "4 " + name + " has no parameter \"Strange\"");
        if (!parameters.empty() && kind != OperationKind::enumerateClassNames) {
            EXPECT_THAT(refusalOf(call(name)), StartsWith("4 " + name + " needs parameter "));
        }
    }
}

TEST_F(OperationTest, DefaultsAreThoseOfTheOperation)
{
    const auto get = read(call("GetInstance", instanceParameter));
    EXPECT_TRUE(get.selection.localOnly);
    EXPECT_FALSE(get.selection.includeQualifiers);
    EXPECT_EQ(get.selection.properties, std::nullopt);
    const auto enumerate = read(call("EnumerateInstances", gaugeParameter));
    EXPECT_TRUE(enumerate.selection.localOnly && enumerate.deepInheritance);
    const auto classes = read(call("EnumerateClasses"));
    EXPECT_TRUE(classes.selection.localOnly && classes.selection.includeQualifiers);
    EXPECT_FALSE(classes.deepInheritance);
    EXPECT_EQ(classes.className, "");
    const auto open = read(call("OpenEnumerateInstances", gaugeParameter));
    EXPECT_TRUE(open.deepInheritance);
    EXPECT_FALSE(open.selection.localOnly || open.continueOnError);
    EXPECT_EQ(open.operationTimeout, std::nullopt);
    EXPECT_EQ(open.maxObjectCount, 0U);
}

TEST_F(OperationTest, ReadsFlagsInAnyLetterCase)
{
    const auto operation = read(call("getINSTANCE",
        instanceParameter + valueOf("localonly", "FALSE") + valueOf("IncludeQualifiers", " TRUE ") +
            valueOf("IncludeClassOrigin", "true")));
    EXPECT_FALSE(operation.selection.localOnly);
    EXPECT_TRUE(operation.selection.includeQualifiers);
    EXPECT_TRUE(operation.selection.includeClassOrigin);
    EXPECT_EQ(refusalOf(call("GetInstance", instanceParameter + valueOf("LocalOnly", "1"))),
        "4 parameter LocalOnly: \"1\" is no value of type boolean");
}

TEST_F(OperationTest, AnEmptyPropertyListIsOtherThanNone)
{
    const auto listOf = [this](const std::string& list) {
        return read(call("GetInstance", instanceParameter + list)).selection.properties;
    };
    EXPECT_EQ(listOf("<IPARAMVALUE NAME='PropertyList'/>"), std::nullopt);
    EXPECT_THAT(listOf(parameter("PropertyList", "<VALUE.ARRAY/>")), Optional(IsEmpty()));
    EXPECT_THAT(listOf(parameter("PropertyList", "\n<VALUE.ARRAY> <VALUE>a</VALUE>"
                                                 "<VALUE>B</VALUE></VALUE.ARRAY>\n")),
        Optional(ElementsAre("a", "B")));
    EXPECT_EQ(refusalOf(call("GetInstance", instanceParameter + valueOf("PropertyList", "a"))),
        "4 parameter PropertyList must be a VALUE.ARRAY, not a VALUE");
}

TEST_F(OperationTest, ReadsAssociationFiltersAsDeclared)
{
    const auto operation =
        read(call("Associators", objectParameter + filterParameters + moreFilters));
    EXPECT_EQ(operation.associationClass, "Link");
    EXPECT_EQ(operation.resultClass, "Single");
    EXPECT_EQ(operation.role, "Owner");
    EXPECT_EQ(operation.resultRole, "Part");
    EXPECT_EQ(operation.className, "Thing");
    EXPECT_EQ(operation.path->toText(), "root/test:Thing.Name=\"a\",Index=7");
    EXPECT_EQ(
        read(call("AssociatorNames", objectParameter + classOf("AssocClass", ""))).associationClass,
        "");
}

TEST_F(OperationTest, TakesAClassAsTheSourceOfAssociations)
{
    const auto operation = read(call("References", classOf("ObjectName", "GAUGE")));
    EXPECT_EQ(operation.className, "Gauge");
    EXPECT_EQ(operation.path, nullptr);
}

TEST_F(OperationTest, ReadsWhatEnumerationsAreOpenedWith)
{
    const auto operation = read(call("OpenEnumerateInstances",
        gaugeParameter + valueOf("FilterQuery", "q") + valueOf("FilterQueryLanguage", "DMTF:FQL") +
            valueOf("OperationTimeout", "30") + valueOf("ContinueOnError", "true") +
            valueOf("MaxObjectCount", "1000")));
    EXPECT_EQ(operation.filterQuery, "q");
    EXPECT_EQ(operation.filterQueryLanguage, "DMTF:FQL");
    EXPECT_EQ(operation.operationTimeout, 30U);
    EXPECT_TRUE(operation.continueOnError);
    EXPECT_EQ(operation.maxObjectCount, 1000U);
    EXPECT_EQ(refusalOf(call("PullInstancePaths",
                  valueOf("EnumerationContext", "c") + valueOf("MaxObjectCount", "4294967296"))),
        "4 parameter MaxObjectCount: \"4294967296\" is no value of type uint32");
}

TEST_F(OperationTest, NamesTheParameterThatIsWrong)
{
    EXPECT_EQ(refusalOf(call("GetInstance")), "4 GetInstance needs parameter InstanceName");
    EXPECT_EQ(refusalOf(call("GetInstance", "<IPARAMVALUE NAME='InstanceName'/>")),
        "4 GetInstance needs parameter InstanceName");
    EXPECT_EQ(refusalOf(call("GetInstance", instanceParameter + instanceParameter)),
        "4 parameter InstanceName comes twice");
    EXPECT_EQ(refusalOf(call("EnumerateInstances", classOf("ClassName", ""))),
        "4 EnumerateInstances needs parameter ClassName");
    EXPECT_EQ(refusalOf(call("EnumerateInstances", valueOf("ClassName", "Thing"))),
        "4 parameter ClassName must be a CLASSNAME, not a VALUE");
    EXPECT_THAT(
        refusalOf(call("GetInstance", "<IPARAMVALUE/>")), StartsWith("request-not-loosely-valid "));
    EXPECT_THAT(refusalOf(call("GetInstance", parameter("InstanceName", thing() + thing()))),
        StartsWith("request-not-loosely-valid "));
}

TEST_F(OperationTest, RefusesUnknownOperationsAndNamespaces)
{
    EXPECT_EQ(refusalOf(call("CreateClass")), "7 operation \"CreateClass\" is not offered");
    std::string body = call("EnumerateQualifiers");
    body.replace(body.find("\"test\""), 6, "\"none\"");
    EXPECT_EQ(refusalOf(body), "3 there is no namespace \"root/none\"");
}

TEST_F(OperationTest, KeepsTheSpellingOfAnUnknownClass)
{
    EXPECT_EQ(read(call("GetClass", classOf("ClassName", "Nothing"))).className, "Nothing");
}

TEST_F(OperationTest, RefusesMethodsOfClassesWithoutReadingTheirArguments)
{
    const std::string where = "<LOCALNAMESPACEPATH><NAMESPACE NAME='root'/><NAMESPACE NAME='test'/>"
                              "</LOCALNAMESPACEPATH>";
    const auto method = [&](const std::string& path) {
        return withHead("<SIMPLEREQ><METHODCALL NAME='Reset'>" + path +
                        "<PARAMVALUE/></METHODCALL></SIMPLEREQ>");
    };
    const auto onClass = [&](const std::string& name) {
        return method("<LOCALCLASSPATH>" + where + name + "</LOCALCLASSPATH>");
    };
    EXPECT_EQ(refusalOf(method("<LOCALINSTANCEPATH>" + where + thing() + "</LOCALINSTANCEPATH>")),
        "16 class Thing offers no method Reset");
    EXPECT_EQ(
        refusalOf(onClass("<CLASSNAME NAME='thing'/>")), "16 class Thing offers no method Reset");
    EXPECT_EQ(refusalOf(onClass("<CLASSNAME NAME='Other'/>")), "5 there is no class \"Other\"");
    EXPECT_THAT(refusalOf(method("")), StartsWith("request-not-loosely-valid "));
    EXPECT_THAT(refusalOf(onClass("")), StartsWith("request-not-loosely-valid "));
}

} // namespace

} // namespace CimXmlTests
