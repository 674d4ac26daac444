// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/output/PropertyList.h"

#include "host/broker/Array.h"
#include "host/broker/Instance.h"
#include "host/broker/ObjectPath.h"
#include "host/broker/String.h"
#include "host/broker/Text.h"
#include "tools/cim/ObjectNames.h"
#include "tools/cim/ValueMaps.h"
#include "tools/output/Emphasis.h"
#include "tools/output/PrintableText.h"
#include "tools/output/SensorCells.h"

#include <algorithm>
#include <string_view>
#include <vector>

namespace Tools {

namespace {

constexpr std::size_t margin = 2;

struct ListedObject {
    Sensor sensor;
    const Host::ClassDeclaration* declared;
};

// Returns the meaning of a number; an empty text when it has none.
std::string meaningIn(
    const ListedObject& object, std::string_view property, const Host::Value& value)
{
    const Sensor& sensor = object.sensor;
    if (property == "CurrentReading")
        return sensor.reading ? textWithUnit(sensor.reading, sensor) : "no reading";
    for (std::size_t i = 0; i < limitKinds.size(); ++i)
        if (const auto& limit = sensor.limits.at(i); property == limitKinds.at(i).property)
            return limit ? textWithUnit(limit, sensor) : "out of range";
    const auto code = value.unsignedInteger();
    return code ? std::string(meaningOf(object.declared, property, *code)) : std::string{};
}

std::string shown(const ListedObject& object, std::string_view property, const Host::Value& value)
{
    if (const auto text = value.text())
        return std::string(*text);
    if (const Host::ObjectPath* const path = value.path())
        return path->toText();
    const std::string meaning = meaningIn(object, property, value);
    const std::string number = Host::toText(value);
    return meaning.empty() ? number : number + " (" + meaning + ")";
}

// Returns one item, or an item for each element of an array.
std::vector<std::string> itemsOf(
    const ListedObject& object, std::string_view property, const Host::Value& value, bool isUtf8)
{
    const Host::Array* const array = value.array();
    if (array == nullptr)
        return {printable(shown(object, property, value), isUtf8)};
    std::vector<std::string> items;
    for (const Host::Value& element : array->elements())
        items.push_back(printable(shown(object, property, element), isUtf8));
    return items;
}

// Joins the items with commas in lines that begin at the column. Breaks lines between items to keep
// them within the width.
std::string flow(const std::vector<std::string>& items, std::size_t column, std::size_t width)
{
    std::string text;
    std::size_t used = column;
    for (std::size_t i = 0; i < items.size(); ++i) {
        const std::string item = items[i] + (i + 1 < items.size() ? "," : "");
        const std::size_t room = 1 + displayWidth(item);
        if (i > 0 && used + room > width) {
            text.append("\n").append(column, ' ');
            used = column;
        } else if (i > 0) {
            text += ' ';
            ++used;
        }
        text += item;
        used += room - 1;
    }
    return text;
}

} // namespace

std::string propertyList(
    const Host::Instance& instance, const Host::ClassDeclaration* declared, const TextStyle& style)
{
    std::size_t column = 0;
    for (const Host::NamedValue& property : instance.properties())
        column = std::max(column, property.name->text()->size());
    column += 2 * margin;

    const ListedObject object = {Sensor(instance), declared};
    std::string text =
        emphasized(printable(nameOf(instance), style.isUtf8), Emphasis::heading, style.isColored) +
        "\n";
    for (const Host::NamedValue& property : instance.properties()) {
        if (property.value.isNull())
            continue;
        const std::string_view name = *property.name->text();
        text.append(margin, ' ').append(name).append(column - margin - name.size(), ' ');
        text +=
            flow(itemsOf(object, name, property.value, style.isUtf8), column, style.width) + "\n";
    }
    return text;
}

} // namespace Tools
