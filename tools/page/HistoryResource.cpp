// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/page/HistoryResource.h"

#include "host/http/ResourceCheck.h"
#include "tools/history/HistoryJson.h"
#include "tools/output/JsonText.h"
#include "tools/page/SensorResources.h"

#include <algorithm>
#include <cstddef>
#include <stdexcept>
#include <utility>

namespace Tools {

namespace {

using Host::Http::Representation;

constexpr std::size_t maximumDevices = 6;
constexpr int secondsOfMinute = secondsOfSlot * slotsOfMinute;

// The reason for which a request is refused.
class RequestProblem : public std::runtime_error {
public:
    RequestProblem(unsigned status, const char* reason)
        : std::runtime_error(reason), status_(status)
    {
    }

    unsigned status() const { return status_; }

private:
    unsigned status_;
};

struct Query {
    std::string span;
    std::vector<std::string> devices;
    bool isThinned = false;
};

// Throws RequestProblem.
Query parse(const Host::Http::RequestHead& head)
{
    Query query;
    for (auto& [name, value] : Host::Http::queryOf(head)) {
        if (name == "span") {
            query.span = value;
        } else if (name == "device") {
            if (std::find(query.devices.begin(), query.devices.end(), value) != query.devices.end())
                throw RequestProblem(400, "a device is there twice");
            query.devices.push_back(std::move(value));
        } else if (name == "points") {
            if (value != std::to_string(thinnedSamples))
                throw RequestProblem(400, "points can be 60 only");
            query.isThinned = true;
        }
    }
    if (query.span != "hour" && query.span != "day")
        throw RequestProblem(400, "span must be hour or day");
    if (query.isThinned && query.span == "day")
        throw RequestProblem(400, "points needs the span hour");
    if (query.devices.size() > maximumDevices)
        throw RequestProblem(400, "there can be at most 6 devices");
    if (query.devices.empty() && !query.isThinned)
        throw RequestProblem(400, "without devices, points must be 60");
    return query;
}

void append(std::string& json, const Query& query, const std::string& deviceId,
    const Samples& samples, SlotNumber newest)
{
    json += json.empty() ? "" : ",\n";
    if (query.span == "day")
        appendDay(json, deviceId, samples, newest);
    else if (query.isThinned)
        appendThinnedHour(json, deviceId, samples, newest);
    else
        appendHour(json, deviceId, samples, newest);
}

// Throws RequestProblem.
std::string historyOf(const SensorHistory& history, const Query& query)
{
    std::string sensors;
    SlotNumber end = 0;
    const auto visit = [&](const std::string& deviceId, const Samples& samples, SlotNumber newest) {
        append(sensors, query, deviceId, samples, newest);
        end = newest + 1;
    };
    if (query.devices.empty())
        history.visitPresent(visit);
    else if (!history.visit(query.devices, visit))
        throw RequestProblem(404, "nothing was recorded of the devices");

    const bool isOfMinutes = query.span == "day" || query.isThinned;
    const SlotNumber endOfMinutes = (minuteOf(end - 1) + 1) * secondsOfMinute;
    const int interval = isOfMinutes ? secondsOfMinute : secondsOfSlot;
    return R"({"span": ")" + query.span + R"(", "interval": )" + std::to_string(interval) +
           R"(, "end": )" +
           std::to_string(query.span == "day" ? endOfMinutes : end * secondsOfSlot) +
           R"(, "sensors": [)" + sensors + "]}\n";
}

std::string errorText(const RequestProblem& problem)
{
    std::string json = "{\"error\": ";
    appendString(json, problem.what());
    return json + "}\n";
}

} // namespace

HistoryResource::HistoryResource(const SensorHistory* history, Host::Http::UnsentObjects& unsent)
    : history_(history), unsent_(unsent), ofAll_([this] {
          return std::make_shared<const UnsentText>(
              historyOf(*history_, Query{"hour", {}, true}), unsent_);
      })
{
}

Representation HistoryResource::represent(const Host::Http::RequestHead& head)
{
    const auto fields = apiFields("application/json");
    try {
        const Query query = parse(head);
        if (history_ == nullptr)
            throw RequestProblem(404, "the server keeps no history");
        if (query.devices.empty())
            return representationOf(ofAll_.get(), fields);
        return representationOf(
            std::make_shared<const UnsentText>(historyOf(*history_, query), unsent_), fields);
    } catch (const RequestProblem& problem) {
        return {fields, std::make_shared<const std::string>(errorText(problem)), problem.status()};
    }
}

} // namespace Tools
