// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/output/ObjectTable.h"

#include "host/broker/Array.h"
#include "host/broker/Instance.h"
#include "host/broker/Names.h"
#include "host/broker/ObjectPath.h"
#include "host/broker/String.h"
#include "host/broker/Text.h"
#include "tools/cim/ObjectNames.h"
#include "tools/cim/ValueMaps.h"
#include "tools/output/PrintableText.h"
#include "tools/output/Table.h"

#include <algorithm>
#include <array>
#include <cctype>
#include <string_view>

namespace Tools {

namespace {

// The columns after those of the references, which have other names in each class.
constexpr std::array<std::string_view, 7> shownProperties = {"DeviceID", "InstanceID", "Name",
    "ElementName", "EnabledState", "HealthState", "OperationalStatus"};

std::string shown(
    const Host::ClassDeclaration* declared, std::string_view property, const Host::Value& value)
{
    if (const Host::ObjectPath* const path = value.path())
        return shortName(*path);
    if (const auto text = value.text())
        return std::string(*text);
    if (const auto code = value.unsignedInteger()) {
        const std::string_view meaning = meaningOf(declared, property, *code);
        return meaning.empty() ? std::to_string(*code) : std::string(meaning);
    }
    if (const Host::Array* const array = value.array()) {
        std::string text;
        for (const Host::Value& element : array->elements())
            text.append(text.empty() ? "" : ", ").append(shown(declared, property, element));
        return text;
    }
    return Host::toText(value);
}

bool contains(const std::vector<std::string>& names, std::string_view name)
{
    return std::any_of(names.begin(), names.end(),
        [&](const std::string& known) { return Host::equalNames(known, name); });
}

std::vector<std::string> columnsOf(const Instances& objects)
{
    std::vector<std::string> columns;
    for (const Host::Instance* const object : objects)
        for (const Host::NamedValue& property : object->properties())
            if (property.value.path() != nullptr && !contains(columns, *property.name->text()))
                columns.emplace_back(*property.name->text());
    for (const std::string_view name : shownProperties)
        if (std::any_of(objects.begin(), objects.end(),
                [&](const Host::Instance* object) { return object->property(name) != nullptr; }))
            columns.emplace_back(name);
    return columns;
}

bool areOfSeveralClasses(const Instances& objects)
{
    return std::any_of(objects.begin(), objects.end(), [&](const Host::Instance* object) {
        return object->className() != objects.front()->className();
    });
}

std::string titleOf(std::string name)
{
    std::transform(name.begin(), name.end(), name.begin(),
        [](unsigned char c) { return static_cast<char>(std::toupper(c)); });
    return name;
}

Cell cellOf(const Host::Instance& object, const Host::ClassDeclaration* declared,
    const std::string& property, bool isUtf8)
{
    const Host::Value* const value = object.property(property);
    if (value == nullptr || value->isNull())
        return {absent, Emphasis::faint};
    const std::string text = printable(shown(declared, property, *value), isUtf8);
    return text.empty() ? Cell{absent, Emphasis::faint} : Cell{text};
}

} // namespace

std::string objectTable(
    const ProviderClient& provider, const Instances& objects, const TextStyle& style)
{
    const std::vector<std::string> properties = columnsOf(objects);
    const bool showsClass = properties.empty() || areOfSeveralClasses(objects);
    std::vector<Column> columns;
    columns.reserve(properties.size() + 1);
    for (const std::string& property : properties)
        columns.push_back({titleOf(printable(property, style.isUtf8))});
    if (showsClass)
        columns.push_back({"CLASS"});
    Table table(columns);
    for (const Host::Instance* const object : objects) {
        const Host::ClassDeclaration* const declared = provider.classOf(*object);
        std::vector<Cell> cells;
        cells.reserve(columns.size());
        for (const std::string& property : properties)
            cells.push_back(cellOf(*object, declared, property, style.isUtf8));
        if (showsClass)
            cells.push_back({printable(object->className(), style.isUtf8)});
        table.add(std::move(cells));
    }
    return table.toText(style);
}

} // namespace Tools
