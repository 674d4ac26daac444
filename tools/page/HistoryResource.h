// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "host/http/Resource.h"
#include "tools/history/SensorHistory.h"
#include "tools/serve/SingleFlight.h"
#include "tools/serve/UnsentText.h"

namespace Tools {

// The history of some sensors, or the thinned hour of all, which
// schema/sensor-profile-api.openapi.yaml describes.
class HistoryResource : public Host::Http::Resource {
public:
    // The history is null where none is kept. Both must outlive it.
    HistoryResource(const SensorHistory* history, Host::Http::UnsentObjects& unsent);

    // Answers with status 400 or 404 as JSON.
    Host::Http::Representation represent(const Host::Http::RequestHead& head) override;

private:
    const SensorHistory* const history_;
    Host::Http::UnsentObjects& unsent_;
    SingleFlight<UnsentText> ofAll_;
};

} // namespace Tools
