// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tests/tools/Wbemcli.h"

#include "tests/tools/ToolTest.h"

namespace Testing {

namespace {

std::string plainValue(const nlohmann::json& value)
{
    if (value.is_boolean())
        return value.get<bool>() ? "TRUE" : "FALSE";
    if (value.is_string())
        return plain(value);
    if (!value.is_array())
        return value.dump();
    std::string list;
    for (const nlohmann::json& element : value)
        list += (list.empty() ? "" : ",") + plainValue(element);
    return list;
}

} // namespace

std::string plain(const std::string& text)
{
    static const std::string space = "root/cimv2";
    std::string result;
    for (const char character : text)
        if (character != '"' && character != '\\')
            result += character;
    for (std::size_t at = result.find(space); at != std::string::npos; at = result.find(space)) {
        const std::size_t before = result.find_last_of("=,", at);
        const std::size_t begin = before == std::string::npos ? 0 : before + 1;
        // wbemcli omits the colon where a key refers to an object on a host.
        const std::size_t end = at + space.size();
        result.erase(begin, end - begin + (result.substr(end, 1) == ":" ? 1 : 0));
    }
    return result;
}

PlainInstances::value_type plainInstance(const nlohmann::json& instance)
{
    PlainProperties properties;
    for (const auto& [name, value] : instance.at("properties").items())
        properties[name] = plainValue(value);
    return {plain(instance.at("path")), properties};
}

PlainInstances plainInstances(const std::string& output)
{
    PlainInstances instances;
    auto last = instances.end();
    for (const std::string& line : linesOf(output)) {
        if (line.empty())
            continue;
        if (line[0] != '-') {
            last = instances.emplace(plain(line), PlainProperties());
            continue;
        }
        const std::size_t sign = line.find('=');
        if (last == instances.end() || sign == std::string::npos)
            ADD_FAILURE() << "not a property of an instance: " << line;
        else if (!last->second.emplace(line.substr(1, sign - 1), plain(line.substr(sign + 1)))
                      .second)
            ADD_FAILURE() << "twice: " << line;
    }
    return instances;
}

PlainPaths plainPaths(const std::string& output)
{
    PlainPaths paths;
    for (const std::string& line : linesOf(output))
        paths.insert(plain(line));
    return paths;
}

PlainPaths pathsOf(const PlainInstances& instances)
{
    PlainPaths paths;
    for (const auto& [path, properties] : instances)
        paths.insert(path);
    return paths;
}

Ended wbemcli(const std::vector<std::string>& arguments)
{
    return run(arguments, {.program = "/usr/bin/wbemcli"});
}

} // namespace Testing
