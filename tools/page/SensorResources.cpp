// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/page/SensorResources.h"

#include "tools/output/SensorJson.h"

#include <string>

namespace Tools {

namespace {

std::string listOf(const Harvest& harvest)
{
    std::string json = "[";
    for (const Sensor* const sensor : inListOrder(harvest.sensors)) {
        json += json.size() > 1 ? ",\n" : "";
        appendSensorJson(json, *sensor);
    }
    return json + "]\n";
}

} // namespace

std::vector<Host::Http::HeaderField> apiFields(const char* contentType)
{
    return {{"Content-Type", contentType}, {"Cache-Control", "no-store"},
        {"Cross-Origin-Resource-Policy", "same-origin"}, {"X-Content-Type-Options", "nosniff"}};
}

SensorListResource::SensorListResource(
    SingleFlight<Harvest>& harvests, Host::Http::UnsentObjects& unsent)
    : lists_([&harvests, &unsent] {
          return std::make_shared<const UnsentText>(listOf(*harvests.get()), unsent);
      })
{
}

Host::Http::Representation SensorListResource::represent(const Host::Http::RequestHead&)
{
    return representationOf(lists_.get(), apiFields("application/json"));
}

Host::Http::Representation EventsResource::represent(const Host::Http::RequestHead&)
{
    return {apiFields("text/event-stream"), nullptr, 200, feed_.subscribe()};
}

} // namespace Tools
