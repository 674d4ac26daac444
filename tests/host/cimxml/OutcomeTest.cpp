// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Texts that are no request, and their outcomes.

#include "tests/host/cimxml/CimXmlTest.h"

namespace CimXmlTests {

namespace {

using testing::HasSubstr;

std::string replaced(std::string text, const std::string& from, const std::string& to)
{
    const auto at = text.find(from);
    if (at == std::string::npos)
        throw std::invalid_argument("nothing to replace: " + from);
    return text.replace(at, from.size(), to);
}

const std::string goodCall = call("EnumerateQualifiers");

TEST(OutcomeTest, ReadsWhatTheMessageSays)
{
    const Message message(goodCall);
    EXPECT_EQ(message.id(), "4711");
    EXPECT_EQ(message.protocolVersion(), "1.0");
    EXPECT_EQ(message.methodName(), "EnumerateQualifiers");
    EXPECT_EQ(message.nameSpace(), "root/test");
    EXPECT_TRUE(message.isIntrinsic());
}

TEST(OutcomeTest, PassesOverWhatTheProtocolDoesNotKnow)
{
    EXPECT_EQ(outcomeOf(replaced(goodCall, "<SIMPLEREQ>", "<X-EXTRA>t</X-EXTRA><SIMPLEREQ Y='1'>")),
        "read");
    EXPECT_EQ(outcomeOf("\xEF\xBB\xBF" + goodCall), "read");
    EXPECT_EQ(
        outcomeOf(replaced(goodCall, "<SIMPLEREQ>", "<!-- c --><?pi x?> <SIMPLEREQ>")), "read");
}

TEST(OutcomeTest, RefusesWhatIsNotWellFormed)
{
    for (const std::string body : {"", "   ", "text", "<CIM", "<CIM>", "<CIM></MIC>",
             "<CIM/><CIM/>", "<CIM/>text", "</CIM>", "<CIM a=1/>", "<CIM a='1' a='2'/>",
             "<CIM a='<'/>", "<CIM a='1'b='2'/>", "<1/>", "<CIM>&nbsp;</CIM>", "<CIM>&</CIM>",
             "<CIM>&#0;</CIM>", "<CIM>&#xD800;</CIM>", "<CIM>&#x110000;</CIM>", "<CIM>&#;</CIM>",
             "<CIM>\x01</CIM>", "<CIM>\xFF</CIM>", "<CIM>\xED\xA0\x80</CIM>", "<CIM>]]></CIM>",
             "<CIM><!-- -- --></CIM>", "<CIM><!-- x", "<CIM><![CDATA[x</CIM>", "<![CDATA[x]]>",
             "<CIM/ >", "<CIM><?xml version='1.0'?></CIM>", "<?xml version='1.1'?><CIM/>",
             "<?xml version='1.0' encoding='utf-16'?><CIM/>", "<?xml encoding='utf-8'?><CIM/>",
             "<?xml ?><CIM/>", "<?xml version='1.0' encoding='iso-8859-1'?><CIM>\xE9</CIM>"})
        EXPECT_EQ(outcomeOf(body), "request-not-well-formed") << body;
    EXPECT_EQ(outcomeOf(std::string("<CIM>\0</CIM>", 12)), "request-not-well-formed");
}

TEST(OutcomeTest, RefusesUtf16WhicheverEndComesFirst)
{
    std::string big;
    std::string little;
    for (const char c : goodCall) {
        big.append({'\0', c});
        little.append({c, '\0'});
    }
    for (const std::string& body : {big, little, "\xFE\xFF" + big, "\xFF\xFE" + little})
        EXPECT_EQ(errorOf(body), "line 1, byte 0: only the encoding UTF-8 is read");
}

TEST(OutcomeTest, RefusesDocumentTypesAndEntities)
{
    EXPECT_EQ(outcomeOf("<!DOCTYPE CIM><CIM/>"), "request-not-valid");
    EXPECT_EQ(outcomeOf("<!DOCTYPE CIM SYSTEM 'file:///etc/passwd'><CIM/>"), "request-not-valid");
    EXPECT_EQ(outcomeOf("<!DOCTYPE b [<!ENTITY a 'aaaa'><!ENTITY b '&a;&a;&a;'>]><CIM>&b;</CIM>"),
        "request-not-valid");
    EXPECT_EQ(outcomeOf("<CIM><!ENTITY a 'b'></CIM>"), "request-not-well-formed");
}

TEST(OutcomeTest, RefusesVersionsOfAnotherKind)
{
    EXPECT_EQ(outcomeOf(replaced(goodCall, "CIMVERSION=\"2.0", "CIMVERSION=\"3.0")),
        "unsupported-cim-version");
    EXPECT_EQ(outcomeOf(replaced(goodCall, "DTDVERSION=\"2.0", "DTDVERSION=\"20")),
        "unsupported-dtd-version");
    EXPECT_EQ(outcomeOf(replaced(goodCall, "PROTOCOLVERSION=\"1.0", "PROTOCOLVERSION=\"2.0")),
        "unsupported-protocol-version");
    EXPECT_EQ(outcomeOf(replaced(replaced(goodCall, "DTDVERSION=\"2.0", "DTDVERSION=\"2.4"),
                  "PROTOCOLVERSION=\"1.0", "PROTOCOLVERSION=\"1.4")),
        "read");
}

TEST(OutcomeTest, RefusesWhatLacksSomething)
{
    for (const std::string part : {" CIMVERSION=\"2.0\"", " DTDVERSION=\"2.0\"", " ID=\"4711\"",
             " PROTOCOLVERSION=\"1.0\"", " NAME=\"EnumerateQualifiers\"", " NAME=\"root\""})
        EXPECT_EQ(outcomeOf(replaced(goodCall, part, "")), "request-not-loosely-valid") << part;
    EXPECT_EQ(outcomeOf("<XML/>"), "request-not-loosely-valid");
    EXPECT_EQ(outcomeOf(withHead("")), "request-not-loosely-valid");
    EXPECT_EQ(outcomeOf(withHead("<SIMPLEREQ/>")), "request-not-loosely-valid");
    EXPECT_EQ(outcomeOf(withHead("text<SIMPLEREQ/>")), "request-not-loosely-valid");
    EXPECT_EQ(outcomeOf(withHead("<SIMPLEREQ><IMETHODCALL NAME='A'/></SIMPLEREQ>")),
        "request-not-loosely-valid");
    EXPECT_EQ(outcomeOf(withHead("<SIMPLEREQ><VALUE/></SIMPLEREQ>")), "request-not-loosely-valid");
}

TEST(OutcomeTest, RefusesSeveralRequestsAndWhatIsNone)
{
    EXPECT_EQ(outcomeOf(withHead("<MULTIREQ><SIMPLEREQ/><SIMPLEREQ/></MULTIREQ>")),
        "multiple-requests-unsupported");
    EXPECT_EQ(outcomeOf(withHead("<SIMPLEEXPREQ/>")), "unsupported-operation");
    EXPECT_EQ(outcomeOf(withHead("<SIMPLERSP/>")), "request-not-valid");
    EXPECT_EQ(outcomeOf("<CIM CIMVERSION='2.0' DTDVERSION='2.0'><DECLARATION/></CIM>"),
        "request-not-valid");
    const auto begin = goodCall.find("<IMETHODCALL");
    const std::string again = goodCall.substr(begin, goodCall.find("</SIMPLEREQ>") - begin);
    EXPECT_EQ(outcomeOf(replaced(goodCall, "</SIMPLEREQ>", again + "</SIMPLEREQ>")),
        "request-not-loosely-valid");
}

TEST(OutcomeTest, SaysWhatIsWrongAndWhere)
{
    EXPECT_EQ(errorOf("<CIM>\n<A>\n</B></CIM>"), "line 3, byte 12: mismatched tag");
    EXPECT_EQ(errorOf("<CIM\nCIMVERSION='2.0'/>"),
        "line 1, byte 1: CIM: there is no attribute DTDVERSION");
    EXPECT_THAT(errorOf(replaced(goodCall, "<SIMPLEREQ>", "<MULTIREQ/><SIMPLEREQ>")),
        HasSubstr("line 2, byte"));
}

TEST(OutcomeTest, BoundsDepthElementsAndAttributes)
{
    std::string deep;
    for (int level = 0; level < 100'000; ++level)
        deep += "<A>";
    EXPECT_EQ(outcomeOf(deep), "request-not-valid");

    std::string many = "<A>";
    for (int count = 0; count < 100'000; ++count)
        many += "<B/>";
    EXPECT_EQ(outcomeOf(many + "</A>"), "request-not-valid");

    std::string attributes = "<A";
    for (int count = 0; count < 17; ++count)
        attributes += " a" + std::to_string(count) + "=''";
    EXPECT_EQ(outcomeOf(attributes + "/>"), "request-not-valid");

    const std::string huge(8'000'000, 'x');
    EXPECT_EQ(outcomeOf(replaced(goodCall, "ID=\"", "ID=\"" + huge)), "read");
    EXPECT_EQ(outcomeOf("<A b='" + huge), "request-not-well-formed");
    EXPECT_LT(errorOf("<A><" + huge + "></A></A>").size(), 500U);
}

} // namespace

} // namespace CimXmlTests
