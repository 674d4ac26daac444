// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/cimxml/ObjectSelection.h"

#include "tests/host/cimxml/CimXmlTest.h"

namespace CimXmlTests {

namespace {

using Host::CimXml::isSelected;
using Host::CimXml::ObjectSelection;

class SelectionTest : public CimXmlTest {
protected:
    const Host::ClassDeclaration& gauge = Testing::classNamed(*repository, "Gauge");
};

TEST_F(SelectionTest, WithoutListAllPropertiesAreSelected)
{
    EXPECT_TRUE(isSelected({}, &gauge, "Name"));
    EXPECT_TRUE(isSelected({}, nullptr, "Anything"));
}

TEST_F(SelectionTest, ListsAreReadInAnyLetterCase)
{
    ObjectSelection selection;
    selection.properties = {"PERCENT", "name"};
    EXPECT_TRUE(isSelected(selection, &gauge, "Percent"));
    EXPECT_TRUE(isSelected(selection, nullptr, "Name"));
    EXPECT_FALSE(isSelected(selection, &gauge, "Label"));
    selection.properties->clear();
    EXPECT_FALSE(isSelected(selection, &gauge, "Percent"));
}

TEST_F(SelectionTest, LocalIsWhatTheClassDeclares)
{
    ObjectSelection selection;
    selection.localOnly = true;
    EXPECT_TRUE(isSelected(selection, &gauge, "percent"));
    EXPECT_TRUE(isSelected(selection, &gauge, "Label")); // overridden
    EXPECT_FALSE(isSelected(selection, &gauge, "Name"));
    EXPECT_TRUE(isSelected(selection, &gauge, "Unknown"));
    EXPECT_TRUE(isSelected(selection, nullptr, "Name"));
}

TEST_F(SelectionTest, QualifiersAreSelectedOnRequest)
{
    const auto& inherited = *findQualifier(gauge.qualifiers, "Description");
    ASSERT_TRUE(inherited.isPropagated);
    ObjectSelection selection;
    EXPECT_FALSE(isSelected(selection, inherited));
    selection.includeQualifiers = true;
    EXPECT_TRUE(isSelected(selection, inherited));
    selection.localOnly = true;
    EXPECT_FALSE(isSelected(selection, inherited));
}

} // namespace

} // namespace CimXmlTests
