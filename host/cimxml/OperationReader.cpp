// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "host/broker/Names.h"
#include "host/broker/ObjectPath.h"
#include "host/broker/Refusal.h"
#include "host/cimxml/InvalidParameter.h"
#include "host/cimxml/Literal.h"
#include "host/cimxml/Message.h"
#include "host/cimxml/OperationTable.h"
#include "host/cimxml/PathReader.h"
#include "host/cimxml/Quotation.h"
#include "host/repository/TypeNames.h"

#include <array>

namespace Host::CimXml {

namespace {

using P = Parameter;

std::string described(Parameter parameter)
{
    return "parameter " + std::string(nameOf(parameter));
}

// The IPARAMVALUEs of one call by their names.
class Parameters {
public:
    Parameters(const OperationForm& form, const Element& call) : form_(form)
    {
        for (const Element& child : call.children({"LOCALNAMESPACEPATH", "IPARAMVALUE"}))
            if (child.is("IPARAMVALUE"))
                add(child);
        for (std::size_t at = 0; at < parameterCount; ++at)
            if (form.required.has(static_cast<P>(at)) && values_[at] == nullptr)
                refuse(std::string(form.name) + " needs " + described(static_cast<P>(at)));
    }

    // Returns the value of a parameter; null when the parameter was not given or has no value.
    const Element* operator[](P parameter) const
    {
        return values_[static_cast<std::size_t>(parameter)];
    }

    // Returns the value of a parameter, or null. Throws when the value is another element.
    const Element* get(P parameter, std::string_view kind) const
    {
        const Element* const value = (*this)[parameter];
        if (value != nullptr && !value->is(kind))
            refuse(described(parameter) + " must be a " + std::string(kind) + ", not a " +
                   value->name());
        return value;
    }

    std::string text(P parameter) const
    {
        const Element* const value = get(parameter, "VALUE");
        return value != nullptr ? value->content() : std::string();
    }

    bool flag(P parameter) const
    {
        const auto value = literal(parameter, CMPI_boolean);
        return value ? *value->boolean() : form_.trueByDefault.has(parameter);
    }

    std::optional<std::uint32_t> number(P parameter) const
    {
        const auto value = literal(parameter, CMPI_uint32);
        return value ? std::optional(static_cast<std::uint32_t>(*value->unsignedInteger()))
                     : std::nullopt;
    }

    // Returns nothing when there is no list, which differs from an empty one.
    std::optional<std::vector<std::string>> texts(P parameter) const
    {
        const Element* const value = get(parameter, "VALUE.ARRAY");
        if (value == nullptr)
            return std::nullopt;
        std::vector<std::string> all;
        for (const Element& each : value->children({"VALUE"}))
            all.push_back(each.content());
        return all;
    }

private:
    void add(const Element& element)
    {
        const std::string_view name = element.attribute("NAME");
        std::size_t at = 0;
        while (at < parameterCount && !equalNames(nameOf(static_cast<P>(at)), name))
            ++at;
        const auto parameter = static_cast<P>(at);
        if (at == parameterCount ||
            !(form_.required.has(parameter) || form_.optional.has(parameter)))
            refuse(std::string(form_.name) + " has no parameter " + quotation(name));
        if (isGiven_[at])
            refuse(described(parameter) + " comes twice");
        isGiven_[at] = true;
        values_[at] = element.findChild({"VALUE", "VALUE.ARRAY", "VALUE.REFERENCE", "INSTANCENAME",
            "CLASSNAME", "QUALIFIER.DECLARATION", "CLASS", "INSTANCE", "VALUE.NAMEDINSTANCE"});
        // Some clients send an empty name in place of no class.
        if (values_[at] != nullptr && values_[at]->is("CLASSNAME") &&
            values_[at]->attribute("NAME").empty())
            values_[at] = nullptr;
    }

    std::optional<Value> literal(P parameter, CMPIType type) const
    {
        const Element* const value = get(parameter, "VALUE");
        if (value == nullptr)
            return std::nullopt;
        const std::string& content = value->content();
        const auto read = readLiteral(Arena::required(), type, content);
        if (!read)
            refuse(described(parameter) + ": " + quotation(content) + " is no value of type " +
                   nameOfType(type));
        return read;
    }

    const OperationForm& form_;
    std::array<bool, parameterCount> isGiven_{};
    std::array<const Element*, parameterCount> values_{};
};

class OperationReader {
public:
    OperationReader(const Repository& classes, const Parameters& parameters, Operation& operation)
        : parameters_(parameters), paths_(classes), operation_(operation)
    {
    }

    void read()
    {
        readFlags();
        readTexts();
        readClasses();
        readPath();
    }

private:
    void readFlags()
    {
        operation_.deepInheritance = parameters_.flag(P::deepInheritance);
        operation_.selection.localOnly = parameters_.flag(P::localOnly);
        operation_.selection.includeQualifiers = parameters_.flag(P::includeQualifiers);
        operation_.selection.includeClassOrigin = parameters_.flag(P::includeClassOrigin);
        operation_.continueOnError = parameters_.flag(P::continueOnError);
        operation_.operationTimeout = parameters_.number(P::operationTimeout);
        operation_.maxObjectCount = parameters_.number(P::maxObjectCount).value_or(0);
        operation_.selection.properties = parameters_.texts(P::propertyList);
    }

    void readTexts()
    {
        operation_.role = parameters_.text(P::role);
        operation_.resultRole = parameters_.text(P::resultRole);
        operation_.propertyName = parameters_.text(P::propertyName);
        operation_.qualifierName = parameters_.text(P::qualifierName);
        operation_.filterQuery = parameters_.text(P::filterQuery);
        operation_.filterQueryLanguage = parameters_.text(P::filterQueryLanguage);
        operation_.enumerationContext = parameters_.text(P::enumerationContext);
    }

    std::string className(P parameter) const
    {
        const Element* const value = parameters_.get(parameter, "CLASSNAME");
        return value != nullptr ? paths_.className(*value, operation_.nameSpace) : std::string();
    }

    void readClasses()
    {
        operation_.className = className(P::className);
        operation_.associationClass = className(P::assocClass);
        operation_.resultClass = className(P::resultClass);
    }

    void readPath()
    {
        const Element* const object = parameters_[P::objectName];
        if (object != nullptr && object->is("CLASSNAME")) {
            operation_.className = className(P::objectName);
            return;
        }
        const Element* const name =
            parameters_.get(object != nullptr ? P::objectName : P::instanceName, "INSTANCENAME");
        if (name == nullptr)
            return;
        operation_.path = &paths_.instanceName(*name, operation_.nameSpace);
        operation_.className = operation_.path->className();
    }

    const Parameters& parameters_;
    PathReader paths_;
    Operation& operation_;
};

// No class has a method that can be called: neither the path's keys nor the arguments are read.
[[noreturn]] void refuseMethod(const Message& message, const Repository& classes)
{
    const PathReader paths(classes);
    const Element& path = message.path();
    std::string className;
    for (const Element& part : path.children({"LOCALNAMESPACEPATH", "INSTANCENAME", "CLASSNAME"}))
        if (!part.is("LOCALNAMESPACEPATH"))
            className = paths.className(part, message.nameSpace());
    if (className.empty())
        path.fail("it names no class");
    if (classes.findClass(message.nameSpace(), className) == nullptr)
        throw Refusal(CMPI_RC_ERR_INVALID_CLASS, "there is no class " + quotation(className));
    throw Refusal(CMPI_RC_ERR_METHOD_NOT_AVAILABLE,
        "class " + className + " offers no method " + message.methodName());
}

} // namespace

Operation readOperation(const Message& message, const Repository& classes)
{
    const OperationForm* const form = findOperation(message.methodName());
    if (message.isIntrinsic() && form == nullptr)
        throw Refusal(CMPI_RC_ERR_NOT_SUPPORTED,
            "operation " + quotation(message.methodName()) + " is not offered");
    const Namespace* const nameSpace = classes.findNamespace(message.nameSpace());
    if (nameSpace == nullptr)
        throw Refusal(CMPI_RC_ERR_INVALID_NAMESPACE,
            "there is no namespace " + quotation(message.nameSpace()));
    if (!message.isIntrinsic())
        refuseMethod(message, classes);
    Operation operation;
    operation.kind = form->kind;
    operation.nameSpace = nameSpace->name();
    OperationReader(classes, Parameters(*form, message.call()), operation).read();
    return operation;
}

} // namespace Host::CimXml
