// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/cimxml/AnswerWriter.h"

#include "host/broker/Arena.h"
#include "host/cimxml/ClassWriter.h"
#include "host/cimxml/Markup.h"
#include "host/cimxml/Message.h"
#include "host/cimxml/QualifierWriter.h"

namespace Host::CimXml {

namespace {

// Where an instance makes its path, so that nothing is left of it in the request.
class ScratchArena {
public:
    ScratchArena() : before_(Arena::makeCurrent(&arena_)) {}
    ~ScratchArena() { Arena::makeCurrent(before_); }
    ScratchArena(const ScratchArena&) = delete;
    ScratchArena& operator=(const ScratchArena&) = delete;

private:
    Arena arena_;
    Arena* before_;
};

std::string_view responseName(bool isIntrinsic)
{
    return isIntrinsic ? "IMETHODRESPONSE" : "METHODRESPONSE";
}

std::string head(std::string_view id, std::string_view protocolVersion, bool isIntrinsic,
    std::string_view methodName)
{
    std::string out = "<?xml version=\"1.0\" encoding=\"utf-8\"?>\n"
                      "<CIM CIMVERSION=\"2.0\" DTDVERSION=\"2.0\"><MESSAGE ID=\"";
    appendEscaped(out, id);
    out += "\" PROTOCOLVERSION=\"";
    appendEscaped(out, protocolVersion);
    out.append("\"><SIMPLERSP><").append(responseName(isIntrinsic)).append(" NAME=\"");
    appendEscaped(out, methodName);
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

// Around an instance; empty where it stands alone.
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

std::string errorAnswer(const Message& message, CMPIrc code, std::string_view description)
{
    std::string out =
        head(message.id(), message.protocolVersion(), message.isIntrinsic(), message.methodName());
    Markup(out, "ERROR")
        .attribute("CODE", std::to_string(code))
        .attribute("DESCRIPTION", description);
    return out += tail(message.isIntrinsic());
}

AnswerWriter::AnswerWriter(const Message& message, OperationKind kind, const Repository& classes,
    Location location, PropertySelection selection, Sink sink)
    : id_(message.id()), protocolVersion_(message.protocolVersion()),
      methodName_(message.methodName()), kind_(kind), classes_(classes),
      location_(std::move(location)), selection_(std::move(selection)), instances_(selection_),
      sink_(std::move(sink))
{
}

void AnswerWriter::instance(const Instance& instance)
{
    begin();
    const ScratchArena scratch;
    const ObjectPath& path = instance.objectPath();
    const std::string_view nameSpace =
        path.nameSpace().empty() ? std::string_view(location_.nameSpace) : path.nameSpace();
    const ClassDeclaration* const declared = classes_.findClass(nameSpace, instance.className());
    const std::string_view wrapper = wrapperOf(kind_);
    if (wrapper.empty()) {
        instances_.write(piece_, instance, declared);
    } else {
        const Markup element(piece_, wrapper);
        if (kind_ == OperationKind::enumerateInstances)
            writeInstanceName(piece_, path);
        else
            writeInstancePath(piece_, path, location_);
        instances_.write(piece_, instance, declared);
    }
    send();
}

void AnswerWriter::path(const ObjectPath& path)
{
    begin();
    if (kind_ == OperationKind::enumerateInstanceNames)
        writeInstanceName(piece_, path);
    else if (isBetweenObjects(kind_))
        writeObjectPath(piece_, path, location_);
    else
        writeInstancePath(piece_, path, location_);
    send();
}

void AnswerWriter::classDeclaration(const ClassDeclaration& declared)
{
    begin();
    if (isBetweenObjects(kind_)) {
        const Markup element(piece_, "VALUE.OBJECTWITHPATH");
        writeClassPath(piece_, declared.name, location_);
        writeClass(piece_, declared, selection_);
    } else {
        writeClass(piece_, declared, selection_);
    }
    send();
}

void AnswerWriter::className(std::string_view name)
{
    begin();
    if (isBetweenObjects(kind_)) {
        const Markup element(piece_, "OBJECTPATH");
        writeClassPath(piece_, name, location_);
    } else {
        Markup(piece_, "CLASSNAME").attribute("NAME", name);
    }
    send();
}

void AnswerWriter::qualifierDeclaration(const QualifierDeclaration& declared)
{
    begin();
    writeQualifierDeclaration(piece_, declared);
    send();
}

void AnswerWriter::value(const Value& value)
{
    begin();
    writeValue(piece_, value);
    send();
}

void AnswerWriter::finish()
{
    begin();
    if (kind_ != OperationKind::closeEnumeration) // which returns nothing
        piece_ += "</IRETURNVALUE>";
    piece_ += tail(true);
    send();
}

void AnswerWriter::finish(const std::optional<std::string>& enumerationContext)
{
    begin();
    piece_ += "</IRETURNVALUE>";
    const auto parameter = [this](const char* name, const char* type, std::string_view text) {
        Markup element(piece_, "PARAMVALUE");
        element.attribute("NAME", name).attribute("PARAMTYPE", type);
        Markup(piece_, "VALUE").content(text);
    };
    parameter("EndOfSequence", "boolean", enumerationContext ? "FALSE" : "TRUE");
    parameter("EnumerationContext", "string", enumerationContext.value_or(""));
    piece_ += tail(true);
    send();
}

void AnswerWriter::begin()
{
    piece_.clear(); // of an object that could not be written
    if (hasBegun_)
        return;
    piece_ = head(id_, protocolVersion_, true, methodName_);
    if (kind_ != OperationKind::closeEnumeration)
        piece_ += "<IRETURNVALUE>";
}

void AnswerWriter::send()
{
    hasBegun_ = true;
    sink_(piece_);
    piece_.clear();
}

} // namespace Host::CimXml
