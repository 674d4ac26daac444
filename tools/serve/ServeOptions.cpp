// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/serve/ServeOptions.h"

#include "tools/UsageError.h"
#include "tools/serve/ConfigurationFile.h"

#include <CLI/CLI.hpp>

#include <cstdint>
#include <functional>

namespace Tools {

namespace {

constexpr const char* limitsGroup = "Limits, with their defaults";

void addFile(CLI::App& parser, const char* name, std::optional<std::string>& file,
    const std::string& description)
{
    parser.add_option(name, file, description)->type_name("FILE");
}

struct Bounds {
    std::uint64_t least;
    std::uint64_t most;
};

constexpr std::uint64_t many = 100'000;
// The unit of the service allows 4096 descriptors.
constexpr std::uint64_t mostConnections = 4000;
constexpr std::uint64_t veryMany = 100'000'000;
constexpr std::uint64_t aDay = 86'400; // in seconds

CLI::Option* addNumber(CLI::App& parser, const char* name, std::uint64_t value, Bounds bounds,
    const char* unit, const char* description, const std::function<void(std::uint64_t)>& set)
{
    return parser.add_option_function<std::uint64_t>(name, set, description)
        ->default_str(std::to_string(value))
        ->type_name(unit)
        ->check(CLI::Range(bounds.least, bounds.most).description(""));
}

template <typename Number>
void addCount(CLI::App& parser, const char* name, Number& value, Bounds bounds,
    const char* description, const char* unit = "N")
{
    addNumber(parser, name, value, bounds, unit, description, [&value](std::uint64_t given) {
        value = static_cast<Number>(given);
    })->group(limitsGroup);
}

template <typename Duration>
void addTime(CLI::App& parser, const char* name, Duration& value, std::uint64_t most,
    const char* description, const char* unit = "SECONDS")
{
    addNumber(parser, name, static_cast<std::uint64_t>(value.count()), {1, most}, unit, description,
        [&value](std::uint64_t given) { value = Duration(given); })
        ->group(limitsGroup);
}

void addPort(CLI::App& parser, const char* name, std::uint16_t& value, const char* description)
{
    addNumber(parser, name, value, {0, 65'535}, "PORT", description,
        [&value](std::uint64_t given) { value = static_cast<std::uint16_t>(given); });
}

void addPlaces(CLI::App& parser, Host::Http::ListenWishes& listen)
{
    parser
        .add_option("--address", listen.addresses,
            "Listen there; may be repeated (default: 127.0.0.1 and,\n"
            "where the machine has it, ::1)")
        ->type_name("ADDRESS")
        ->allow_extra_args(false)
        ->multi_option_policy(CLI::MultiOptionPolicy::TakeAll);
    addPort(parser, "--port", listen.port,
        "Port without TLS, on loopback addresses only; 0 is any\n"
        "that is free");
    addPort(parser, "--tls-port", listen.tlsPort, "Port with TLS; 0 is any that is free");
}

void addHttpLimits(CLI::App& parser, Host::Http::Limits& limits)
{
    constexpr std::uint64_t aGigabyte = std::uint64_t{1} << 30;
    constexpr std::uint64_t aMegabyte = std::uint64_t{1} << 20;
    addCount(
        parser, "--max-body", limits.maximumBody, {1024, aGigabyte}, "Size of a request", "BYTES");
    addCount(parser, "--max-header", limits.maximumHeader, {1024, aMegabyte},
        "Size of a request's first line and header fields", "BYTES");
    addCount(parser, "--max-depth", limits.maximumDepth, {16, 1024},
        "XML elements in one another in a request");
    addCount(parser, "--max-connections", limits.maximumConnections, {1, mostConnections},
        "Connections at a time, of all clients; each takes a\n"
        "thread and a file descriptor");
    addCount(parser, "--max-connections-per-address", limits.maximumConnectionsPerAddress,
        {1, many},
        "Connections at a time from one address; an IPv6 network\n"
        "(/64) counts as one");
    addCount(
        parser, "--workers", limits.workers, {1, 256}, "Requests that are worked on at a time");
    addCount(parser, "--max-queue", limits.maximumQueue, {1, many},
        "Requests that wait for that; those beyond are refused");
    addCount(parser, "--max-unsent-objects", limits.maximumUnsentObjects, {1, veryMany},
        "Objects in answers that clients have yet to fetch, in all");
    addTime(parser, "--idle-timeout", limits.idleTimeout, aDay,
        "A connection on which nothing moves is closed after");
    addTime(parser, "--request-timeout", limits.requestTimeout, aDay,
        "A request must have come within");
    addTime(parser, "--answer-timeout", limits.answerTimeout, aDay,
        "An answer must have been fetched within");
    addTime(parser, "--sign-in-delay", limits.signInDelay, 10'000,
        "What a wrong password costs; twice as much after each\n"
        "further one, up to 32 times",
        "MILLISECONDS");
}

void addOperationLimits(CLI::App& parser, Host::OperationLimits& limits)
{
    addCount(parser, "--max-enumerations", limits.maximumOpenEnumerations, {1, many},
        "Enumerations open at a time, of all clients");
    addCount(parser, "--max-held-objects", limits.maximumHeldObjects, {1, veryMany},
        "Objects kept for open enumerations, in all");
    addCount(parser, "--max-pull", limits.maximumObjectCount, {1, veryMany},
        "Objects in one answer to a pull");
    addTime(parser, "--enumeration-timeout", limits.defaultTimeout, aDay,
        "An enumeration that nobody pulls is closed after, unless\n"
        "its client asks for another time");
    addTime(parser, "--max-enumeration-timeout", limits.maximumTimeout, aDay,
        "The longest time that a client may ask for");
}

} // namespace

void ServeOptions::addTo(CLI::App& parser)
{
    addPlaces(parser, listen);
    addFile(parser, "--certificate", certificate,
        "Serve TLS, with this certificate in PEM form\n"
        "(default: no TLS)");
    addFile(parser, "--key", key, "The certificate's private key in PEM form");
    addFile(parser, "--passwords", passwords,
        "Clients must sign in as one of these users\n"
        "(default: anybody may ask)");
    parser
        .add_option("--user", user,
            "When started by root: serve as this user (default:\n"
            "sensor-profile if there is such a user, else nobody)")
        ->type_name("NAME");
    addFile(parser, "--config", configuration,
        "Take options from this file, but for those typed here\n"
        "(default: none)");
    addHttpLimits(parser, http);
    addOperationLimits(parser, operations);
    addTime(parser, "--grace-period", gracePeriod, aDay,
        "When the server ends, requests that run have so long");
}

void ServeOptions::complete(CLI::App& parser)
{
    if (configuration)
        applyConfigurationFile(parser, *configuration);
    if (certificate.has_value() != key.has_value())
        throw UsageError(certificate ? "--certificate needs the private key: --key is missing"
                                     : "--key needs its certificate: --certificate is missing");
    listen.hasCertificate = certificate.has_value();
    listen.hasPasswords = passwords.has_value();
}

} // namespace Tools
