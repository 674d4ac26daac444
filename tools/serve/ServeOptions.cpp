// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/serve/ServeOptions.h"

#include "tools/UsageError.h"
#include "tools/serve/ConfigurationFile.h"

#include <CLI/CLI.hpp>

#include <cstdint>

namespace Tools {

namespace {

constexpr const char* limitsGroup = "Limits";

void addFile(CLI::App& parser, const char* name, std::optional<std::string>& file,
    const std::string& description)
{
    parser.add_option(name, file, description)->type_name("FILE");
}

template <typename Number>
void addCount(CLI::App& parser, const char* name, Number& value, std::uint64_t least,
    std::uint64_t most, const char* description, const char* unit = "N")
{
    parser
        .add_option_function<std::uint64_t>(
            name, [&value](std::uint64_t given) { value = static_cast<Number>(given); },
            description)
        ->default_str(std::to_string(value))
        ->type_name(unit)
        ->check(CLI::Range(least, most).description(""))
        ->group(limitsGroup);
}

void addSeconds(
    CLI::App& parser, const char* name, std::chrono::seconds& value, const char* description)
{
    constexpr std::uint64_t aDay = 86'400;
    parser
        .add_option_function<std::uint64_t>(
            name, [&value](std::uint64_t given) { value = std::chrono::seconds(given); },
            description)
        ->default_str(std::to_string(value.count()))
        ->type_name("SECONDS")
        ->check(CLI::Range(std::uint64_t{1}, aDay).description(""))
        ->group(limitsGroup);
}

void addPlaces(CLI::App& parser, Host::Http::ListenWishes& listen)
{
    parser
        .add_option(
            "--address", listen.addresses, "Listen there; may be repeated (127.0.0.1 and ::1)")
        ->type_name("ADDRESS")
        ->allow_extra_args(false)
        ->multi_option_policy(CLI::MultiOptionPolicy::TakeAll);
    parser.add_option("--port", listen.port, "Without TLS, on loopback addresses; 0 is any")
        ->type_name("PORT")
        ->capture_default_str();
    parser.add_option("--tls-port", listen.tlsPort, "With TLS; 0 is any")
        ->type_name("PORT")
        ->capture_default_str();
}

void addHttpLimits(CLI::App& parser, Host::Http::Limits& limits)
{
    constexpr std::uint64_t aGigabyte = std::uint64_t{1} << 30;
    constexpr std::uint64_t aMegabyte = std::uint64_t{1} << 20;
    constexpr std::uint64_t many = 100'000;
    addCount(parser, "--max-body", limits.maximumBody, 1024, aGigabyte, "Of a request", "BYTES");
    addCount(parser, "--max-header", limits.maximumHeader, 1024, aMegabyte,
        "Of a request's first line and header fields", "BYTES");
    addCount(
        parser, "--max-depth", limits.maximumDepth, 16, 1024, "Of XML elements in one another");
    addCount(parser, "--max-connections", limits.maximumConnections, 1, many, "In all");
    addCount(parser, "--max-connections-per-address", limits.maximumConnectionsPerAddress, 1, many,
        "From one client's address");
    addCount(parser, "--workers", limits.workers, 1, 256, "Operations that run at a time");
    addCount(parser, "--max-queue", limits.maximumQueue, 1, many, "Operations that wait");
    addSeconds(parser, "--idle-timeout", limits.idleTimeout, "A client may be silent so long");
    addSeconds(parser, "--request-timeout", limits.requestTimeout, "A request must come within");
    addSeconds(
        parser, "--answer-timeout", limits.answerTimeout, "An answer must be fetched within");
}

void addOperationLimits(CLI::App& parser, Host::OperationLimits& limits)
{
    constexpr std::uint64_t many = 100'000;
    constexpr std::uint64_t veryMany = 100'000'000;
    addCount(parser, "--max-enumerations", limits.maximumOpenEnumerations, 1, many,
        "Open at a time, of all clients");
    addCount(parser, "--max-held-objects", limits.maximumHeldObjects, 1, veryMany,
        "In open enumerations");
    addCount(parser, "--max-pull", limits.maximumObjectCount, 1, veryMany,
        "Objects in one answer to a pull");
    addSeconds(parser, "--enumeration-timeout", limits.defaultTimeout,
        "An enumeration that nobody pulls stays so long");
    addSeconds(parser, "--max-enumeration-timeout", limits.maximumTimeout,
        "The longest that a client may ask for");
}

} // namespace

void ServeOptions::addTo(CLI::App& parser)
{
    addPlaces(parser, listen);
    addFile(parser, "--certificate", certificate, "Serve TLS with this certificate (PEM)");
    addFile(parser, "--key", key, "The certificate's private key (PEM)");
    addFile(parser, "--passwords", passwords, "Clients must sign in as one of these users");
    parser.add_option("--user", user, "As root: serve as this user (sensor-profile or nobody)")
        ->type_name("NAME");
    addFile(parser, "--config", configuration, "Options from a file, for those not given here");
    addHttpLimits(parser, http);
    addOperationLimits(parser, operations);
    addSeconds(parser, "--grace-period", gracePeriod,
        "Requests that run have so long when the server ends");
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
