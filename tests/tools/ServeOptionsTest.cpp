// Copyright The sensor-profile authors. SPDX-License-Identifier: Apache-2.0

// The limits of the server as options and as settings: their names, defaults and bounds.

#include "tools/serve/ServeOptions.h"
#include "tests/support/ErrorOf.h"
#include "tests/support/TemporaryFolder.h"
#include "tests/support/Texts.h"

#include <CLI/CLI.hpp>
#include <gmock/gmock.h>
#include <gtest/gtest.h>

#include <cstdint>
#include <string>
#include <vector>

namespace ServeOptionsTests {

using Values = std::vector<std::uint64_t>;

struct Limit {
    std::string name;
    std::uint64_t byDefault;
    std::uint64_t least;
    std::uint64_t most;
};

constexpr std::uint64_t many = 100'000;
constexpr std::uint64_t veryMany = 100'000'000;
constexpr std::uint64_t aDay = 86'400;

const std::vector<Limit> limits = {{"max-body", 1U << 20U, 1024, 1U << 30U},
    {"max-header", 16'384, 1024, 1U << 20U}, {"max-depth", 64, 16, 1024},
    {"max-connections", 256, 1, 4000}, {"max-connections-per-address", 64, 1, many},
    {"workers", 4, 1, 256}, {"max-queue", 128, 1, many},
    {"max-unsent-objects", 200'000, 1, veryMany}, {"idle-timeout", 60, 1, aDay},
    {"request-timeout", 30, 1, aDay}, {"answer-timeout", 600, 1, aDay},
    {"sign-in-delay", 1000, 1, 10'000}, {"max-enumerations", 64, 1, many},
    {"max-held-objects", 100'000, 1, veryMany}, {"max-pull", 10'000, 1, veryMany},
    {"enumeration-timeout", 60, 1, aDay}, {"max-enumeration-timeout", 600, 1, aDay},
    {"grace-period", 20, 1, aDay}};

template <typename Duration>
std::uint64_t countOf(Duration duration)
{
    return static_cast<std::uint64_t>(duration.count());
}

// Returns the values in the order of the limits. It does not compile when a structure gets a
// further member.
Values valuesOf(const Tools::ServeOptions& options)
{
    const auto& [body, header, depth, connections, connectionsPerAddress, workers, queue, unsent,
        idle, request, answer, signIn] = options.http;
    const auto& [enumerations, held, pull, timeout, longestTimeout] = options.operations;
    return {body, header, depth, connections, connectionsPerAddress, workers, queue, unsent,
        countOf(idle), countOf(request), countOf(answer), countOf(signIn), enumerations, held, pull,
        countOf(timeout), countOf(longestTimeout), countOf(options.gracePeriod)};
}

Values defaults()
{
    Values values;
    for (const Limit& limit : limits)
        values.push_back(limit.byDefault);
    return values;
}

Values with(std::size_t at, std::uint64_t value)
{
    Values values = defaults();
    values[at] = value;
    return values;
}

// Returns the values after the command line was parsed.
Values typed(std::vector<std::string> words)
{
    CLI::App parser;
    Tools::ServeOptions options;
    options.addTo(parser);
    parser.parse(std::vector<std::string>(words.rbegin(), words.rend()));
    options.complete(parser);
    return valuesOf(options);
}

class ServeOptionsTest : public testing::Test {
protected:
    Values configured(const std::string& line) const
    {
        return typed({"--config", folder_.write("settings", line + "\n")});
    }

    Testing::TemporaryFolder folder_;
};

// Returns the name of an option in the source of a manual page.
std::string inManual(std::string name)
{
    for (std::size_t at = 0; (at = name.find('-', at)) != std::string::npos; at += 2)
        name.insert(at, "\\");
    return "\n.It Fl \\-" + name + " ";
}

TEST_F(ServeOptionsTest, EveryLimitHasTheDefaultOfTheManual)
{
    EXPECT_EQ(valuesOf(Tools::ServeOptions()), defaults());
    const std::string page =
        Testing::contentOf(SENSOR_PROFILE_SOURCE_DIR "/packaging/man/sensorctl.1");
    for (const Limit& limit : limits) {
        const std::size_t begin = page.find(inManual(limit.name));
        ASSERT_NE(begin, std::string::npos) << limit.name;
        EXPECT_THAT(page.substr(begin, page.find("\n.", begin + 1) - begin),
            testing::ContainsRegex("[ (]" + std::to_string(limit.byDefault) + "($|[,;).])"));
    }
}

TEST_F(ServeOptionsTest, EveryLimitIsAnOptionAndASetting)
{
    for (std::size_t at = 0; at < limits.size(); ++at)
        for (const std::uint64_t value : {limits[at].least, limits[at].most}) {
            const std::string number = std::to_string(value);
            EXPECT_EQ(typed({"--" + limits[at].name, number}), with(at, value));
            EXPECT_EQ(configured(limits[at].name + " = " + number), with(at, value));
        }
}

TEST_F(ServeOptionsTest, ValuesBeyondTheBoundsAreRefusedNamingThem)
{
    for (const Limit& limit : limits)
        for (const std::uint64_t value : {limit.least - 1, limit.most + 1}) {
            const std::string number = std::to_string(value);
            const std::string reason = "--" + limit.name + ": Value " + number + " not in range " +
                                       std::to_string(limit.least) + " to " +
                                       std::to_string(limit.most);
            EXPECT_EQ(Testing::errorOf([&] { typed({"--" + limit.name, number}); }), reason);
            EXPECT_EQ(Testing::errorOf([&] { configured(limit.name + " = " + number); }),
                (folder_.path() / "settings").string() + ":1: " + reason);
        }
}

} // namespace ServeOptionsTests
