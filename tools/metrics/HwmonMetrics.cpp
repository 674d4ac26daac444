// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/metrics/HwmonMetrics.h"

#include "tools/sensors/HwmonFiles.h"

#include <algorithm>
#include <array>
#include <charconv>
#include <filesystem>
#include <map>
#include <optional>
#include <string>
#include <system_error>
#include <utility>
#include <vector>

namespace Tools {

namespace {

namespace Files = std::filesystem;

constexpr const char* help =
    "Values of an attribute in /sys/class/hwmon, named and labelled as node_exporter does.";

// The kernel's unit of an attribute, as a part of the unit of its series.
enum class Scale { one, milli, micro };

// Multiplies and divides where the exporter does, since that decides on the last digit.
double scaled(double number, Scale scale)
{
    switch (scale) {
    case Scale::milli:
        return number * 0.001;
    case Scale::micro:
        return number / 1'000'000;
    default:
        return number;
    }
}

// How the exporter publishes an attribute.
struct Unit {
    std::string_view suffix; // of the name
    Scale scale = Scale::one;
};

// The kinds of attributes with the units of those elements that are not listed below.
constexpr std::array<std::pair<std::string_view, Unit>, 10> channelKinds = {{
    {"cpu", {"_volts", Scale::milli}},
    {"curr", {"_amps", Scale::milli}},
    {"energy", {"_joule_total", Scale::micro}},
    {"fan", {""}},
    {"humidity", {"", Scale::micro}},
    {"in", {"_volts", Scale::milli}},
    {"intrusion", {""}},
    {"power", {"_watt", Scale::micro}},
    {"pwm", {""}},
    {"temp", {"_celsius", Scale::milli}},
}};

// The elements with units of their own, of a kind or, where that is empty, of all.
struct ElementUnit {
    std::string_view kind;
    std::string_view name;
    Unit unit;
};
constexpr std::array elements = {ElementUnit{"", "alarm", {""}},
    ElementUnit{"", "beep", {"_enabled"}}, ElementUnit{"", "fault", {""}},
    ElementUnit{"fan", "input", {"_rpm"}}, ElementUnit{"fan", "max", {"_rpm"}},
    ElementUnit{"fan", "min", {"_rpm"}}, ElementUnit{"fan", "target", {"_rpm"}},
    ElementUnit{"power", "accuracy", {"", Scale::micro}},
    ElementUnit{"power", "average_interval", {"_seconds", Scale::milli}},
    ElementUnit{"power", "average_interval_max", {"_seconds", Scale::milli}},
    ElementUnit{"power", "average_interval_min", {"_seconds", Scale::milli}},
    ElementUnit{"temp", "type", {""}}};

// The attributes of whole chips.
struct ChipAttribute {
    std::string_view name;
    std::string_view metric;
    Scale scale = Scale::one;
};
constexpr std::array chipAttributes = {ChipAttribute{"beep_enable", "beep_enabled"},
    ChipAttribute{"update_interval", "update_interval_seconds", Scale::milli},
    ChipAttribute{"vrm", "voltage_regulator_version"}};

// Returns the text as the exporter spells names.
std::string cleaned(std::string_view text)
{
    std::string name(text);
    for (char& c : name) {
        c = c >= 'A' && c <= 'Z' ? static_cast<char>(c - 'A' + 'a') : c;
        const bool isKept = (c >= 'a' && c <= 'z') || (c >= '0' && c <= '9') || c == ':';
        c = isKept ? c : '_';
    }
    name.erase(0, std::min(name.find_first_not_of('_'), name.size()));
    name.erase(name.find_last_not_of('_') + 1);
    return name;
}

// An attribute such as temp1_max: the element max of the sensor temp1.
struct ExportedAttribute {
    std::string sensor;
    std::string element; // "label" for one that is a text
    std::string metric;
    Scale scale = Scale::one;
};

std::optional<ExportedAttribute> attributeOf(std::string_view name)
{
    for (const ChipAttribute& each : chipAttributes)
        if (name == each.name)
            return ExportedAttribute{
                std::string(name) + "0", "", std::string(each.metric), each.scale};
    constexpr std::string_view digits = "0123456789";
    const std::size_t kindEnd = std::min(name.find_first_of(digits), name.size());
    const std::size_t sensorEnd = std::min(name.find_first_not_of(digits, kindEnd), name.size());
    const std::string_view kind = name.substr(0, kindEnd);
    std::string_view element = name.substr(sensorEnd);
    const auto* const known = std::find_if(channelKinds.begin(), channelKinds.end(),
        [&](const auto& each) { return each.first == kind; });
    if (known == channelKinds.end() || kindEnd == sensorEnd || element == "_" ||
        (!element.empty() && !element.starts_with('_')))
        return std::nullopt;
    element.remove_prefix(element.empty() ? 0 : 1);
    const auto* const own =
        std::find_if(elements.begin(), elements.end(), [&](const ElementUnit& each) {
            return each.name == element && (each.kind.empty() || each.kind == kind);
        });
    const Unit unit = own == elements.end() ? known->second : own->unit;
    std::string metric(kind);
    if (!element.empty() && element != "input")
        (metric += '_') += cleaned(element);
    metric += unit.suffix;
    return ExportedAttribute{
        std::string(name.substr(0, sensorEnd)), std::string(element), metric, unit.scale};
}

std::optional<double> numberIn(const Files::path& file)
{
    const auto text = contentOf(file);
    double number = 0;
    if (!text)
        return std::nullopt;
    const char* const end = text->data() + text->size();
    const auto [stop, error] = std::from_chars(text->data(), end, number);
    return error == std::errc{} && stop == end ? std::optional(number) : std::nullopt;
}

// Returns the folder's device by its address, below that of its parent; where it has none, its
// name, and where it has none either, that of the folder.
std::string chipOf(const Files::path& folder, const std::string& name)
{
    std::error_code failure;
    const Files::path device = Files::canonical(folder / "device", failure);
    if (!failure)
        return cleaned(device.parent_path().filename().string()) + "_" +
               cleaned(device.filename().string());
    return name.empty() ? folder.filename().string() : name;
}

class HwmonFamilies {
public:
    void addChip(const Files::path& folder)
    {
        const std::string name = cleaned(contentOf(folder / "name").value_or(""));
        const std::string chip = chipOf(folder, name);
        if (!name.empty())
            add("chip_names", Labels().add("chip", chip).add("chip_name", name), 1);
        // Old drivers have their attributes in the folder of the device, which has precedence.
        for (const Files::path& place : {folder / "device", folder})
            for (const std::string& entry : entriesOf(place.string()))
                if (const auto attribute = attributeOf(entry))
                    addAttribute(*attribute, chip, place / entry);
    }

    void addTo(Exposition& exposition) const
    {
        for (const auto& [metric, family] : families_) {
            const std::string name = "node_hwmon_" + metric;
            const bool isCounter = metric.ends_with("_total");
            std::vector<Series> series;
            series.reserve(family.size());
            for (const auto& [labels, value] : family)
                series.push_back({labels, value});
            exposition.add(
                {name, help, isCounter ? MetricFamily::Type::counter : MetricFamily::Type::gauge},
                series);
        }
    }

private:
    void addAttribute(
        const ExportedAttribute& attribute, const std::string& chip, const Files::path& file)
    {
        Labels labels;
        labels.add("chip", chip);
        if (attribute.element == "label") {
            if (const auto label = contentOf(file))
                add("sensor_label", labels.add("label", *label).add("sensor", attribute.sensor), 1);
        } else if (const auto number = numberIn(file))
            add(attribute.metric, labels.add("sensor", attribute.sensor),
                scaled(*number, attribute.scale));
    }

    // Of several chips of one name, the first has the series.
    void add(const std::string& metric, const Labels& labels, double value)
    {
        families_[metric].try_emplace(labels, value);
    }

    std::map<std::string, std::map<Labels, double>> families_; // by the name without a prefix
};

} // namespace

void addHwmon(Exposition& exposition)
{
    std::vector<std::string> chips = entriesOf(hwmonFolder);
    std::sort(chips.begin(), chips.end());
    HwmonFamilies families;
    for (const std::string& chip : chips)
        families.addChip(Files::path(hwmonFolder) / chip);
    families.addTo(exposition);
}

} // namespace Tools
