// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/metrics/MetricsResource.h"

#include "host/http/ResourceCheck.h"
#include "tools/metrics/HarvestMetrics.h"
#include "tools/serve/FreedMemory.h"

#include <utility>

namespace Tools {

namespace {

ExpositionForm preferredForm(const Host::Http::RequestHead& head)
{
    const double openMetrics = Host::Http::weightOf(head, "application/openmetrics-text", "1.0.0");
    return openMetrics > 0 && openMetrics >= Host::Http::weightOf(head, "text/plain", "0.0.4")
               ? ExpositionForm::openMetrics
               : ExpositionForm::text;
}

const char* contentTypeOf(ExpositionForm form)
{
    return form == ExpositionForm::text
               ? "text/plain; version=0.0.4; charset=utf-8"
               : "application/openmetrics-text; version=1.0.0; charset=utf-8";
}

} // namespace

MetricsResource::MetricsResource(
    SingleFlight<Harvest>& harvests, std::function<void(Exposition&)> addMore)
    : harvests_(harvests), addMore_(std::move(addMore)), unsent_(maximumUnsentBytes),
      text_([this] { return write(ExpositionForm::text); }),
      openMetrics_([this] { return write(ExpositionForm::openMetrics); })
{
}

Host::Http::Representation MetricsResource::represent(const Host::Http::RequestHead& head)
{
    const ExpositionForm form = preferredForm(head);
    const auto text = (form == ExpositionForm::text ? text_ : openMetrics_).get();
    return representationOf(text, {{"Content-Type", contentTypeOf(form)}, {"Vary", "Accept"}});
}

std::shared_ptr<const UnsentText> MetricsResource::write(ExpositionForm form)
{
    if (!unsent_.hasRoomFor(latestSize_)) // before the sensors are read in vain
        throw tooMuchUnsentText();
    // From one text to the next, some numbers become longer.
    Exposition exposition(form, latestSize_ + latestSize_ / 64);
    auto harvest = harvests_.get();
    const std::size_t count = harvest->sensors.size();
    addHarvest(exposition, *harvest, sensors_);
    harvest.reset();
    if (count >= largeAnswer)
        returnFreedMemory();
    addMore_(exposition);
    std::string text = std::move(exposition).finish();
    latestSize_ = text.size();
    return std::make_shared<const UnsentText>(std::move(text), unsent_);
}

} // namespace Tools
