// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/serve/ServeOptions.h"

#include "tools/UsageError.h"
#include "tools/metrics/CompatibleOption.h"
#include "tools/serve/ConfigurationFile.h"

#include <CLI/CLI.hpp>

#include <cstdint>
#include <cstdlib>
#include <filesystem>
#include <functional>
#include <memory>
#include <string_view>
#include <system_error>
#include <vector>

namespace Tools {

namespace {

constexpr const char* limitsGroup = "Limits";

// Leaves the limits out of the help, which fits on a screen; the manual page describes them. An
// option of the group without a name, which CLI11 hides, would have no name in errors either.
class HelpWithoutLimits : public CLI::Formatter {
public:
    explicit HelpWithoutLimits(std::size_t column) { column_width(column); }

    std::string make_group(std::string group, bool isPositional,
        std::vector<const CLI::Option*> options) const override
    {
        return group == limitsGroup ? "" : CLI::Formatter::make_group(group, isPositional, options);
    }
};

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

CLI::Option* addNumber(CLI::App& parser, const char* name, Bounds bounds,
    const std::function<void(std::uint64_t)>& set, const char* description = "")
{
    return parser.add_option_function<std::uint64_t>(name, set, description)
        ->check(CLI::Range(bounds.least, bounds.most).description(""));
}

template <typename Number>
void addCount(CLI::App& parser, const char* name, Number& value, Bounds bounds)
{
    addNumber(parser, name, bounds, [&value](std::uint64_t given) {
        value = static_cast<Number>(given);
    })->group(limitsGroup);
}

template <typename Duration>
void addTime(CLI::App& parser, const char* name, Duration& value, std::uint64_t most)
{
    addNumber(parser, name, {1, most}, [&value](std::uint64_t given) {
        value = Duration(given);
    })->group(limitsGroup);
}

void addPort(CLI::App& parser, const char* name, std::uint16_t& value, const char* description)
{
    const auto set = [&value](std::uint64_t given) { value = static_cast<std::uint16_t>(given); };
    addNumber(parser, name, {0, 65'535}, set, description)
        ->default_str(std::to_string(value))
        ->type_name("N");
}

void addPlaces(CLI::App& parser, Host::Http::ListenWishes& listen)
{
    parser
        .add_option("--address", listen.addresses,
            "Listen there; may be repeated (default: 127.0.0.1, ::1)")
        ->type_name("ADDR")
        ->allow_extra_args(false)
        ->multi_option_policy(CLI::MultiOptionPolicy::TakeAll);
    addPort(parser, "--port", listen.port, "Port without TLS, on loopback addresses; 0 is any");
    addPort(parser, "--tls-port", listen.tlsPort, "Port with TLS; 0 is any");
}

void addHttpLimits(CLI::App& parser, Host::Http::Limits& limits)
{
    constexpr std::uint64_t aGigabyte = std::uint64_t{1} << 30;
    constexpr std::uint64_t aMegabyte = std::uint64_t{1} << 20;
    addCount(parser, "--max-body", limits.maximumBody, {1024, aGigabyte});
    addCount(parser, "--max-header", limits.maximumHeader, {1024, aMegabyte});
    addCount(parser, "--max-depth", limits.maximumDepth, {16, 1024});
    addCount(parser, "--max-connections", limits.maximumConnections, {1, mostConnections});
    addCount(
        parser, "--max-connections-per-address", limits.maximumConnectionsPerAddress, {1, many});
    addCount(parser, "--workers", limits.workers, {1, 256});
    addCount(parser, "--max-queue", limits.maximumQueue, {1, many});
    addCount(parser, "--max-unsent-objects", limits.maximumUnsentObjects, {1, veryMany});
    addTime(parser, "--idle-timeout", limits.idleTimeout, aDay);
    addTime(parser, "--request-timeout", limits.requestTimeout, aDay);
    addTime(parser, "--answer-timeout", limits.answerTimeout, aDay);
    addTime(parser, "--sign-in-delay", limits.signInDelay, 10'000);
}

void addOperationLimits(CLI::App& parser, Host::OperationLimits& limits)
{
    addCount(parser, "--max-enumerations", limits.maximumOpenEnumerations, {1, many});
    addCount(parser, "--max-held-objects", limits.maximumHeldObjects, {1, veryMany});
    addCount(parser, "--max-pull", limits.maximumObjectCount, {1, veryMany});
    addTime(parser, "--enumeration-timeout", limits.defaultTimeout, aDay);
    addTime(parser, "--max-enumeration-timeout", limits.maximumTimeout, aDay);
}

} // namespace

void ServeOptions::addTo(CLI::App& parser)
{
    parser.formatter(
        std::make_shared<HelpWithoutLimits>(parser.get_formatter()->get_column_width()));
    addPlaces(parser, listen);
    addFile(parser, "--certificate", certificate, "Serve TLS with this certificate in PEM form");
    addFile(parser, "--key", key, "The certificate's private key in PEM form");
    addFile(parser, "--passwords", passwords, "Users who may sign in (default: everybody may ask)");
    parser.add_option("--user", user, "Serve as this user, when started by root")
        ->type_name("NAME");
    parser.add_option("--history", history, "Keep the last day's readings in this folder, or off")
        ->type_name("FOLDER");
    addCompatible(parser, compatible);
    addFile(parser, "--config", configuration, "Read options from this file, too");
    parser.add_flag("--check", isCheck, "Check the options and their files, and exit");
    addHttpLimits(parser, http);
    addOperationLimits(parser, operations);
    addTime(parser, "--grace-period", gracePeriod, aDay);
}

void ServeOptions::complete(CLI::App& parser)
{
    if (configuration)
        applyConfigurationFile(parser, *configuration);
    if (certificate.has_value() != key.has_value())
        throw UsageError(certificate ? "--certificate needs the private key: --key is missing"
                                     : "--key needs its certificate: --certificate is missing");
    const char* const stateFolders = std::getenv("STATE_DIRECTORY"); // systemd.exec(5)
    if (!history && stateFolders != nullptr && *stateFolders != '\0')
        history =
            std::string_view(stateFolders).substr(0, std::string_view(stateFolders).find(':'));
    isHistoryKept = history != "off";
    if (!isHistoryKept)
        history.reset();
    std::error_code error; // of a folder that cannot be looked up
    if (history && !std::filesystem::is_directory(*history, error))
        throw UsageError("--history needs a folder or off: there is no folder " + *history);
    listen.hasCertificate = certificate.has_value();
    listen.hasPasswords = passwords.has_value();
}

} // namespace Tools
