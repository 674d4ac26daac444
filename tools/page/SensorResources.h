// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// What the scripts of the page read, which schema/sensor-profile-api.openapi.yaml describes.

#pragma once

#include "host/http/Resource.h"
#include "tools/page/ChangeFeed.h"
#include "tools/sensors/Harvest.h"
#include "tools/serve/SingleFlight.h"
#include "tools/serve/UnsentText.h"

#include <memory>

namespace Tools {

// The list of all sensors. Clients that wait at the same time share a harvest and its text.
class SensorListResource : public Host::Http::Resource {
public:
    // Both must outlive it.
    SensorListResource(SingleFlight<Harvest>& harvests, Host::Http::UnsentObjects& unsent);

    Host::Http::Representation represent(const Host::Http::RequestHead& head) override;

private:
    SingleFlight<UnsentText> lists_;
};

// The changes, as a stream.
class EventsResource : public Host::Http::Resource {
public:
    // The feed must outlive it and the streams.
    explicit EventsResource(ChangeFeed& feed) : feed_(feed) {}

    Host::Http::Representation represent(const Host::Http::RequestHead& head) override;

private:
    ChangeFeed& feed_;
};

// Returns the header fields of an answer that is not kept by caches.
std::vector<Host::Http::HeaderField> apiFields(const char* contentType);

} // namespace Tools
