// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

#include "tools/collect/CollectOptions.h"

#include <CLI/CLI.hpp>

namespace Tools {

namespace {

constexpr const char* collectFooter =
    "The file describes the fans, voltages and temperatures of /dev/ipmi0; the source\n"
    "`ipmi` or `ipmi:FILE` of VORN_INSTRUMENTATION publishes them. Without --once, it\n"
    "is renewed until a signal ends the command.\n"
    "\n"
    "Workarounds, for controllers that deviate from IPMI:\n"
    "  discretereading         sensors with readings have a discrete type\n"
    "  ignorescanningdisabled  the BMC says of every sensor that it is not scanned\n"
    "  assumebmcowner          all sensors are the BMC's, whatever their records say";

} // namespace

void CollectOptions::addTo(CLI::App& parser)
{
    parser.add_flag("--once", isOnce, "Write the file once and exit");
    parser.add_option("-o,--output", file, "Renew this file")
        ->type_name("FILE")
        ->capture_default_str();
    parser.add_option("--interval", interval, "Read every so many seconds, or more slowly")
        ->type_name("SECONDS")
        ->check(CLI::Range(1U, 3600U).description(""))
        ->capture_default_str();
    parser.add_flag("--only-present", isOnlyPresent, "Leave out what has never been readable");
    parser.add_option("--workaround", workarounds, "Allow for a deviation; may be repeated")
        ->type_name("NAME")
        ->check(CLI::IsMember({discreteReading, ignoreScanningDisabled, assumeBmcOwner})
                    .description(""))
        ->expected(1)
        ->take_all();
    parser.footer(collectFooter);
}

std::optional<int> CollectOptions::parse(int argc, const char* const* argv)
{
    CLI::App parser("Reads the sensors of the BMC", "sensorctl collect");
    addTo(parser);
    try {
        parser.parse(argc, argv);
        return std::nullopt;
    } catch (const CLI::ParseError& error) {
        return parser.exit(error);
    }
}

std::vector<std::string> CollectOptions::words() const
{
    std::vector<std::string> words = {"--output", file, "--interval", std::to_string(interval)};
    if (isOnce)
        words.emplace_back("--once");
    if (isOnlyPresent)
        words.emplace_back("--only-present");
    for (const std::string& workaround : workarounds)
        words.insert(words.end(), {"--workaround", workaround});
    return words;
}

} // namespace Tools
