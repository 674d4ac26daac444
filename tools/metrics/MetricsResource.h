// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "host/http/Resource.h"
#include "host/http/UnsentObjects.h"
#include "tools/metrics/Exposition.h"
#include "tools/metrics/SensorMetrics.h"
#include "tools/sensors/Harvest.h"
#include "tools/serve/SingleFlight.h"
#include "tools/serve/UnsentText.h"

#include <atomic>
#include <cstddef>
#include <functional>
#include <memory>

namespace Tools {

// The metrics of a server: GET /metrics. Scrapes at the same time share a harvest and its text.
class MetricsResource : public Host::Http::Resource {
public:
    // `addMore` adds further families to an exposition. The harvests must outlive the resource,
    // which must outlive its representations.
    MetricsResource(SingleFlight<Harvest>& harvests, std::function<void(Exposition&)> addMore);

    // Returns the form that the request prefers, the text format where it has no preference. Throws
    // HttpError where clients have yet to fetch very much text.
    Host::Http::Representation represent(const Host::Http::RequestHead& head) override;

private:
    // The lines of 10,000 sensors take 25 MB.
    static constexpr std::size_t maximumKeptSensors = 10'000;

    std::shared_ptr<const UnsentText> write(ExpositionForm form);

    SingleFlight<Harvest>& harvests_;
    const std::function<void(Exposition&)> addMore_;
    Host::Http::UnsentObjects unsent_;
    std::atomic<std::size_t> latestSize_ = 0; // of a text, in bytes
    SensorMetrics sensors_{maximumKeptSensors};
    SingleFlight<UnsentText> text_;
    SingleFlight<UnsentText> openMetrics_;
};

} // namespace Tools
