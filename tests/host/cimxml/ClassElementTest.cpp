// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The XML of classes and qualifiers.

#include "host/cimxml/ClassElement.h"
#include "host/cimxml/QualifierElement.h"
#include "tests/host/cimxml/CimXmlTest.h"

namespace CimXmlTests {

namespace {

using Host::CimXml::ObjectSelection;

class ClassElementTest : public CimXmlTest {
protected:
    std::string written(const std::string& name, const ObjectSelection& selection) const
    {
        std::string out;
        writeClass(out, Testing::classNamed(*repository, name), selection);
        return out;
    }
    std::string qualifier(const std::string& name) const
    {
        std::string out;
        Host::CimXml::writeQualifierDeclaration(
            out, *repository->findQualifier(Testing::testNameSpace, name));
        return out;
    }
};

TEST_F(ClassElementTest, WritesWhatAClassDeclares)
{
    EXPECT_EQ(written("Thing", {}),
        R"(<CLASS NAME="Thing"><PROPERTY NAME="Name" TYPE="string"></PROPERTY>)"
        R"(<PROPERTY NAME="Index" TYPE="uint16"></PROPERTY>)"
        R"(<PROPERTY NAME="Label" TYPE="string"><VALUE>none</VALUE></PROPERTY>)"
        R"(<PROPERTY NAME="IsOn" TYPE="boolean"></PROPERTY>)"
        R"(<PROPERTY.ARRAY NAME="Levels" TYPE="sint32"></PROPERTY.ARRAY>)"
        R"(<PROPERTY NAME="Since" TYPE="datetime"></PROPERTY>)"
        R"(<PROPERTY NAME="Reading" TYPE="real64"></PROPERTY></CLASS>)");
}

TEST_F(ClassElementTest, ShowsOriginAndInheritance)
{
    ObjectSelection selection;
    selection.includeClassOrigin = true;
    selection.properties = {"name", "label", "percent"};
    EXPECT_EQ(written("Gauge", selection),
        R"(<CLASS NAME="Gauge" SUPERCLASS="Thing">)"
        R"(<PROPERTY NAME="Name" TYPE="string" CLASSORIGIN="Thing" PROPAGATED="true"></PROPERTY>)"
        R"(<PROPERTY NAME="Label" TYPE="string" CLASSORIGIN="Thing"><VALUE>gauge</VALUE>)"
        R"(</PROPERTY><PROPERTY NAME="Percent" TYPE="uint8" CLASSORIGIN="Gauge"></PROPERTY></CLASS>)");
}

TEST_F(ClassElementTest, WritesQualifiersOnRequest)
{
    ObjectSelection selection;
    selection.includeQualifiers = true;
    EXPECT_EQ(written("Link", selection),
        R"(<CLASS NAME="Link"><QUALIFIER NAME="Association" TYPE="boolean" OVERRIDABLE="false">)"
        R"(<VALUE>TRUE</VALUE></QUALIFIER>)"
        R"(<PROPERTY.REFERENCE NAME="Owner" REFERENCECLASS="Thing">)"
        R"(<QUALIFIER NAME="Key" TYPE="boolean" OVERRIDABLE="false"><VALUE>TRUE</VALUE>)"
        R"(</QUALIFIER></PROPERTY.REFERENCE>)"
        R"(<PROPERTY.REFERENCE NAME="Part" REFERENCECLASS="Single">)"
        R"(<QUALIFIER NAME="Key" TYPE="boolean" OVERRIDABLE="false"><VALUE>TRUE</VALUE>)"
        R"(</QUALIFIER></PROPERTY.REFERENCE></CLASS>)");
    selection.properties.emplace();
    EXPECT_THAT(written("Gauge", selection),
        testing::StartsWith(R"(<CLASS NAME="Gauge" SUPERCLASS="Thing"><QUALIFIER )"
                            R"(NAME="Description" TYPE="string" PROPAGATED="true" )"
                            R"(TRANSLATABLE="true"><VALUE>A &lt;thing&gt;</VALUE></QUALIFIER>)"));
}

TEST_F(ClassElementTest, WritesQualifierDeclarations)
{
    EXPECT_EQ(qualifier("Key"),
        R"(<QUALIFIER.DECLARATION NAME="Key" TYPE="boolean" ISARRAY="false" OVERRIDABLE="false">)"
        R"(<SCOPE REFERENCE="true" PROPERTY="true"></SCOPE><VALUE>FALSE</VALUE>)"
        R"(</QUALIFIER.DECLARATION>)");
    EXPECT_EQ(qualifier("Values"),
        R"(<QUALIFIER.DECLARATION NAME="Values" TYPE="string" ISARRAY="true">)"
        R"(<SCOPE PROPERTY="true" METHOD="true" PARAMETER="true"></SCOPE>)"
        R"(</QUALIFIER.DECLARATION>)");
}

} // namespace

} // namespace CimXmlTests
