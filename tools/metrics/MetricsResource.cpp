// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/metrics/MetricsResource.h"

#include "host/http/ResourceCheck.h"
#include "tools/metrics/HarvestMetrics.h"
#include "tools/serve/FreedMemory.h"

#include <malloc.h>

#include <cstddef>
#include <utility>

namespace Tools {

namespace {

// In the texts that clients have yet to fetch. Of 10,000 sensors, three fit.
constexpr std::size_t maximumUnsentBytes = std::size_t{64} << 20;

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

Host::Http::HttpError tooMuchText()
{
    return Host::Http::HttpError::closing(
        503, "clients have yet to fetch too much text", {{"Retry-After", "1"}});
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
    return {{{"Content-Type", contentTypeOf(form)}, {"Vary", "Accept"}}, {text, &text->content}};
}

std::shared_ptr<const MetricsResource::Text> MetricsResource::write(ExpositionForm form)
{
    if (!unsent_.hasRoomFor(latestSize_)) // before the sensors are read in vain
        throw tooMuchText();
    Exposition exposition(form, latestSize_ + latestSize_ / 64);
    auto harvest = harvests_.get();
    const std::size_t sensors = harvest->sensors.size();
    addHarvest(exposition, *harvest);
    harvest.reset();
    if (sensors >= largeAnswer)
        ::malloc_trim(0);
    addMore_(exposition);
    auto text = std::make_shared<Text>();
    text->content = std::move(exposition).finish();
    latestSize_ = text->content.size();
    text->share = unsent_.hold(text->content.size());
    if (!text->share)
        throw tooMuchText();
    return text;
}

} // namespace Tools
