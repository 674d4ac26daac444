// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/page/PageResource.h"

#include "host/broker/Names.h"
#include "host/http/ResourceCheck.h"
#include "platform/utilities/ProviderUtilities.h"
#include "tools/page/WebFiles.h"

#include <kainjow/mustache.hpp>
#include <nlohmann/json.hpp>

#include <algorithm>
#include <array>
#include <stdexcept>
#include <string_view>
#include <utility>

namespace Tools {

namespace {

using Data = kainjow::mustache::data;
using Texts = nlohmann::json; // by name

constexpr const char* defaultLanguage = "en";

constexpr std::array urgencies = {Urgency::critical, Urgency::warning, Urgency::lost,
    Urgency::unknown, Urgency::inactive, Urgency::normal};

// Returns the text of that name; the name where there is none.
std::string textIn(const Texts& texts, std::string_view name)
{
    const auto found = texts.find(name);
    return found != texts.end() && found->is_string() ? found->get<std::string>()
                                                      : std::string(name);
}

// Returns a number and its unit in the language of the texts.
std::string quantityIn(const Texts& texts, std::string number, std::string_view unit)
{
    if (const std::size_t point = number.find('.'); point != std::string::npos)
        number.replace(point, 1, textIn(texts, "decimalSign"));
    return unit.empty() ? number : number.append("\u00a0").append(unit);
}

Data rowOf(const Sensor& sensor, const Texts& texts)
{
    constexpr const char* noReading = "\u2013";
    std::string limits;
    for (std::size_t i = 0; i < limitKinds.size(); ++i)
        if (const auto& limit = sensor.limits.at(i))
            limits += (limits.empty() ? "" : ", ") +
                      textIn(texts.at("limitNames"), limitKinds.at(i).member) + " " +
                      quantityIn(texts, limit->text(), sensor.unit);
    Data row;
    row.set("label", sensor.label.empty() ? sensor.deviceId : sensor.label);
    row.set("reading",
        sensor.reading ? quantityIn(texts, sensor.reading->rounded(), sensor.unit) : noReading);
    row.set("state", textIn(texts.at("states"), sensor.state.word));
    row.set("urgency", std::string(wordOf(sensor.state.urgency)));
    row.set("limits", limits);
    return row;
}

Data chipsOf(const std::vector<const Sensor*>& sensors, const Texts& texts)
{
    Data chips(Data::type::list);
    for (auto first = sensors.begin(); first != sensors.end();) {
        Data rows(Data::type::list);
        auto next = first;
        for (; next != sensors.end() && (*next)->chip == (*first)->chip; ++next)
            rows.push_back(rowOf(**next, texts));
        Data chip;
        chip.set("chip", (*first)->chip);
        chip.set("device", (*first)->device);
        chip.set("sensors", rows);
        chips.push_back(chip);
        first = next;
    }
    return chips;
}

Data countsOf(const Sensors& sensors, const Texts& texts)
{
    std::map<Urgency, std::size_t> counts;
    for (const Sensor& sensor : sensors)
        ++counts[sensor.state.urgency];
    Data list(Data::type::list);
    for (const Urgency urgency : urgencies) {
        const std::string word(wordOf(urgency));
        Data count;
        count.set("urgency", word);
        count.set("number", std::to_string(counts[urgency]));
        count.set("word", textIn(texts.at("urgencies"), word));
        list.push_back(count);
    }
    return list;
}

Data textsOf(const Texts& texts)
{
    Data result;
    for (const auto& [name, text] : texts.items())
        if (text.is_string())
            result.set(name, text.get<std::string>());
    return result;
}

// Returns a sentence, or nothing where no source is lost. The names are isolated in it: their
// direction is theirs (Unicode Standard Annex #9).
std::string lostSourcesIn(const Texts& texts, const Harvest& harvest)
{
    constexpr std::string_view isolated = "\u2068\u2069"; // the characters around a name
    constexpr std::size_t half = isolated.size() / 2;
    std::string names;
    for (const std::string& name : harvest.lostSources())
        names.append(names.empty() ? "" : ", ")
            .append(isolated.substr(0, half))
            .append(name)
            .append(isolated.substr(half));
    if (names.empty())
        return "";
    constexpr std::string_view place = "{names}";
    std::string sentence = textIn(texts, "lostSources");
    if (const std::size_t at = sentence.find(place); at != std::string::npos)
        sentence.replace(at, place.size(), names);
    return sentence;
}

std::string render(const std::string& text, const std::string& language, const Texts& texts,
    const Harvest& harvest, bool isHistoryKept)
{
    Data data;
    data.set("language", language);
    data.set("machine", Vorn::getSystemName());
    data.set("text", textsOf(texts));
    data.set("history", isHistoryKept ? "kept" : "off");
    data.set("lostSources", lostSourcesIn(texts, harvest));
    data.set("counts", countsOf(harvest.sensors, texts));
    data.set("chips", chipsOf(inListOrder(harvest.sensors), texts));
    return kainjow::mustache::mustache(text).render(data); // whose method is not const
}

Texts parseTexts(const std::string& name, const std::string& content)
{
    try {
        Texts texts = Texts::parse(content);
        for (const char* const member : {"limitNames", "states", "urgencies"})
            (void)texts.at(member);
        return texts;
    } catch (const Texts::exception& error) {
        throw std::runtime_error(name + ": " + error.what());
    }
}

} // namespace

PageResource::PageResource(const WebFiles& files, SingleFlight<Harvest>& harvests,
    bool isHistoryKept, Host::Http::UnsentObjects& unsent)
    : template_(files.contentOf("page.html"))
{
    (void)files.contentOf(std::string("languages/") + defaultLanguage + ".json");
    const kainjow::mustache::mustache parsed(template_);
    if (!parsed.is_valid())
        throw std::runtime_error("page.html: " + parsed.error_message());
    for (const std::string& name : files.namesIn("languages")) {
        const std::string language = std::filesystem::path(name).stem();
        const auto write = [this, &harvests, isHistoryKept, &unsent, language,
                               texts = parseTexts(name, files.contentOf(name))] {
            return std::make_shared<const UnsentText>(
                render(template_, language, texts, *harvests.get(), isHistoryKept), unsent);
        };
        pages_.emplace(language, std::make_unique<SingleFlight<UnsentText>>(write));
    }
}

Host::Http::Representation PageResource::represent(const Host::Http::RequestHead& head)
{
    auto preferred = pages_.find(defaultLanguage);
    double greatest = 0;
    for (const auto& [range, weight] : Host::Http::weightedElements(head, "Accept-Language")) {
        const std::string_view language = range.substr(0, range.find('-'));
        const auto found = std::find_if(pages_.begin(), pages_.end(),
            [&](const auto& each) { return Host::equalNames(each.first, language); });
        if (found != pages_.end() && weight > greatest) {
            greatest = weight;
            preferred = found;
        }
    }
    auto fields = pageFields("text/html; charset=utf-8", "no-store");
    fields.push_back({"Content-Language", preferred->first});
    fields.push_back({"Vary", "Accept-Language"});
    return representationOf(preferred->second->get(), std::move(fields));
}

} // namespace Tools
