// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/page/PageService.h"

#include "host/http/EventLog.h"

#include <exception>

namespace Tools {

PageService::PageService(SingleFlight<Harvest>& harvests, bool isHistoryKept,
    const std::optional<std::string>& historyFolder, const std::filesystem::path& folder)
    : sensors_(harvests, unsent_),
      histories_(isHistoryKept ? &history_.emplace() : nullptr, unsent_)
{
    if (history_ && historyFolder)
        keeper_.emplace(*history_, *historyFolder);
    readFiles(harvests, folder);
    sampler_.emplace(harvests, feed_, history_ ? &*history_ : nullptr);
}

void PageService::readFiles(SingleFlight<Harvest>& harvests, const std::filesystem::path& folder)
{
    try {
        files_.emplace(folder);
        page_.emplace(*files_, harvests, history_.has_value(), unsent_);
    } catch (const std::exception& error) {
        absentPage_.reason = std::string("the page is not installed: ") + error.what();
        Host::Http::report({"readFiles", "PageService", __LINE__}, absentPage_.reason);
    }
}

void PageService::addTo(Host::Http::Resources& resources)
{
    resources.emplace("/api/sensors", sensors_);
    resources.emplace("/api/history", histories_);
    resources.emplace("/api/events", events_);
    if (files_)
        files_->addTo(resources);
    if (page_)
        resources.emplace("/", *page_);
    else
        resources.emplace("/", absentPage_);
}

bool PageService::finish(std::chrono::milliseconds timeout)
{
    const bool isOver = sampler_->stop(timeout);
    keeper_.reset();
    return isOver;
}

Host::Http::Representation PageService::AbsentPage::represent(const Host::Http::RequestHead&)
{
    throw Host::Http::HttpError(404, reason);
}

} // namespace Tools
