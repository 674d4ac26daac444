// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tests/objectmanagers/Answer.h"

#include "host/cimxml/Element.h"
#include "tests/tools/ChildProcess.h"

#include <strings.h>

#include <set>
#include <stdexcept>

namespace Testing {

namespace {

using Host::CimXml::Element;

std::string pathOf(const Element& element);

std::string textOf(const Element& value)
{
    return value.is("VALUE.REFERENCE") ? pathOf(value.children().at(0)) : value.content();
}

std::string keyValue(const Element& key)
{
    return key.is("KEYVALUE") ? '"' + key.content() + '"' : textOf(key);
}

// Object managers spell the names of keys as classes or as clients do.
struct InAnySpelling {
    bool operator()(const std::string& one, const std::string& other) const
    {
        return strcasecmp(one.c_str(), other.c_str()) < 0;
    }
};

// NAMESPACE:CLASS.KEY=VALUE,... of any element that holds a path, and CLASS without keys.
std::string pathOf(const Element& element)
{
    if (element.is("INSTANCENAME")) {
        std::set<std::string, InAnySpelling> keys;
        for (const Element& binding : element.children())
            keys.insert(
                std::string(binding.attribute("NAME")) + '=' + keyValue(binding.children().at(0)));
        std::string path(element.attribute("CLASSNAME"));
        for (const std::string& key : keys)
            path += (&key == &*keys.begin() ? '.' : ',') + key;
        return path;
    }
    if (element.is("NAMESPACE"))
        return std::string(element.attribute("NAME"));
    std::string path;
    for (const Element& part : element.children())
        if (!part.is("HOST"))
            path += (path.empty() ? "" : part.is("NAMESPACE") ? "/" : ":") + pathOf(part);
    return path;
}

// The text of a VALUE or VALUE.ARRAY.
std::string quoted(const Element& value)
{
    if (value.is("VALUE"))
        return '"' + value.content() + '"';
    std::string text = "{";
    for (const Element& element : value.children())
        text += (text.ends_with('{') ? "\"" : ", \"") + element.content() + '"';
    return text + '}';
}

std::optional<std::string> valueOf(const Element& property)
{
    // After the qualifiers, which properties of classes have.
    if (property.children().empty() || property.children().back().is("QUALIFIER"))
        return std::nullopt;
    const Element& value = property.children().back();
    if (property.is("PROPERTY.REFERENCE"))
        return textOf(value);
    return std::string(property.attribute("TYPE")) + ' ' + quoted(value);
}

Properties propertiesOf(const Element& instance)
{
    Properties properties;
    for (const Element& child : instance.children())
        if (child.name().starts_with("PROPERTY") &&
            !properties.emplace(child.attribute("NAME"), valueOf(child)).second)
            throw std::runtime_error("twice: " + std::string(child.attribute("NAME")));
    return properties;
}

// An object or the name of one, with a path or without, or the value of a property.
void add(Answer& answer, const Element& object)
{
    if (object.is("INSTANCE"))
        answer.objects.emplace(object.attribute("CLASSNAME"), propertiesOf(object));
    else if (object.is("CLASS"))
        answer.objects.emplace(object.attribute("NAME"), propertiesOf(object));
    else if (object.is("VALUE.NAMEDINSTANCE") || object.is("VALUE.OBJECTWITHPATH"))
        answer.objects.emplace(
            pathOf(object.children().at(0)), propertiesOf(object.children().at(1)));
    else if (object.is("VALUE") || object.is("VALUE.ARRAY"))
        answer.objects.emplace(quoted(object), Properties());
    else
        answer.objects.emplace(pathOf(object), Properties());
}

} // namespace

Answer ask(const std::vector<std::string>& arguments)
{
    std::vector<std::string> words = {"-dx"};
    words.insert(words.end(), arguments.begin(), arguments.end());
    const Ended ended = run(words, {.program = "/usr/bin/wbemcli"});
    // Before it invokes a method, wbemcli asks for the class.
    const std::string before = "From server: <?xml";
    const std::size_t begin = ended.err.rfind(before);
    const std::size_t end = ended.err.find("</CIM>", begin);
    if (begin == std::string::npos || end == std::string::npos)
        throw std::runtime_error("no answer: " + ended.out + ended.err);
    const std::size_t xml = begin + before.size() - 5;
    const Element document =
        Host::CimXml::readDocument(std::string_view(ended.err).substr(xml, end + 6 - xml));
    const Element& response =
        document.children().at(0).children().at(0).child({"IMETHODRESPONSE", "METHODRESPONSE"});
    Answer answer;
    for (const Element& result : response.children())
        if (result.is("ERROR"))
            answer.error = std::stoi(std::string(result.attribute("CODE")));
        else
            for (const Element& object : result.children())
                add(answer, object);
    return answer;
}

std::string describe(const Answer& answer)
{
    if (answer.error != 0)
        return "error " + std::to_string(answer.error) + '\n';
    std::string text = std::to_string(answer.objects.size()) + " objects\n";
    for (const auto& [path, properties] : answer.objects) {
        text += path + '\n';
        for (const auto& [name, value] : properties)
            text += "  " + name + " = " + value.value_or("NULL") + '\n';
    }
    return text;
}

} // namespace Testing
