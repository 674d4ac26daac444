// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/cimxml/ResponseWriter.h"

#include "host/cimxml/ClassElement.h"
#include "host/cimxml/InstanceElement.h"
#include "host/cimxml/Markup.h"
#include "host/cimxml/Message.h"
#include "host/cimxml/QualifierElement.h"

namespace Host::CimXml {

namespace {

std::string_view responseName(bool isIntrinsic)
{
    return isIntrinsic ? "IMETHODRESPONSE" : "METHODRESPONSE";
}

std::string head(const Message& message)
{
    std::string out = "<?xml version=\"1.0\" encoding=\"utf-8\"?>\n"
                      "<CIM CIMVERSION=\"2.0\" DTDVERSION=\"2.0\"><MESSAGE ID=\"";
    appendEscaped(out, message.id());
    out += "\" PROTOCOLVERSION=\"";
    appendEscaped(out, message.protocolVersion());
    out.append("\"><SIMPLERSP><").append(responseName(message.isIntrinsic())).append(" NAME=\"");
    appendEscaped(out, message.methodName());
    return out += "\">";
}

std::string tail(bool isIntrinsic)
{
    return "</" + std::string(responseName(isIntrinsic)) + "></SIMPLERSP></MESSAGE></CIM>\n";
}

bool isBetweenObjects(OperationKind kind)
{
    return kind == OperationKind::associators || kind == OperationKind::associatorNames ||
           kind == OperationKind::references || kind == OperationKind::referenceNames;
}

// Returns the element around an instance; an empty name where there is none.
std::string_view wrapperOf(OperationKind kind)
{
    switch (kind) {
    case OperationKind::getInstance:
        return {};
    case OperationKind::enumerateInstances:
        return "VALUE.NAMEDINSTANCE";
    case OperationKind::associators:
    case OperationKind::references:
        return "VALUE.OBJECTWITHPATH";
    default:
        return "VALUE.INSTANCEWITHPATH";
    }
}

} // namespace

std::string errorResponse(const Message& message, CMPIrc code, std::string_view description)
{
    std::string out = head(message);
    Markup(out, "ERROR")
        .attribute("CODE", std::to_string(code))
        .attribute("DESCRIPTION", description);
    return out += tail(message.isIntrinsic());
}

ResponseWriter::ResponseWriter(const Message& message, OperationKind kind,
    const Repository& classes, Location location, ObjectSelection selection)
    : head_(head(message)), kind_(kind), classes_(classes), location_(std::move(location)),
      selection_(std::move(selection)), instances_(selection_)
{
    if (kind_ != OperationKind::closeEnumeration) // which returns nothing
        head_ += "<IRETURNVALUE>";
}

void ResponseWriter::begin(std::string& out) const
{
    out += head_;
}

void ResponseWriter::instance(std::string& out, const Instance& instance)
{
    const std::string_view nameSpace =
        instance.nameSpace().empty() ? std::string_view(location_.nameSpace) : instance.nameSpace();
    const ClassDeclaration* const declared = classes_.findClass(nameSpace, instance.className());
    const std::string_view wrapper = wrapperOf(kind_);
    if (wrapper.empty()) {
        instances_.write(out, instance, declared);
        return;
    }
    const ObjectPath& path = instance.objectPath();
    const Markup element(out, wrapper);
    if (kind_ == OperationKind::enumerateInstances)
        writeInstanceName(out, path);
    else
        writeInstancePath(out, path, location_);
    instances_.write(out, instance, declared);
}

void ResponseWriter::path(std::string& out, const ObjectPath& path) const
{
    if (kind_ == OperationKind::enumerateInstanceNames)
        writeInstanceName(out, path);
    else if (isBetweenObjects(kind_))
        writeObjectPath(out, path, location_);
    else
        writeInstancePath(out, path, location_);
}

void ResponseWriter::classDeclaration(std::string& out, const ClassDeclaration& declared) const
{
    if (!isBetweenObjects(kind_)) {
        writeClass(out, declared, selection_);
        return;
    }
    const Markup element(out, "VALUE.OBJECTWITHPATH");
    writeClassPath(out, declared.name, location_);
    writeClass(out, declared, selection_);
}

void ResponseWriter::className(std::string& out, std::string_view name) const
{
    if (!isBetweenObjects(kind_)) {
        Markup(out, "CLASSNAME").attribute("NAME", name);
        return;
    }
    const Markup element(out, "OBJECTPATH");
    writeClassPath(out, name, location_);
}

void ResponseWriter::qualifierDeclaration(
    std::string& out, const QualifierDeclaration& declared) const
{
    writeQualifierDeclaration(out, declared);
}

void ResponseWriter::value(std::string& out, const Value& value) const
{
    writeValue(out, value);
}

void ResponseWriter::finish(std::string& out) const
{
    if (kind_ != OperationKind::closeEnumeration)
        out += "</IRETURNVALUE>";
    out += tail(true);
}

void ResponseWriter::finish(
    std::string& out, const std::optional<std::string>& enumerationContext) const
{
    out += "</IRETURNVALUE>";
    const auto parameter = [&out](const char* name, const char* type, std::string_view text) {
        Markup element(out, "PARAMVALUE");
        element.attribute("NAME", name).attribute("PARAMTYPE", type);
        Markup(out, "VALUE").content(text);
    };
    parameter("EndOfSequence", "boolean", enumerationContext ? "FALSE" : "TRUE");
    parameter("EnumerationContext", "string", enumerationContext.value_or(""));
    out += tail(true);
}

} // namespace Host::CimXml
