// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/serve/Greeting.h"

#include "tools/cim/ProviderClient.h"

namespace Tools {

namespace {

std::string urlOf(const Host::Http::ListeningSocket& socket, const std::string& account = {})
{
    std::string place = socket.address().text();
    // An unspecified address is no destination.
    if (socket.address().isAny())
        place = "localhost:" + std::to_string(socket.address().port());
    return (socket.isEncrypted() ? "https://" : "http://") + account + place;
}

} // namespace

std::string greeting(const std::vector<Host::Http::ListeningSocket>& sockets, bool isSignInNeeded)
{
    std::string text = "Serving CIM clients on";
    for (const auto& socket : sockets)
        text += (socket.isEncrypted() ? " https://" : " http://") + socket.address().text();
    const auto& first = sockets.front();
    text += "\nTry: wbemcli -nl ";
    if (first.isEncrypted())
        text += "-noverify ";
    return text + "ei '" + urlOf(first, isSignInNeeded ? "USER:PASSWORD@" : "") + "/" + nameSpace +
           ":" + sensorClass + "'\n";
}

} // namespace Tools
