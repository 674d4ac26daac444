// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#pragma once

#include "host/http/Resource.h"
#include "tools/sensors/Harvest.h"
#include "tools/serve/SingleFlight.h"
#include "tools/serve/UnsentText.h"

#include <functional>
#include <map>
#include <memory>
#include <string>

namespace Tools {

class WebFiles;

// The page with a table of the sensors and the sources that are lost, in the language that the
// request prefers; in English where it prefers none of the page's. Texts of sensors are escaped.
class PageResource : public Host::Http::Resource {
public:
    // Takes the template `page.html` and the texts in `languages`. The other arguments must outlive
    // it. Throws std::runtime_error where these files are missing or malformed.
    PageResource(const WebFiles& files, SingleFlight<Harvest>& harvests, bool isHistoryKept,
        Host::Http::UnsentObjects& unsent);

    Host::Http::Representation represent(const Host::Http::RequestHead& head) override;

private:
    const std::string template_;
    // By language. Clients that wait at the same time share a harvest and its page.
    std::map<std::string, std::unique_ptr<SingleFlight<UnsentText>>, std::less<>> pages_;
};

} // namespace Tools
