// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The heads that are accepted and refused, without sockets.

#include "host/http/HeaderCheck.h"
#include "host/cimxml/Message.h"
#include "tests/host/http/HttpTest.h"

namespace HttpTests {

namespace {

using Host::Http::CallHead;
using Host::Http::HeaderField;
using Host::Http::HttpError;
using Host::Http::Limits;
using Host::Http::RequestHead;

using Fields = std::vector<HeaderField>;

const Fields usual = {{"Host", "localhost"}, {"Content-Type", "application/xml; charset=\"utf-8\""},
    {"Content-Length", "10"}, {"CIMOperation", "MethodCall"}, {"CIMMethod", "GetClass"},
    {"CIMObject", "root/cimv2"}};

Fields with(HeaderField field, Fields fields = usual)
{
    for (HeaderField& each : fields)
        if (each.name == field.name) {
            each = field;
            return fields;
        }
    fields.push_back(std::move(field));
    return fields;
}

Fields without(const std::string& name, Fields fields = usual)
{
    std::erase_if(fields, [&](const HeaderField& each) { return each.name == name; });
    return fields;
}

CallHead check(const RequestHead& head)
{
    const Limits limits;
    return checkHead(head, bodySizeOf(head), limits);
}

// Returns "ok", or the status with the CIMError.
std::string verdict(const Fields& fields, const std::string& method = "POST",
    const std::string& target = "/cimom", const std::string& version = "HTTP/1.1")
{
    try {
        check({method, target, version, fields});
        return "ok";
    } catch (const HttpError& error) {
        return std::to_string(error.status()) + (error.cimError().empty() ? "" : " ") +
               error.cimError();
    }
}

std::string mismatch(const Fields& fields, const std::string& operation = "GetClass")
{
    try {
        requireMatch(check({"POST", "/cimom", "HTTP/1.1", fields}), Message(cimCall(operation)));
        return "ok";
    } catch (const HttpError& error) {
        return error.cimError();
    }
}

TEST(HeaderCheckTest, TakesWhatIsInOrder)
{
    EXPECT_EQ(verdict(usual), "ok");
    EXPECT_EQ(verdict(usual, "POST", "/"), "ok");
    EXPECT_EQ(verdict(with({"CIMProtocolVersion", "1.0"})), "ok");
    EXPECT_EQ(verdict(with({"CIMProtocolVersion", "1.4"})), "ok");
    EXPECT_EQ(verdict(with({"Transfer-Encoding", "Chunked"}, without("Content-Length"))), "ok");
    EXPECT_EQ(verdict(with({"Content-Encoding", "identity"})), "ok");
    EXPECT_EQ(verdict(with({"CIMOperation", "methodcall"})), "ok");
    EXPECT_EQ(verdict({{"host", ""}, {"content-type", "text/xml"}, {"CONTENT-LENGTH", "0"},
                  {"cimoperation", " MethodCall\t"}}),
        "ok");
}

TEST(HeaderCheckTest, KnowsTwoPathsAndTwoMethods)
{
    for (const std::string target :
        {"/cimom?", "/cimom?x=/", "/?", "/%63imom", "http://host/cimom", "https://host:5989/cimom",
            "HTTP://[::1]/", "http://host", "http://host?x", "http://u@host/cimom?a://b"})
        EXPECT_EQ(verdict(usual, "POST", target), "ok") << target;
    for (const std::string target :
        {"/cimom/", "/etc/passwd", "*", "", "cimom", "?", "/cimom%00", "/cimom%00x", "/cimom%",
            "/cimom%6", "/%zz", "http:///cimom", "http://", "ftp://host/cimom", "host/cimom",
            "/x://host/cimom", "http://host/cimom/", "http://host/http://host/cimom"})
        EXPECT_EQ(verdict(usual, "POST", target), "404") << target;
    EXPECT_EQ(verdict(usual, "OPTIONS", "*"), "405");
    for (const std::string method : {"GET", "HEAD", "PUT", "DELETE", "OPTIONS", "post", "M-GET"})
        EXPECT_EQ(verdict(usual, method), "405") << method;
}

TEST(HeaderCheckTest, TakesNothingButXmlInUtf8)
{
    for (const std::string type : {"text/xml", "TEXT/XML", "application/xml;charset=UTF-8",
             "application/xml ; q=1 ; charset = utf-8",
             R"(text/xml; q="\";charset=x"; charset=utf-8)", "text/xml;",
             "text/xml; charset=\"utf-8\"", "text/xml; version=2.0"})
        EXPECT_EQ(verdict(with({"Content-Type", type})), "ok") << type;
    for (const std::string type : {"", "text/plain", "text/xml charset=utf-8", "application/json",
             "text/xml; charset=iso-8859-1", "text/xml; charset=", "text/xml; charset=\"utf-8",
             "text/xml; charset=utf-8; charset=utf-16", "multipart/form-data"})
        EXPECT_EQ(verdict(with({"Content-Type", type})), "415") << type;
    EXPECT_EQ(verdict(without("Content-Type")), "415");
    EXPECT_EQ(verdict(with({"Content-Encoding", "gzip"})), "415");
}

TEST(HeaderCheckTest, MustKnowWhereTheBodyEnds)
{
    EXPECT_EQ(verdict(without("Content-Length")), "411");
    for (const std::string length : {"", "-1", "+1", "1 2", "0x10", "ten", "1.0", "1,1"})
        EXPECT_EQ(verdict(with({"Content-Length", length})), "400") << length;
    EXPECT_EQ(verdict(with({"Content-Length", "1048576"})), "ok");
    EXPECT_EQ(verdict(with({"Content-Length", "1048577"})), "413");
    EXPECT_EQ(verdict(with({"Content-Length", "18446744073709551615"})), "413");
    EXPECT_EQ(verdict(with({"Content-Length", "18446744073709551616"})), "413");
    EXPECT_EQ(verdict(with({"Transfer-Encoding", "gzip"}, without("Content-Length"))), "501");
    EXPECT_EQ(verdict(with({"Transfer-Encoding", "chunked"})), "400");
    EXPECT_EQ(verdict(with({"Expect", "100-Continue"})), "ok");
    EXPECT_EQ(verdict(with({"Expect", "200-ok"})), "417");
}

TEST(HeaderCheckTest, RepeatedFieldsThatCountAreRefused)
{
    for (HeaderField field : usual) {
        Fields twice = usual;
        twice.push_back(field);
        EXPECT_EQ(verdict(twice), "400") << field.name;
    }
    Fields fields = with({"X-Other", "1"});
    fields.push_back({"X-Other", "2"});
    EXPECT_EQ(verdict(fields), "ok");
}

TEST(HeaderCheckTest, NamesMustBeNames)
{
    for (const std::string name :
        {"Content-Length ", "Content-Length\t", "X Y", "", " X", "X\x01", "X(", "X\xC3\xA4"}) {
        Fields fields = usual;
        fields.push_back({name, "10"});
        EXPECT_EQ(verdict(fields), "400") << name;
    }
    EXPECT_EQ(verdict(with({"x-9!#$%&'*+.^_`|~", "10"})), "ok");
}

TEST(HeaderCheckTest, ValuesHoldNoControlCharacters)
{
    for (const std::string value : {"1\r", "a\rb", "\x01", "a\x7F", "a\nb"})
        EXPECT_EQ(verdict(with({"X-Other", value})), "400");
    EXPECT_EQ(verdict(with({"X-Other", std::string("a\0b", 3)})), "400");
    for (const std::string value : {"a\tb", "", "\xC3\xA4", "\xFF"})
        EXPECT_EQ(verdict(with({"X-Other", value})), "ok");
}

TEST(HeaderCheckTest, MustNameTheHostSinceHttpOneOne)
{
    EXPECT_EQ(verdict(without("Host")), "400");
    EXPECT_EQ(verdict(without("Host"), "POST", "/cimom", "HTTP/1.0"), "ok");
    EXPECT_EQ(verdict(with({"Host", ""})), "ok");
}

TEST(HeaderCheckTest, MustBeACallOfAKnownProtocolVersion)
{
    EXPECT_EQ(verdict(without("CIMOperation")), "400 unsupported-operation");
    EXPECT_EQ(verdict(with({"CIMOperation", "MethodResponse"})), "400 unsupported-operation");
    for (const std::string version : {"2.0", "0.9", "1", "", "one"})
        EXPECT_EQ(
            verdict(with({"CIMProtocolVersion", version})), "501 unsupported-protocol-version")
            << version;
}

TEST(HeaderCheckTest, MandatoryPostDeclaresItsExtension)
{
    const Fields fields = {{"Host", "localhost"}, {"Content-Type", "text/xml"},
        {"Content-Length", "10"}, {"42-CIMOperation", "MethodCall"}, {"42-CIMMethod", "GetClass"}};
    const auto declared = [&](const std::string& value) {
        return verdict(with({"Man", value}, fields), "M-POST");
    };
    EXPECT_EQ(declared("http://www.dmtf.org/cim/mapping/http/v1.0;ns=42"), "ok");
    EXPECT_EQ(declared("\"http://www.dmtf.org/cim/mapping/http/v1.0\" ; ns = 42"), "ok");
    EXPECT_EQ(
        declared("http://www.dmtf.org/cim/mapping/http/v1.0;ns=43"), "400 unsupported-operation");
    for (const std::string end : {"", ";", ";ns", ";ns=", ";ns=4", ";ns=421", ";ns=x2", ";xs=42"})
        EXPECT_EQ(declared("http://www.dmtf.org/cim/mapping/http/v1.0" + end), "400") << end;
    EXPECT_EQ(declared("http://www.dmtf.org/cim/mapping/http/v2.0;ns=42"), "510");
    EXPECT_EQ(declared(""), "510");
    EXPECT_EQ(verdict(fields, "M-POST"), "400");
    EXPECT_EQ(verdict(usual, "M-POST"), "400");
}

TEST(HeaderCheckTest, MethodAndNamespaceMustBeThoseOfTheBody)
{
    EXPECT_EQ(mismatch(usual), "ok");
    EXPECT_EQ(mismatch(without("CIMMethod")), "header-mismatch");
    EXPECT_EQ(mismatch(without("CIMObject")), "header-mismatch");
    for (const std::string method : {"GetClass", "getclass", "Get%43lass"})
        EXPECT_EQ(mismatch(with({"CIMMethod", method})), "ok") << method;
    for (const std::string method : {"GetInstance", "", "GetClass%20"})
        EXPECT_EQ(mismatch(with({"CIMMethod", method})), "header-mismatch") << method;
    for (const std::string object :
        {"root/cimv2", "root%2Fcimv2", "root%2fcimv2", "ROOT/CIMV2", "/root/cimv2", "root/cimv2/",
            "//host/root/cimv2", "root/cimv2:CIM_Thing.Name=\"a\"", "//host:5988/root/cimv2"})
        EXPECT_EQ(mismatch(with({"CIMObject", object})), "ok") << object;
    for (const std::string object :
        {"root", "", "//host", "root/cimv2/x", "root%2", "root%", "root%zzcimv2", "%00", "%ff"})
        EXPECT_EQ(mismatch(with({"CIMObject", object})), "header-mismatch") << object;
}

} // namespace

} // namespace HttpTests
