// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "tools/history/HistoryKeeper.h"
#include "tools/history/SensorHistory.h"
#include "tools/page/ChangeFeed.h"
#include "tools/page/HistoryResource.h"
#include "tools/page/PageResource.h"
#include "tools/page/Sampler.h"
#include "tools/page/SensorResources.h"
#include "tools/page/WebFiles.h"

#include <chrono>
#include <filesystem>
#include <optional>
#include <string>

namespace Tools {

// The page and what its scripts read, as resources of a server.
class PageService {
public:
    // Where there is a history, it is written to its folder, or, without a
    // folder, kept in memory only.
    // Where `folder` lacks the files of the page, requests for the page are refused with the
    // reason, and the other resources work. The harvests must outlive the object. Throws
    // std::runtime_error where the history cannot be kept.
    PageService(SingleFlight<Harvest>& harvests, bool isHistoryKept,
        const std::optional<std::string>& historyFolder, const std::filesystem::path& folder);

    // Adds the resources. They belong to this object.
    void addTo(Host::Http::Resources& resources);

    // Writes the history a last time. Returns false where the sensors are still being read after
    // the timeout, for which the destructor would wait.
    bool finish(std::chrono::milliseconds timeout);

private:
    // Refuses requests with the reason why there is no page.
    class AbsentPage : public Host::Http::Resource {
    public:
        Host::Http::Representation represent(const Host::Http::RequestHead& head) override;

        std::string reason;
    };

    void readFiles(SingleFlight<Harvest>& harvests, const std::filesystem::path& folder);

    std::optional<SensorHistory> history_;
    std::optional<HistoryKeeper> keeper_;
    Host::Http::UnsentObjects unsent_{maximumUnsentBytes};
    ChangeFeed feed_;
    SensorListResource sensors_;
    HistoryResource histories_;
    EventsResource events_{feed_};
    AbsentPage absentPage_;
    std::optional<WebFiles> files_;
    std::optional<PageResource> page_;
    std::optional<Sampler> sampler_; // last: it uses all of the above
};

} // namespace Tools
