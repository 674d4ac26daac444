// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/cimxml/PathElement.h"

#include "host/broker/String.h"
#include "host/cimxml/Literal.h"
#include "host/cimxml/Markup.h"

namespace Host::CimXml {

namespace {

void writeLocalNameSpace(std::string& out, std::string_view nameSpace)
{
    const Markup path(out, "LOCALNAMESPACEPATH");
    while (!nameSpace.empty()) {
        const std::string_view part = nameSpace.substr(0, nameSpace.find('/'));
        nameSpace.remove_prefix(part.size() == nameSpace.size() ? part.size() : part.size() + 1);
        if (!part.empty())
            Markup(out, "NAMESPACE").attribute("NAME", part);
    }
}

void writeNameSpace(std::string& out, std::string_view host, std::string_view nameSpace)
{
    const Markup path(out, "NAMESPACEPATH");
    Markup(out, "HOST").content(host);
    writeLocalNameSpace(out, nameSpace);
}

std::string_view valueTypeOf(const Value& value)
{
    if (value.type() == CMPI_boolean)
        return "boolean";
    const bool isNumber = value.type() != CMPI_char16 &&
                          (value.unsignedInteger() || value.signedInteger() || value.real());
    return isNumber ? "numeric" : "string";
}

// Appends the markup in few pieces, since each instance of an answer has several keys.
void writeKey(std::string& out, std::string_view name, const Value& value)
{
    out += std::string_view("<KEYBINDING NAME=\"");
    appendEscaped(out, name);
    out += std::string_view("\"><KEYVALUE VALUETYPE=\"");
    out += valueTypeOf(value);
    out += std::string_view("\">");
    appendLiteral(out, value);
    out += std::string_view("</KEYVALUE></KEYBINDING>");
}

} // namespace

void writeInstanceName(std::string& out, const ObjectPath& path)
{
    Markup name(out, "INSTANCENAME");
    name.attribute("CLASSNAME", path.className());
    for (const auto& [key, value] : path.keys()) {
        if (const ObjectPath* const reference = value.path()) {
            Markup binding(out, "KEYBINDING");
            binding.attribute("NAME", *key->text());
            writeReference(out, *reference);
        } else if (!value.isNull()) {
            writeKey(out, *key->text(), value);
        }
    }
}

void writeInstancePath(std::string& out, const ObjectPath& path, const Location& location)
{
    const Markup element(out, "INSTANCEPATH");
    writeNameSpace(out, path.host().empty() ? std::string_view(location.host) : path.host(),
        path.nameSpace().empty() ? std::string_view(location.nameSpace) : path.nameSpace());
    writeInstanceName(out, path);
}

void writeObjectPath(std::string& out, const ObjectPath& path, const Location& location)
{
    const Markup element(out, "OBJECTPATH");
    writeInstancePath(out, path, location);
}

void writeClassPath(std::string& out, std::string_view className, const Location& location)
{
    const Markup element(out, "CLASSPATH");
    writeNameSpace(out, location.host, location.nameSpace);
    Markup(out, "CLASSNAME").attribute("NAME", className);
}

void writeReference(std::string& out, const ObjectPath& path)
{
    const Markup element(out, "VALUE.REFERENCE");
    if (path.nameSpace().empty()) {
        writeInstanceName(out, path);
    } else if (path.host().empty()) {
        const Markup local(out, "LOCALINSTANCEPATH");
        writeLocalNameSpace(out, path.nameSpace());
        writeInstanceName(out, path);
    } else {
        writeInstancePath(out, path, {});
    }
}

} // namespace Host::CimXml
