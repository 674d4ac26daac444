// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// Defines the requests in whose answers object managers are compared.

#pragma once

#include <compare>
#include <functional>
#include <ostream>
#include <string>
#include <vector>

namespace Testing {

// Holds what wbemcli is given; an empty member is left out.
struct ClientRequest {
    std::string operation; // as wbemcli names it
    std::string object;    // a class or a path
    std::string association = {};
    std::string resultClass = {};
    std::string role = {};
    std::string resultRole = {};
    // The names of properties, separated by commas; the method that is invoked; or the property
    // that is set, with its value.
    std::string properties = {};
    bool hasEmptyList = false; // of properties

    auto operator<=>(const ClientRequest&) const = default;

    bool isAssociators() const { return operation == "ai" || operation == "ain"; }
    bool isReferences() const { return operation == "ri" || operation == "rin"; }
    // Returns wbemcli's arguments, given the URL of the object.
    std::vector<std::string> arguments(const std::string& url) const;
};

std::ostream& operator<<(std::ostream& stream, const ClientRequest& request);

// Returns the paths of a class's objects.
using PathsOf = std::function<std::vector<std::string>(const std::string& className)>;

// Returns requests that write, all of which are refused, requests for methods and for all
// operations that read instances: of all classes and objects, from both ends of both associations,
// with and without each filter, and with names that fit nothing.
std::vector<ClientRequest> allRequests(const PathsOf& pathsOf);

} // namespace Testing
